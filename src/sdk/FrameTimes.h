// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// When frames are.
#pragma once

#include <fbxsdk.h>

#include <cstdint>
#include <vector>

namespace Tarnell::Fbx::detail {

/// The times of whole frames. Most channels of a scene have the same ones: they are worked out once.
class FrameTimes {
public:
    /// Of a channel whose first frame this is, at so many frames per second.
    void begin(std::int64_t firstFrame, float rate);
    /// Frames are asked for in order, from the first one on.
    fbxsdk::FbxTime at(std::int64_t frame);

private:
    std::int64_t mFirstFrame = 0;
    float mRate = 0.0f;
    std::vector<fbxsdk::FbxTime> mTimes; // of the first frames
};

} // namespace Tarnell::Fbx::detail
