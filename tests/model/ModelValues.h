// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Values that the model tests build and read: time records, channel samples, numbers that are no enumerator.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxTime.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

namespace Tarnell::Fbx::test {

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr int kLowest = std::numeric_limits<int>::min();
constexpr int kHighest = std::numeric_limits<int>::max();

inline TnFbxTime timeRecord(float frame, int startFrame, int endFrame, float frameRate) {
    TnFbxTime time;
    time.setTime(frame, startFrame, endFrame, frameRate);
    return time;
}

inline TnFbxTime range(int startFrame, int endFrame) { return timeRecord(0.0f, startFrame, endFrame, 24.0f); }

inline TnFbxChannel channelOver(int startFrame, const std::vector<float>& values) {
    TnFbxChannel channel;
    channel.setAnimatedValues(range(startFrame, startFrame + static_cast<int>(values.size()) - 1), values);
    return channel;
}

/// The channel's value at every whole frame of its range.
inline std::vector<float> samplesOf(const TnFbxChannel& channel) {
    std::vector<float> samples;
    for (int frame = channel.getTime().getStartFrame(); frame <= channel.getTime().getEndFrame(); ++frame)
        samples.push_back(channel.getAnimatedValue(static_cast<float>(frame)));
    return samples;
}

inline void expectTime(const TnFbxTime& time, float frame, int startFrame, int endFrame, float frameRate) {
    EXPECT_EQ(time.getFrame(), frame);
    EXPECT_EQ(time.getStartFrame(), startFrame);
    EXPECT_EQ(time.getEndFrame(), endFrame);
    EXPECT_EQ(time.getFrameRate(), frameRate);
}

inline void expectDefaultTime(const TnFbxTime& time) { expectTime(time, 0.0f, 0, 0, 24.0f); }

} // namespace Tarnell::Fbx::test
