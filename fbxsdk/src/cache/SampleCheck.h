// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Validation of numbers before they are written to a point cache.
#pragma once

#include <cmath>
#include <limits>
#include <span>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Null, or why the points of a sample cannot be written, in single or double precision. NaN and infinity are refused:
/// they would spread in every program that reads the cache.
[[nodiscard]] inline const char* sampleFault(std::span<const double> points, bool asFloats) {
    constexpr auto kMostFloat = static_cast<double>(std::numeric_limits<float>::max());
    for (const double value : points) {
        if (!std::isfinite(value))
            return "a sample has points that are not finite";
        if (asFloats && std::abs(value) > kMostFloat)
            return "a sample has points outside the range of floats";
    }
    return nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
