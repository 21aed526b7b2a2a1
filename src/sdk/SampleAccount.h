// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The samples of one call, as part of what it hands out.
#pragma once

#include "SampleRange.h"

#include "calls/MemoryLimit.h"

#include <cstdint>
#include <string>

namespace Tarnell::Fbx::detail {

/// Asks for the memory of samples before they are made, and knows over which frames they were wanted.
///
/// Samples that do not change take none. Whether they do shows only when they are evaluated; so what may move asks for
/// one channel before the first frame and gives it back if nothing moved. All that is given back in a call is bounded,
/// too: evaluation takes time where it takes no memory.
class SampleAccount {
public:
    explicit SampleAccount(MemoryAccount& memory) : mMemory(memory) {}

    /// Forgets the frames of the call before.
    void begin() {
        mFrames = {};
        mGivenBack = 0;
    }

    /// False when the samples of so many channels over the frames go beyond the limit.
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

    /// "frames 0 to 239 at 24 frames per second: ", or nothing when no samples were asked for.
    std::string describe() const;

private:
    static std::uint64_t bytesOf(const SampleRange& frames) {
        return static_cast<std::uint64_t>(frameCount(frames.first, frames.last)) * sizeof(float);
    }

    MemoryAccount& mMemory;
    std::uint64_t mGivenBack = 0;
    SampleRange mFrames; // all that were asked for
    float mRate = 0.0f;
};

} // namespace Tarnell::Fbx::detail
