// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The only source that uses the compression libraries. ISA-L deflates geometry in 0.4 of the time that libdeflate
// takes, into a tenth more bytes; libdeflate inflates faster.
#include "container/ZlibStream.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>
#include <memory>
#include <new>
#include <vector>

#include <isa-l/igzip_lib.h>
#include <libdeflate.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// Geometry is mostly mantissa bits: level 2 takes longer and saves a fiftieth of the bytes.
constexpr unsigned kCompressionLevel = 1;
constexpr std::size_t kLevelMemory = ISAL_DEF_LVL1_DEFAULT;

/// The library counts the bytes of a call in 32 bits.
constexpr std::size_t kMostBytesOfACall = std::size_t{1} << 30;

/// Longer arrays hardly repeat and are not cached.
constexpr std::size_t kMostKeptBytes = std::size_t{1} << 17;

} // namespace

namespace {

class Decompressor {
public:
    bool inflate(std::span<const char> stream, std::span<char> destination) {
        if (!mMemory)
            mMemory.reset(libdeflate_alloc_decompressor());
        if (!mMemory)
            throw std::bad_alloc(); // not an error of the stream
        // Without a variable for the actual size the library requires the exact one.
        return libdeflate_zlib_decompress(mMemory.get(), stream.data(), stream.size(), destination.data(),
                                          destination.size(), nullptr) == LIBDEFLATE_SUCCESS;
    }

private:
    std::unique_ptr<libdeflate_decompressor, decltype(&libdeflate_free_decompressor)> mMemory{
        nullptr, &libdeflate_free_decompressor};
};

/// A thread's decompressor and cache for short arrays. Curves of one rig have their keys at the same times, each with
/// an array of its own: short arrays that were inflated recently are copied.
class Inflater {
public:
    bool inflate(std::span<const char> stream, std::span<char> destination) {
        Kept& kept = find(stream, destination.size());
        kept.lastUse = ++mUses;
        if (kept.size != 0) {
            std::memcpy(destination.data(), kept.bytes.data() + stream.size(), destination.size());
            return true;
        }
        if (!mDecompressor.inflate(stream, destination))
            return false;
        remember(kept, stream, destination);
        return true;
    }

private:
    struct Kept {
        std::vector<char> bytes;    ///< the stream, followed by its inflated content
        std::size_t streamSize = 0; ///< size of the stream
        std::size_t size = 0;       ///< size of the content; 0: the entry is unused
        std::uint64_t lastUse = 0;
    };

    /// The entry of that stream; else the least recently used one, emptied.
    Kept& find(std::span<const char> stream, std::size_t size) {
        Kept* oldest = mKept.data();
        for (Kept& kept : mKept) {
            if (kept.size == size && kept.streamSize == stream.size() && size != 0 &&
                std::memcmp(kept.bytes.data(), stream.data(), stream.size()) == 0)
                return kept;
            oldest = kept.lastUse < oldest->lastUse ? &kept : oldest;
        }
        oldest->size = 0;
        return *oldest;
    }

    static void remember(Kept& kept, std::span<const char> stream, std::span<const char> content) {
        kept.bytes.clear();
        kept.bytes.reserve(stream.size() + content.size());
        kept.bytes.insert(kept.bytes.end(), stream.begin(), stream.end());
        kept.bytes.insert(kept.bytes.end(), content.begin(), content.end());
        kept.streamSize = stream.size();
        kept.size = content.size();
    }

    Decompressor mDecompressor;
    std::array<Kept, 8> mKept;
    std::uint64_t mUses = 0;
};

} // namespace

bool inflateExactly(std::span<const char> stream, std::span<char> destination) {
    constexpr std::size_t kMostRemembered = std::size_t{1} << 13;
    if (destination.size() > kMostRemembered || stream.size() > kMostRemembered) {
        // No object with the lifetime of the thread: the threads that inflate large arrays are short-lived, and the C
        // library aborts the process when there is no memory to register a destructor with a thread.
        return Decompressor().inflate(stream, destination);
    }
    thread_local Inflater inflater;
    return inflater.inflate(stream, destination);
}

/// The library's state, reused for each stream.
struct Deflater::Compressor {
    /// The size of the stream; 0 when it does not fit.
    std::size_t deflate(std::span<const char> bytes, std::span<char> destination) {
        begin();
        std::size_t read = 0, written = 0;
        while (stream.internal_state.state != ZSTATE_END) {
            if (written == destination.size())
                return 0;
            const std::span<const char> in = bytes.subspan(read, std::min(bytes.size() - read, kMostBytesOfACall));
            const std::span<char> out =
                destination.subspan(written, std::min(destination.size() - written, kMostBytesOfACall));
            // The library does not write to its input.
            stream.next_in = static_cast<std::uint8_t*>(static_cast<void*>(const_cast<char*>(in.data())));
            stream.avail_in = static_cast<std::uint32_t>(in.size());
            stream.end_of_stream = read + in.size() == bytes.size() ? 1 : 0;
            stream.next_out = static_cast<std::uint8_t*>(static_cast<void*>(out.data()));
            stream.avail_out = static_cast<std::uint32_t>(out.size());
            if (isal_deflate(&stream) != COMP_OK)
                return 0;
            read += in.size() - stream.avail_in;
            written += out.size() - stream.avail_out;
        }
        return written;
    }

private:
    // A reset would keep what is left of a stream that was given up.
    void begin() {
        isal_deflate_init(&stream);
        stream.gzip_flag = IGZIP_ZLIB;
        stream.level = kCompressionLevel;
        stream.level_buf = levelMemory.data();
        stream.level_buf_size = static_cast<std::uint32_t>(levelMemory.size());
    }

    isal_zstream stream;
    std::array<std::uint8_t, kLevelMemory> levelMemory;
};

Deflater::Deflater() : mCompressor(std::make_unique<Compressor>()) {}
Deflater::~Deflater() = default;

std::span<const char> Deflater::deflated(std::span<const char> bytes) {
    if (bytes.size() > kMostKeptBytes)
        return deflatedAnew(bytes);
    ++mUses;
    if (Kept* const known = find(bytes)) {
        known->lastUse = mUses;
        return known->stream;
    }
    const std::span<const char> stream = deflatedAnew(bytes);
    Kept& kept = *std::min_element(mKept.begin(), mKept.end(),
                                   [](const Kept& a, const Kept& b) { return a.lastUse < b.lastUse; });
    kept.lastUse = mUses;
    kept.bytes.clear(); // until the stream is complete, it is not found
    kept.stream.assign(stream.begin(), stream.end());
    kept.bytes.assign(bytes.begin(), bytes.end());
    return kept.stream;
}

Deflater::Kept* Deflater::find(std::span<const char> bytes) {
    const auto found = std::find_if(mKept.begin(), mKept.end(), [&](const Kept& kept) {
        return kept.bytes.size() == bytes.size() && std::memcmp(kept.bytes.data(), bytes.data(), bytes.size()) == 0;
    });
    return found != mKept.end() ? &*found : nullptr;
}

std::span<const char> Deflater::deflatedAnew(std::span<const char> bytes) {
    if (bytes.empty())
        return {};
    if (mMemorySize < bytes.size()) {
        mMemorySize = 0;
        mMemory = std::make_unique_for_overwrite<char[]>(bytes.size());
        mMemorySize = bytes.size();
    }
    const std::size_t size = mCompressor->deflate(bytes, {mMemory.get(), bytes.size() - 1});
    return {mMemory.get(), size};
}

} // namespace detail
FBXSDK_NAMESPACE_END
