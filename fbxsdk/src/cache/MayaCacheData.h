// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data files of Maya caches, which are trees of tagged chunks, big-endian:
//
//   FOR4 size CACH { VRSN STIM ETIM }      FOR8 …    once
//   FOR4 size MYCH { [TIME] (CHNM SIZE data)… }      once per sample time; TIME only where one file holds all samples
//
// In FOR4 files a chunk is tag, 32-bit size, payload padded to 4 bytes; in FOR8 files tag, 4 unused bytes, 64-bit size,
// payload padded to 8.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Bytes of the longest channel name that can be written; far longer than names of objects are.
inline constexpr std::size_t kMostMayaChannelName = std::size_t{1} << 20;

/// The numbers of one channel at one time.
class FileBytes;

struct MayaCacheBlock {
    std::string_view channel;
    std::uint64_t elementCount = 0; ///< points of a vector array
    int componentCount = 3;
    bool doubles = true;
    std::span<const char> bytes;
};

/// One sample time with all its channels.
struct MayaCacheFrame {
    bool hasTime = false;
    std::int32_t ticks = 0;
    std::vector<MayaCacheBlock> blocks;
};

struct MayaCacheData {
    std::vector<MayaCacheFrame> frames;
    /// The offset at which the file is truncated or damaged; its size when it is valid.
    std::size_t end = 0;
};
/// Parses a data file into its frames. Zeros after the last one are no damage. Where the bytes are those of a file,
/// they are fetched, except the numbers. Throws FileFault.
[[nodiscard]] MayaCacheData parseMayaCacheData(std::span<const char> bytes, const FileBytes* file = nullptr);

/// Reads the first points of a block, widened to double or narrowed to float. False when the block is no vector array
/// or has another number of points. Throws FileFault.
[[nodiscard]] bool readMayaCacheBlock(const MayaCacheBlock& block, std::span<double> destination,
                                      const FileBytes* file = nullptr);

/// The bytes of the opening CACH group, and of one MYCH group. `ticks` is null in files of a single sample.
[[nodiscard]] std::string mayaCacheHeader(bool wide, std::int32_t start, std::int32_t end);
struct MayaCacheWriteBlock {
    std::string_view channel;
    std::span<const double> values; ///< three per point
    bool doubles = true;
};
/// Null, or why a sample of one channel does not fit the sizes of that layout.
[[nodiscard]] const char* mayaCacheSampleFault(bool wide, std::uint64_t pointCount, bool doubles);
[[nodiscard]] std::string mayaCacheFrame(bool wide, const std::int32_t* ticks,
                                         std::span<const MayaCacheWriteBlock> blocks);

} // namespace detail
FBXSDK_NAMESPACE_END
