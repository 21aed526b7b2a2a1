// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The times of whole frames.
#pragma once

#include <fbxsdk.h>

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace Tarnell::Fbx::detail {

/// How many frames are evaluated together at most.
constexpr std::size_t kMostTogether = 256;

/// The times of whole frames. Most channels of a scene have the same ones: they are computed once.
class FrameTimes {
public:
    /// For a channel that starts at this frame, at that many frames per second.
    void begin(std::int64_t firstFrame, double rate);
    /// Frames are requested in order, from the first one on.
    fbxsdk::FbxTime at(std::int64_t frame) {
        const auto index = static_cast<std::size_t>(frame - mFirstFrame);
        return index < mTimes.size() ? mTimes[index] : timeOf(frame);
    }

    /// Calls `use(frame, times)` for as many frames from the first one on, some at a time: the first of these, and the
    /// times of all of them. False as soon as a call returns that.
    template <class Use>
    bool inPortions(std::int64_t count, Use&& use) {
        std::array<fbxsdk::FbxTime, kMostTogether> times;
        const std::int64_t end = mFirstFrame + count;
        for (std::int64_t frame = mFirstFrame; frame < end; frame += static_cast<std::int64_t>(kMostTogether)) {
            const auto size = std::min(kMostTogether, static_cast<std::size_t>(end - frame));
            for (std::size_t i = 0; i < size; ++i)
                times[i] = at(frame + static_cast<std::int64_t>(i));
            if (!use(frame, std::span<const fbxsdk::FbxTime>(times).first(size)))
                return false;
        }
        return true;
    }

private:
    fbxsdk::FbxTime timeOf(std::int64_t frame);

    std::int64_t mFirstFrame = 0;
    double mRate = 0.0;
    std::vector<fbxsdk::FbxTime> mTimes; // of the first frames
};

} // namespace Tarnell::Fbx::detail
