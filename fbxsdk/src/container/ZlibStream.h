// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The only place that knows the compression library.
#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Deflate cannot expand further than this: 258 bytes from a two-bit code.
inline constexpr std::uint64_t kMaxDeflateRatio = 1032;

/// Inflates a zlib stream (RFC 1950) into exactly the bytes of the destination.
///
/// False when the stream is corrupt or holds fewer or more bytes; the destination is then undefined.
[[nodiscard]] bool inflateExactly(std::span<const char> stream, std::span<char> destination);

/// Deflates bytes into a zlib stream. Empty when the stream would not be smaller than the bytes.
[[nodiscard]] std::vector<char> deflated(std::span<const char> bytes);

} // namespace detail
FBXSDK_NAMESPACE_END
