// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading numbers from unaligned bytes of either byte order.
#pragma once

#include <bit>
#include <cstdint>
#include <cstring>
#include <type_traits>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The unsigned whole number of the same size.
template <class Number>
using BitsOf =
    std::conditional_t<sizeof(Number) == 1, std::uint8_t,
                       std::conditional_t<sizeof(Number) == 2, std::uint16_t,
                                          std::conditional_t<sizeof(Number) == 4, std::uint32_t, std::uint64_t>>>;

template <class Bits>
[[nodiscard]] constexpr Bits swapBytes(Bits bits) {
    static_assert(std::is_unsigned_v<Bits>);
    if constexpr (sizeof(Bits) == 2)
        return __builtin_bswap16(bits);
    else if constexpr (sizeof(Bits) == 4)
        return __builtin_bswap32(bits);
    else if constexpr (sizeof(Bits) == 8)
        return __builtin_bswap64(bits);
    else
        return bits;
}

/// Whether bytes of that order have to be swapped on this machine.
[[nodiscard]] constexpr bool needsSwap(bool bigEndian) {
    return bigEndian != (std::endian::native == std::endian::big);
}

template <class Number>
[[nodiscard]] Number loadNumber(const char* bytes, bool swap) {
    BitsOf<Number> bits;
    std::memcpy(&bits, bytes, sizeof bits);
    return std::bit_cast<Number>(swap ? swapBytes(bits) : bits);
}

} // namespace detail
FBXSDK_NAMESPACE_END
