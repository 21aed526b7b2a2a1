// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The samples of one call, as part of the memory of its results.
#pragma once

#include "SampleRange.h"

#include "calls/MemoryLimit.h"

#include <cstdint>
#include <string>

namespace Tarnell::Fbx::detail {

/// Reserves the memory of samples before they are made, and records the frames that were requested.
///
/// Constant samples take none. Whether they are constant is known only after evaluation; so a node that may be animated
/// reserves one channel before the first frame and returns it if it is constant. The total returned in a call is
/// bounded, too: evaluation takes time where it takes no memory.
class SampleAccount {
public:
    explicit SampleAccount(MemoryAccount& memory) : mMemory(memory) {}

    /// Clears the frames of the call before.
    void begin() {
        mFrames = {};
        mGivenBack = 0;
    }

    /// False when the samples of that many channels over the frames exceed the limit.
    bool take(const SampleRange& frames, float rate, std::uint64_t channelCount) {
        mFrames.include(frames.first, frames.last);
        mRate = rate;
        return mMemory.take(bytesOf(frames) * channelCount);
    }

    bool exceeded() const { return mMemory.exceeded(); }

    /// The samples of one channel that takes no memory after all.
    void giveBack(const SampleRange& frames) {
        const std::uint64_t bytes = bytesOf(frames);
        if (bytes <= mMemory.limit() - mGivenBack) {
            mGivenBack += bytes;
            mMemory.giveBack(bytes);
        }
    }

    /// "frames 0 to 239 at 24 frames per second: ", or nothing when no samples were requested.
    std::string describe() const;

private:
    static std::uint64_t bytesOf(const SampleRange& frames) {
        return static_cast<std::uint64_t>(frameCount(frames.first, frames.last)) * sizeof(float);
    }

    MemoryAccount& mMemory;
    std::uint64_t mGivenBack = 0;
    SampleRange mFrames; // all that were requested
    float mRate = 0.0f;
};

} // namespace Tarnell::Fbx::detail
