// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversions of frames between float and int that are defined for every value, unlike those of C++.
#pragma once

#include <cstdint>
#include <limits>

namespace Tarnell::Fbx::detail {

/// Truncates toward zero. A value beyond the range of an int becomes the nearest int, NaN the lowest int.
constexpr int truncateToInt(float value) {
    constexpr float kBeyondRange = 2147483648.0f; // 2^31, the first float above every int
    if (!(value >= -kBeyondRange))
        return std::numeric_limits<int>::min(); // also for NaN, which compares false with everything
    return value < kBeyondRange ? static_cast<int>(value) : std::numeric_limits<int>::max();
}

/// The number of frames from `startFrame` to `endFrame`, both included; wide enough for any two ints.
constexpr std::int64_t frameCount(int startFrame, int endFrame) { return std::int64_t{endFrame} - startFrame + 1; }

} // namespace Tarnell::Fbx::detail
