// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The only place that knows the compression library.
#include "container/ZlibStream.h"

#include <algorithm>
#include <cstring>
#include <memory>
#include <new>

#include <libdeflate.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// Geometry is mostly mantissa bits: level 3 takes almost twice as long and saves a fiftieth of the bytes.
constexpr int kCompressionLevel = 1;

/// Longer arrays do not repeat.
constexpr std::size_t kMostKeptBytes = std::size_t{1} << 18;

} // namespace

namespace {

using Decompressor = std::unique_ptr<libdeflate_decompressor, decltype(&libdeflate_free_decompressor)>;

/// One for each thread that ever inflated something: to make one takes as long as to inflate a short array.
libdeflate_decompressor* decompressorOfThread() {
    thread_local Decompressor decompressor(nullptr, &libdeflate_free_decompressor);
    if (!decompressor) {
        decompressor.reset(libdeflate_alloc_decompressor());
    }
    return decompressor.get();
}

} // namespace

bool inflateExactly(std::span<const char> stream, std::span<char> destination) {
    libdeflate_decompressor* const decompressor = decompressorOfThread();
    if (decompressor == nullptr) {
        throw std::bad_alloc(); // says nothing about the stream
    }
    // Without a place for the actual size the library insists on the exact one.
    return libdeflate_zlib_decompress(decompressor, stream.data(), stream.size(), destination.data(),
                                      destination.size(), nullptr) == LIBDEFLATE_SUCCESS;
}

struct Deflater::Compressor {
    std::unique_ptr<libdeflate_compressor, decltype(&libdeflate_free_compressor)> memory{
        libdeflate_alloc_compressor(kCompressionLevel), &libdeflate_free_compressor};
};

Deflater::Deflater() : mCompressor(std::make_unique<Compressor>()) {}
Deflater::~Deflater() = default;

std::span<const char> Deflater::deflated(std::span<const char> bytes) {
    if (bytes.size() > kMostKeptBytes) {
        return deflatedAnew(bytes);
    }
    if (const Kept* const kept = find(bytes)) {
        return kept->stream;
    }
    const std::span<const char> stream = deflatedAnew(bytes);
    Kept& kept = mKept[mOldest];
    mOldest = (mOldest + 1) % mKept.size();
    kept.bytes.clear(); // until the stream is complete, nothing is found
    kept.stream.assign(stream.begin(), stream.end());
    kept.bytes.assign(bytes.begin(), bytes.end());
    return kept.stream;
}

const Deflater::Kept* Deflater::find(std::span<const char> bytes) const {
    const auto found = std::find_if(mKept.begin(), mKept.end(), [&](const Kept& kept) {
        return kept.bytes.size() == bytes.size() && std::memcmp(kept.bytes.data(), bytes.data(), bytes.size()) == 0;
    });
    return found != mKept.end() ? &*found : nullptr;
}

std::span<const char> Deflater::deflatedAnew(std::span<const char> bytes) {
    if (bytes.empty() || !mCompressor->memory) {
        return {};
    }
    if (mMemorySize < bytes.size()) {
        mMemorySize = 0;
        mMemory = std::make_unique_for_overwrite<char[]>(bytes.size());
        mMemorySize = bytes.size();
    }
    // Zero when the stream does not fit, which is when it would not be smaller.
    const std::size_t size = libdeflate_zlib_compress(mCompressor->memory.get(), bytes.data(), bytes.size(),
                                                      mMemory.get(), bytes.size() - 1);
    return {mMemory.get(), size};
}

} // namespace detail
FBXSDK_NAMESPACE_END
