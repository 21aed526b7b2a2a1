// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The samples of one channel under construction: stored as one as long as they are all equal.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxTime.h"

#include <bit>
#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::detail {

/// One sample per frame, from the first frame on.
class SampleRun {
public:
    /// Removes all samples. `total`: how many samples there will be.
    void begin(std::size_t total) {
        mValues.clear();
        mCount = 0;
        mTotal = total;
    }

    /// Whether adding the values, at least one, ends the single-sample form: from then on each takes memory.
    bool spreadsWith(const float* values, std::size_t count) const {
        return mValues.empty() && !areAll(mCount > 0 ? mFirst : values[0], values, count);
    }

    void add(float value) { add(&value, 1); }
    /// As many values, at least one.
    void add(const float* values, std::size_t count) {
        const bool spreads = spreadsWith(values, count);
        if (mCount == 0)
            mFirst = values[0];
        if (spreads) {
            mValues.reserve(mTotal);
            mValues.assign(mCount, mFirst);
        }
        if (spreads || !mValues.empty())
            mValues.insert(mValues.end(), values, values + count);
        mCount += count;
    }

    /// The value at all frames.
    void setConstant(float value) {
        mValues.clear();
        mFirst = value;
        mCount = mTotal;
    }

    /// Whether all samples have been added.
    bool isComplete() const { return mCount > 0 && mCount == mTotal; }
    bool isOneValue() const { return mValues.empty(); }
    float first() const { return mFirst; } ///< of a run that is not empty

    /// Replaces every sample by a function of it.
    template <class Function>
    void transform(Function&& function) {
        mFirst = function(mFirst);
        for (float& value : mValues)
            value = function(value);
    }

    /// Stores them in a channel, which takes them over unless some are missing or the range is empty.
    bool moveInto(TnFbxChannel& channel, const TnFbxTime& time) {
        if (!isComplete())
            return false;
        return mValues.empty() ? channel.setConstantValues(time, mFirst)
                               : channel.moveAnimatedValues(time, std::move(mValues));
    }

    /// One float per frame, whether they are equal or not.
    std::vector<float> takeAll() { return mValues.empty() ? std::vector<float>(mCount, mFirst) : std::move(mValues); }

private:
    /// To the bit, as haveSameBits. Without leaving the loop early: so the values are compared several at a time.
    static bool areAll(float value, const float* values, std::size_t count) {
        const auto bits = std::bit_cast<std::uint32_t>(value);
        std::uint32_t different = 0;
        for (std::size_t i = 0; i < count; ++i)
            different |= bits ^ std::bit_cast<std::uint32_t>(values[i]);
        return different == 0;
    }

    std::vector<float> mValues; // empty while all are equal to the first
    float mFirst = 0.0f;
    std::size_t mCount = 0;
    std::size_t mTotal = 0;
};

} // namespace Tarnell::Fbx::detail
