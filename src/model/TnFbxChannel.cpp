// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Samples at whole frames: how a range grows, and how it is evaluated in between.
//
// Spans of frames are computed in 64 bits, so that ranges may reach from the lowest int to the highest.
#include "TnFbxChannel.h"

#include "FrameArithmetic.h"

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <utility>

namespace Tarnell::Fbx {

namespace {

/// How close to a whole frame, in frames, still counts as that frame.
constexpr float kExactFrameTolerance = 1e-4f;

/// The frame held inside the range. NaN passes both tests.
float clampToRange(float frame, const TnFbxTime& time) {
    const float start = static_cast<float>(time.getStartFrame());
    const float end = static_cast<float>(time.getEndFrame());
    if (start > frame) {
        return start;
    }
    return frame > end ? end : frame;
}

/// Whether the range and so many values make samples.
bool areSamples(const TnFbxTime& time, std::size_t valueCount) {
    if (time.getStartFrame() > time.getEndFrame() || valueCount == 0 || time.getFrameRate() <= 0.0f) {
        return false; // kept: a rate of NaN passes
    }
    return detail::frameCount(time.getStartFrame(), time.getEndFrame()) <= static_cast<std::int64_t>(valueCount);
}

} // namespace

TnFbxChannel::TnFbxChannel() { initChannel(); }

TnFbxChannel::~TnFbxChannel() { deleteChannel(); }

TnFbxChannel& TnFbxChannel::operator=(const TnFbxChannel& other) {
    if (this != &other) {
        mValues = other.mValues;
        mAnimated = other.mAnimated;
        mTime = other.mTime;
        mValue = other.mValue;
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
    coverFrame(wholeFrame);
    mValues[static_cast<std::size_t>(std::int64_t{wholeFrame} - mTime.getStartFrame())] = value;
    mAnimated = true;
    return true;
}

// Widens the range to include a frame:
//
//     10 . . 13          before: samples of frames 10 to 13
//     10 . . 13 0 0 16   covering 16 appends three, covering 7 inserts three in front
//
// kept: the new samples are 0, neither the static value nor the neighbour
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
        // values beyond the range, as setAnimatedValues accepts them, belong to no frame and stay out of the new ones
        mValues.resize(static_cast<std::size_t>(end - start + 1));
        mValues.resize(static_cast<std::size_t>(frame - start + 1), 0.0f);
        mTime.setEndFrame(frame);
    }
}

bool TnFbxChannel::setAnimatedValues(TnFbxTime time, const std::vector<float>& values) {
    if (!areSamples(time, values.size())) {
        return false;
    }
    mValues = values;
    mTime = time;
    mAnimated = true;
    return true;
}

bool TnFbxChannel::setAnimatedValues(TnFbxTime time, std::vector<float>&& values) {
    if (!areSamples(time, values.size())) {
        return false;
    }
    mValues = std::move(values);
    mTime = time;
    mAnimated = true;
    return true;
}

// The animated flag plays no part here: a channel without samples is what counts as static.
float TnFbxChannel::getAnimatedValue(float frame) const {
    if (mValues.empty() || std::isnan(frame)) { // NaN is a frame outside every range
        return mValue;
    }
    const float clamped = clampToRange(frame, mTime);
    const int whole = detail::truncateToInt(clamped); // kept: toward zero, so frame −4.5 starts from −4
    const std::int64_t index = std::int64_t{whole} - mTime.getStartFrame();
    const std::int64_t count = static_cast<std::int64_t>(mValues.size());
    if (index < 0 || index >= count) {
        return mValue; // beyond 2^24 the float of the last frame can lie after the frame itself
    }

    const float sample = mValues[static_cast<std::size_t>(index)];
    const float wholeFrame = static_cast<float>(whole);
    if (std::fabs(wholeFrame - clamped) < kExactFrameTolerance || index + 1 >= count) {
        return sample;
    }
    const float next = mValues[static_cast<std::size_t>(index + 1)];
    return sample + (clamped - wholeFrame) * (next - sample);
}

bool TnFbxChannel::getAnimated() const { return mAnimated; }

TnFbxTime TnFbxChannel::getTime() const { return mTime; }

} // namespace Tarnell::Fbx
