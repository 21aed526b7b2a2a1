// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One animatable float property: a static value and, when animated, one sample per whole frame.
#pragma once

#include "TnFbxExport.h"
#include "TnFbxTime.h"

#include <cstddef>
#include <vector>

namespace Tarnell::Fbx {

/// A static value and a dense run of samples over a closed range of whole frames.
///
/// There are no keys, tangents or curve types: sample k belongs to frame `startFrame + k`, and adjacent samples are
/// joined by straight lines. The static value and the samples never change each other.
///
/// Samples that are all equal, to the bit, take the memory of one.
class TARNELL_FBX_API TnFbxChannel {
public:
    static constexpr float kDefaultChannelValue = 0.0f; ///< The static value of a new channel.

    /// The most samples that one `setValueAt` adds to those in memory, 2^25 (128 MiB): every whole frame that a float
    /// distinguishes from the adjacent ones lies within as many.
    static constexpr std::size_t kMostAddedSamples = std::size_t{1} << 25;

    /// Not animated, no samples, static value 0.
    TnFbxChannel();
    TnFbxChannel(const TnFbxChannel& other) = default;
    ~TnFbxChannel();
    /// Copies the samples, the time record and the static value.
    TnFbxChannel& operator=(const TnFbxChannel& other);

    /// Restores the state of a new channel, with `value` as the static value where it is given; always true.
    /// The memory of the samples is kept for the next ones.
    /// @{
    bool initChannel();
    bool initChannel(float value);
    bool deleteChannel();
    /// @}

    /// Removes the samples; the time record and the static value stay as they are. Always true.
    bool deleteAnimatedValues();

    /// Sets the static value and nothing else; always true.
    bool setValue(float value);
    float getValue() const; ///< The static value, whether or not the channel is animated.

    /// Sets the sample at one whole frame and makes the channel animated.
    ///
    /// `frame` is truncated toward zero; a value beyond the range of an int counts as the nearest int, and NaN
    /// as the lowest int. A frame outside the range widens the range up to it, and the frames in between read 0,
    /// neither an adjacent sample nor the static value. Frame and rate of the time record are not touched. False, and
    /// nothing changes, for a frame so far from the range, as NaN and infinity are from most, that more than
    /// `kMostAddedSamples` samples would be added to those in memory.
    /// Cost: memory for the whole gap; when the allocation fails the standard exception passes through and the
    /// channel is unchanged.
    bool setValueAt(float frame, float value);

    /// Replaces all samples: `values[k]` is the sample of frame `time.getStartFrame() + k`. The whole record is kept.
    ///
    /// False, and nothing changes, when the range is inverted, `values` is empty, the rate is zero or below, or there
    /// are fewer values than frames. Values beyond the range are accepted and never read. Copied values go into the
    /// memory that the channel has; `moveAnimatedValues` takes over that of the vector, which is left moved-from unless
    /// the result is false.
    /// @{
    bool setAnimatedValues(TnFbxTime time, const std::vector<float>& values);
    bool moveAnimatedValues(TnFbxTime time, std::vector<float>&& values);
    /// @}

    /// The same with one value for every frame of the range. It takes no memory; that of the previous samples is
    /// released.
    bool setConstantValues(TnFbxTime time, float value);

    /// The value at a possibly fractional frame; the static value when there are no samples.
    ///
    /// Outside the range the end samples hold. Within it the sample of the frame truncated toward zero is joined to the
    /// next one, so that a fractional frame below zero is an extrapolation from the two samples to its right.
    float getAnimatedValue(float frame) const;
    /// The same at `count` whole frames, one after the other.
    void getAnimatedValues(int firstFrame, std::size_t count, float* values) const;

    bool getAnimated() const;  ///< Whether there are samples.
    TnFbxTime getTime() const; ///< A copy of the time record.

    /// Whether the value is the same at every frame: without samples, and where all are kept as one.
    bool isConstant() const;

private:
    float sampleAt(std::size_t index) const { return mValues.empty() ? mCommonValue : mValues[index]; }
    TARNELL_FBX_LOCAL std::size_t indexOf(int frame) const;
    TARNELL_FBX_LOCAL std::size_t countToCover(int frame) const;
    TARNELL_FBX_LOCAL void takeOver(const TnFbxTime& time, std::size_t count);
    TARNELL_FBX_LOCAL void spread();
    TARNELL_FBX_LOCAL void coverFrame(int frame);

    bool mAnimated;
    TnFbxTime mTime;
    std::vector<float> mValues; // the samples; none where all of them are equal
    std::size_t mCount;         // number of samples
    float mValue;
    float mCommonValue; // of the samples that are all equal
};

} // namespace Tarnell::Fbx
