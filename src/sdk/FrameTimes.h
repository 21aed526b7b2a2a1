// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The times of whole frames.
#pragma once

#include <fbxsdk.h>

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Tarnell::Fbx::detail {

/// The times of whole frames. Most channels of a scene have the same ones: they are computed once.
class FrameTimes {
public:
    /// For a channel that starts at this frame, at that many frames per second.
    void begin(std::int64_t firstFrame, float rate);
    /// Frames are requested in order, from the first one on.
    fbxsdk::FbxTime at(std::int64_t frame) {
        const auto index = static_cast<std::size_t>(frame - mFirstFrame);
        return index < mTimes.size() ? mTimes[index] : timeOf(frame);
    }

private:
    fbxsdk::FbxTime timeOf(std::int64_t frame);

    std::int64_t mFirstFrame = 0;
    float mRate = 0.0f;
    std::vector<fbxsdk::FbxTime> mTimes; // of the first frames
};

} // namespace Tarnell::Fbx::detail
