// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The interface to the compression libraries.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <span>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Deflate cannot expand further than this: 258 bytes from a two-bit code.
inline constexpr std::uint64_t kMaxDeflateRatio = 1032;

/// Inflates a zlib stream (RFC 1950) into exactly the bytes of the destination.
///
/// False when the stream is corrupt or holds fewer or more bytes; the destination is then undefined. Throws
/// std::bad_alloc when there is no memory to inflate with.
[[nodiscard]] bool inflateExactly(std::span<const char> stream, std::span<char> destination);

/// Deflates one array after the other into zlib streams. Animation repeats itself, most of all the times of its keys:
/// an array that was deflated recently is not deflated again.
class Deflater {
public:
    Deflater();
    Deflater(const Deflater&) = delete;
    Deflater& operator=(const Deflater&) = delete;
    ~Deflater();

    /// The stream of the bytes, until the next call. Empty when it would not be smaller than the bytes.
    [[nodiscard]] std::span<const char> deflated(std::span<const char> bytes);

private:
    struct Kept {
        std::vector<char> bytes, stream;
        std::uint64_t lastUse = 0;
    };

    [[nodiscard]] Kept* find(std::span<const char> bytes);
    [[nodiscard]] std::span<const char> deflatedAnew(std::span<const char> bytes);

    struct Compressor;
    std::unique_ptr<Compressor> mCompressor;
    std::unique_ptr<char[]> mMemory; ///< of the last stream; reused, never cleared
    std::size_t mMemorySize = 0;
    std::array<Kept, 32> mKept;
    std::uint64_t mUses = 0;
};

} // namespace detail
FBXSDK_NAMESPACE_END
