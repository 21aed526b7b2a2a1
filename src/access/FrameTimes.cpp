// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "FrameTimes.h"

namespace Tarnell::Fbx {

namespace {

/// Longer ranges are computed one by one: a range may state more frames than there is memory for.
constexpr std::size_t kMostKeptTimes = std::size_t{1} << 16;

} // namespace

void detail::FrameTimes::begin(std::int64_t firstFrame, double rate) {
    if (mFirstFrame != firstFrame || mRate != rate)
        mTimes.clear();
    mFirstFrame = firstFrame;
    mRate = rate;
}

fbxsdk::FbxTime detail::FrameTimes::timeOf(std::int64_t frame) {
    fbxsdk::FbxTime time;
    time.SetSecondDouble(static_cast<double>(frame) / mRate);
    if (mTimes.size() < kMostKeptTimes)
        mTimes.push_back(time);
    return time;
}

} // namespace Tarnell::Fbx
