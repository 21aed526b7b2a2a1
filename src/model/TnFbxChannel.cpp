// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Samples at whole frames: how a range grows, and how it is evaluated in between. Samples that are all equal are one
// number in the channel; changing one of them first stores them separately.
//
// Spans of frames are computed in 64 bits, so that ranges may reach from the lowest int to the highest.
#include "TnFbxChannel.h"

#include "FrameArithmetic.h"
#include "SameBits.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <utility>

namespace Tarnell::Fbx {

namespace {

/// How close to a whole frame, in frames, still counts as that frame.
constexpr float kExactFrameTolerance = 1e-4f;

/// 2^24: whole frames up to there are exact as floats.
constexpr float kFirstInexactFrame = 16777216.0f;

/// The frame clamped to the range. NaN passes both tests.
float clampToRange(float frame, const TnFbxTime& time) {
    const float start = static_cast<float>(time.getStartFrame());
    const float end = static_cast<float>(time.getEndFrame());
    if (start > frame)
        return start;
    return frame > end ? end : frame;
}

/// Whether the record is a valid range for samples.
bool isRange(const TnFbxTime& time) {
    return time.getStartFrame() <= time.getEndFrame() && !(time.getFrameRate() <= 0.0f); // kept: a rate of NaN passes
}

std::size_t framesOf(const TnFbxTime& time) {
    return static_cast<std::size_t>(detail::frameCount(time.getStartFrame(), time.getEndFrame()));
}

/// Whether the range and that many values make samples.
bool areSamples(const TnFbxTime& time, std::size_t valueCount) {
    return isRange(time) && valueCount > 0 && framesOf(time) <= valueCount;
}

/// To the bit: 0 and −0 differ, and a NaN is equal to itself.
bool areAllEqual(const std::vector<float>& values) {
    return values.size() < 2 || std::memcmp(values.data(), values.data() + 1, (values.size() - 1) * sizeof(float)) == 0;
}

} // namespace

TnFbxChannel::TnFbxChannel()
    : mAnimated(false), mCount(0), mValue(kDefaultChannelValue), mCommonValue(kDefaultChannelValue) {}

TnFbxChannel::~TnFbxChannel() = default;

TnFbxChannel& TnFbxChannel::operator=(const TnFbxChannel& other) {
    if (this != &other) {
        mValues = other.mValues;
        mCount = other.mCount;
        mAnimated = other.mAnimated;
        mTime = other.mTime;
        mValue = other.mValue;
        mCommonValue = other.mCommonValue;
    }
    return *this;
}

bool TnFbxChannel::initChannel() { return initChannel(kDefaultChannelValue); }

bool TnFbxChannel::initChannel(float value) {
    mValue = value;
    mTime.initTime();
    return deleteAnimatedValues();
}

bool TnFbxChannel::deleteChannel() { return initChannel(); }

bool TnFbxChannel::deleteAnimatedValues() {
    mValues.clear();
    mCount = 0;
    mAnimated = false;
    return true;
}

bool TnFbxChannel::setValue(float value) {
    mValue = value;
    return true;
}

float TnFbxChannel::getValue() const { return mValue; }

bool TnFbxChannel::setValueAt(float frame, float value) {
    const int wholeFrame = detail::truncateToInt(frame);
    const bool isCovered = mCount > 0 && wholeFrame >= mTime.getStartFrame() && wholeFrame <= mTime.getEndFrame();
    if (isCovered && detail::haveSameBits(sampleAt(indexOf(wholeFrame)), value)) {
        mAnimated = true;
        return true;
    }
    const std::size_t stored = mCount > 0 ? std::max(mValues.size(), std::size_t{1}) : 0;
    if (countToCover(wholeFrame) > stored + kMostAddedSamples)
        return false;
    spread();
    coverFrame(wholeFrame);
    mValues[indexOf(wholeFrame)] = value;
    mAnimated = true;
    return true;
}

std::size_t TnFbxChannel::indexOf(int frame) const {
    return static_cast<std::size_t>(std::int64_t{frame} - mTime.getStartFrame());
}

/// How many samples there are once the range includes the frame.
std::size_t TnFbxChannel::countToCover(int frame) const {
    if (mCount == 0)
        return 1;
    const int start = mTime.getStartFrame();
    const int end = mTime.getEndFrame();
    if (frame < start)
        return mCount + static_cast<std::size_t>(std::int64_t{start} - frame);
    return frame > end ? static_cast<std::size_t>(detail::frameCount(start, frame)) : mCount;
}

/// Stores every sample separately.
void TnFbxChannel::spread() {
    if (mValues.empty())
        mValues.assign(mCount, mCommonValue);
}

// Widens the range to include a frame:
//
//     10 . . 13          before: samples of frames 10 to 13
//     10 . . 13 0 0 16   covering 16 appends three, covering 7 inserts three in front
//
// kept: the new samples are 0, neither the static value nor the adjacent sample
void TnFbxChannel::coverFrame(int frame) {
    const std::int64_t start = mTime.getStartFrame();
    const std::int64_t end = mTime.getEndFrame();

    if (mValues.empty()) {
        mValues.resize(1);
        mTime.setStartFrame(frame);
        mTime.setEndFrame(frame);
    } else if (frame < start) {
        mValues.insert(mValues.begin(), static_cast<std::size_t>(start - frame), 0.0f);
        mTime.setStartFrame(frame);
    } else if (frame > end) {
        // values beyond the range, as setAnimatedValues accepts them, belong to no frame and do not become samples
        mValues.resize(static_cast<std::size_t>(end - start + 1));
        mValues.resize(static_cast<std::size_t>(frame - start + 1), 0.0f);
        mTime.setEndFrame(frame);
    }
    mCount = mValues.size();
}

bool TnFbxChannel::setAnimatedValues(TnFbxTime time, const std::vector<float>& values) {
    if (!areSamples(time, values.size()))
        return false;
    if (areAllEqual(values)) {
        mCommonValue = values.front();
        mValues.clear();
    } else {
        mValues = values;
    }
    takeOver(time, values.size());
    return true;
}

bool TnFbxChannel::moveAnimatedValues(TnFbxTime time, std::vector<float>&& values) {
    if (!areSamples(time, values.size()))
        return false;
    const std::size_t count = values.size();
    if (areAllEqual(values)) {
        mCommonValue = values.front();
        mValues = {};
    } else {
        mValues = std::move(values);
    }
    takeOver(time, count);
    return true;
}

bool TnFbxChannel::setConstantValues(TnFbxTime time, float value) {
    if (!isRange(time))
        return false;
    mCommonValue = value;
    mValues = {};
    takeOver(time, framesOf(time));
    return true;
}

void TnFbxChannel::takeOver(const TnFbxTime& time, std::size_t count) {
    mCount = count;
    mTime = time;
    mAnimated = true;
}

// The animated flag has no effect here: a channel without samples counts as static.
float TnFbxChannel::getAnimatedValue(float frame) const {
    if (mCount == 0 || std::isnan(frame)) // NaN is a frame outside every range
        return mValue;
    const auto count = static_cast<std::int64_t>(mCount);
    if (std::fabs(frame) < kFirstInexactFrame) { // most requests are for a whole frame of the range
        const int exact = static_cast<int>(frame);
        const std::int64_t index = std::int64_t{exact} - mTime.getStartFrame();
        if (static_cast<float>(exact) == frame && index >= 0 && index < count && exact <= mTime.getEndFrame())
            return sampleAt(static_cast<std::size_t>(index));
    }
    const float clamped = clampToRange(frame, mTime);
    const int whole = detail::truncateToInt(clamped); // kept: toward zero, so frame −4.5 starts from −4
    const std::int64_t index = std::int64_t{whole} - mTime.getStartFrame();
    if (index < 0 || index >= count)
        return mValue; // beyond 2^24 the float of the last frame can lie after the frame itself

    const float sample = sampleAt(static_cast<std::size_t>(index));
    const float wholeFrame = static_cast<float>(whole);
    if (std::fabs(wholeFrame - clamped) < kExactFrameTolerance || index + 1 >= count)
        return sample;
    const float next = sampleAt(static_cast<std::size_t>(index + 1));
    return sample + (clamped - wholeFrame) * (next - sample);
}

void TnFbxChannel::getAnimatedValues(int firstFrame, std::size_t count, float* values) const {
    constexpr auto kFirstInexact = static_cast<std::int64_t>(kFirstInexactFrame);
    const std::int64_t index = std::int64_t{firstFrame} - mTime.getStartFrame();
    const std::int64_t end = std::int64_t{firstFrame} + static_cast<std::int64_t>(count);
    const bool areSamples = index >= 0 && end - mTime.getStartFrame() <= static_cast<std::int64_t>(mCount) &&
                            end <= std::int64_t{mTime.getEndFrame()} + 1 && firstFrame > -kFirstInexact &&
                            end <= kFirstInexact;
    if (!areSamples)
        for (std::int64_t frame = firstFrame; frame < end; ++frame)
            *values++ = getAnimatedValue(static_cast<float>(frame));
    else if (mValues.empty())
        std::fill_n(values, count, mCommonValue);
    else
        std::copy_n(mValues.begin() + index, count, values);
}

bool TnFbxChannel::getAnimated() const { return mAnimated; }

TnFbxTime TnFbxChannel::getTime() const { return mTime; }

bool TnFbxChannel::isConstant() const { return mValues.size() < 2; }

} // namespace Tarnell::Fbx
