// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The samples of one channel under construction: stored as one as long as they are all equal.
#pragma once

#include "TnFbxChannel.h"
#include "TnFbxTime.h"
#include "model/SameBits.h"

#include <cstddef>
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

    /// Whether adding the value ends the single-sample form: from then on each takes memory.
    bool spreadsWith(float value) const { return mValues.empty() && mCount > 0 && !haveSameBits(value, mFirst); }

    void add(float value) {
        if (mCount == 0) {
            mFirst = value;
        } else if (!mValues.empty()) {
            mValues.push_back(value);
        } else if (spreadsWith(value)) {
            mValues.reserve(mTotal);
            mValues.assign(mCount, mFirst);
            mValues.push_back(value);
        }
        ++mCount;
    }

    /// As many values.
    void add(const float* values, std::size_t count) {
        std::size_t done = 0;
        while (done < count && mValues.empty())
            add(values[done++]);
        mValues.insert(mValues.end(), values + done, values + count);
        mCount += count - done;
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
    std::vector<float> mValues; // empty while all are equal to the first
    float mFirst = 0.0f;
    std::size_t mCount = 0;
    std::size_t mTotal = 0;
};

} // namespace Tarnell::Fbx::detail
