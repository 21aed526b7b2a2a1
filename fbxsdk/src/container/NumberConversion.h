// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The conversion of numbers to another type than the file stores. Every case that C++ leaves
// undefined is defined here.
#pragma once

#include <bit>
#include <cstdint>
#include <limits>
#include <type_traits>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Truncates toward zero; a value beyond the type's range becomes its end, NaN becomes 0.
template <class Integer>
[[nodiscard]] constexpr Integer truncateTo(double number) {
    // The powers of two at the ends of the range are exact doubles, the largest 64-bit number is not.
    constexpr double kBeyond = -static_cast<double>(std::numeric_limits<Integer>::min());
    if (number != number)
        return 0;
    if (number >= kBeyond)
        return std::numeric_limits<Integer>::max();
    return number <= -kBeyond ? std::numeric_limits<Integer>::min() : static_cast<Integer>(number);
}

template <class Integer>
[[nodiscard]] constexpr Integer clampTo(std::int64_t number) {
    if (number > std::numeric_limits<Integer>::max())
        return std::numeric_limits<Integer>::max();
    return number < std::numeric_limits<Integer>::min() ? std::numeric_limits<Integer>::min()
                                                        : static_cast<Integer>(number);
}

/// std::uint32_t as a destination means the bits of a 32-bit float.
///
/// A double beyond the range of float becomes infinite, as IEEE 754 has it.
template <class Destination, class Source>
[[nodiscard]] constexpr Destination convertNumber(Source number) {
    if constexpr (std::is_same_v<Destination, std::uint32_t>)
        return std::bit_cast<std::uint32_t>(static_cast<float>(number));
    else if constexpr (std::is_floating_point_v<Destination>)
        return static_cast<Destination>(number);
    else if constexpr (std::is_floating_point_v<Source>)
        return truncateTo<Destination>(static_cast<double>(number));
    else
        return clampTo<Destination>(static_cast<std::int64_t>(number));
}

} // namespace detail
FBXSDK_NAMESPACE_END
