// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The common part of tangents and evaluation: the piece of a curve between two keys.
#pragma once

#include <fbxsdk/FbxTime.h>

#include "animation/CurveEvaluation.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A segment is interpolated by its left key. Flags without an interpolation mean constant.
enum class Interpolation { constant, constantNext, linear, cubic };

[[nodiscard]] inline Interpolation interpolationOf(const CurveKeys& keys, std::size_t key) {
    const std::uint32_t flags = keys.attributesOf(key).flags;
    if ((flags & KeyFlag::cubic) != 0)
        return Interpolation::cubic;
    if ((flags & KeyFlag::linear) != 0)
        return Interpolation::linear;
    return (flags & KeyFlag::constantNext) != 0 ? Interpolation::constantNext : Interpolation::constant;
}

/// With this weight on both sides a weighted cubic is the plain Hermite one.
constexpr double kEqualWeight = 1.0 / 3.0;

/// The lengths of a key's handles as fractions of their segments, within 0.0001 to 0.99; a third when not weighted.
[[nodiscard]] double rightWeight(const CurveKeys& keys, std::size_t key);
[[nodiscard]] double leftWeight(const CurveKeys& keys, std::size_t key);

/// Ticks from one time to a later one; in 64 bits for any two times.
[[nodiscard]] inline std::uint64_t ticksBetween(std::int64_t from, std::int64_t to) {
    return static_cast<std::uint64_t>(to) - static_cast<std::uint64_t>(from);
}

[[nodiscard]] inline double secondsBetween(std::int64_t from, std::int64_t to) {
    return to > from ? static_cast<double>(ticksBetween(from, to)) / static_cast<double>(FBXSDK_TC_SECOND) : 0.0;
}

} // namespace detail
FBXSDK_NAMESPACE_END
