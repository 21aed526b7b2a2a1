// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What readers and writers of both containers share: how files begin, and the versions at which the format changed.
#pragma once

#include <cstdint>
#include <string_view>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// How binary files begin. The magic is followed by two bytes and the byte order: 0 is little-endian.
inline constexpr std::string_view kBinaryHead("Kaydara FBX Binary  \0\x1A\0", 23);
inline constexpr std::string_view kBinaryMagic = kBinaryHead.substr(0, 20);

inline constexpr std::uint32_t kOldestVersion = 3000;
inline constexpr std::uint32_t kFirstUnknownVersion = 8000;
[[nodiscard]] constexpr bool isSupportedVersion(std::uint32_t version) {
    return version >= kOldestVersion && version < kFirstUnknownVersion;
}
/// From this version on, number lists are arrays; before, they are a scalar per element.
inline constexpr std::uint32_t kFirstVersionWithArrays = 7000;
/// From this version on the packed data of keys is spelt in ASCII as whole numbers that are the bits of floats, before
/// as floats.
inline constexpr std::uint32_t kFirstVersionWithBitPatterns = 7200;
/// From this version on the offsets and counts of binary records have 64 bits.
inline constexpr std::uint32_t kFirstWideVersion = 7500;

/// Between an object's name and its class: name first in binary files, class first in ASCII ones.
inline constexpr std::string_view kBinaryNameSeparator("\0\1", 2);
inline constexpr std::string_view kAsciiNameSeparator = "::";

/// The escapes of characters in texts of ASCII files. There are no others: "&amp;" and a lone "&" represent themselves.
struct Entity {
    std::string_view spelling;
    char character;
};
inline constexpr Entity kEntities[] = {{"&quot;", '"'}, {"&lf;", '\n'}, {"&cr;", '\r'}};

} // namespace detail
FBXSDK_NAMESPACE_END
