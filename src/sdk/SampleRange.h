// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which frames an animated property is sampled over, as arithmetic on plain numbers.
#pragma once

#include "model/FrameArithmetic.h"

#include "TnFbxTime.h"

#include <algorithm>
#include <cstdint>
#include <limits>

namespace Tarnell::Fbx::detail {

/// a − b, wrapping around in 32 bits.
constexpr int wrappingSubtract(int a, int b) {
    return static_cast<int>(static_cast<std::uint32_t>(a) - static_cast<std::uint32_t>(b));
}

/// The low 32 bits of a frame count; frames that far out come from damaged files only.
constexpr int narrowFrame(std::int64_t frame) { return static_cast<int>(frame); }

/// The frame of one rate as the frame of another, in single precision, truncated toward zero.
constexpr int convertFrame(int frame, float rate, float sampleRate) {
    return truncateToInt(static_cast<float>(frame) / rate * sampleRate);
}

/// First and last frame. New ranges are empty: any frame lowers the first and raises the last.
struct SampleRange {
    int first = std::numeric_limits<int>::max();
    int last = std::numeric_limits<int>::min();

    constexpr void include(int firstFrame, int lastFrame) {
        first = std::min(first, firstFrame);
        last = std::max(last, lastFrame);
    }

    /// Whether there is more than one frame to sample.
    ///
    /// kept: the untouched range wraps to a span of 1, so a property without keys counts as sampled, with no samples;
    /// a range of 2^31 frames and more wraps to a negative span and does not.
    constexpr bool isAnimation() const { return wrappingSubtract(last, first) > 0; }
};

/// The time record of the samples of a range: their frames and their rate, which for no samples is 0.
inline TnFbxTime sampledTime(const SampleRange& range, float rate) {
    TnFbxTime time;
    time.setTime(0.0f, range.first, range.last, frameCount(range.first, range.last) > 0 ? rate : 0.0f);
    return time;
}

} // namespace Tarnell::Fbx::detail
