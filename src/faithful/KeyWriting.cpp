// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "KeyWriting.h"

#include "Rates.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

namespace Tarnell::Fbx::faithful {

namespace {

using fbxsdk::FbxTime;

constexpr const char* kComponents[] = {"X", "Y", "Z"};

FbxTime timeOf(std::int64_t frame, double rate) {
    FbxTime time;
    time.SetSecondDouble(static_cast<double>(frame) / rate);
    return time;
}

/// The keys of one curve: a straight line needs its two ends, and constant values are the only line whose
/// samples are exact.
class LinearKeys {
public:
    LinearKeys(fbxsdk::FbxAnimCurve& curve, double rate) : mCurve(curve), mRate(rate) { mCurve.KeyModifyBegin(); }
    ~LinearKeys() { mCurve.KeyModifyEnd(); }
    LinearKeys(const LinearKeys&) = delete;
    LinearKeys& operator=(const LinearKeys&) = delete;

    void add(std::int64_t frame, float value) {
        const bool same = mAny && !(value < mValue) && !(value > mValue);
        if (!same) {
            holdLast();
            set(frame, value);
        }
        mFrame = frame;
        mValue = value;
        mAny = true;
    }

    /// To be called at the end.
    void holdLast() {
        if (mAny && mFrame != mKeyed)
            set(mFrame, mValue);
    }

private:
    void set(std::int64_t frame, float value) {
        const FbxTime time = timeOf(frame, mRate);
        mCurve.KeySet(mCurve.KeyAdd(time), time, value, fbxsdk::FbxAnimCurveDef::eInterpolationLinear);
        mKeyed = frame;
    }

    fbxsdk::FbxAnimCurve& mCurve;
    double mRate;
    bool mAny = false;
    std::int64_t mFrame = 0, mKeyed = 0;
    float mValue = 0.0f;
};

/// Rates may differ arbitrarily.
std::int64_t wholeFrame(double frame) {
    constexpr double kFarthest = 1e15;
    return static_cast<std::int64_t>(std::clamp(frame, -kFarthest, kFarthest));
}

/// The memory of a frame in which several channels have a key: three curves with a time and a value each.
constexpr std::uint64_t kFrameBytes = 48;

double sampleOf(const TnFbxChannel& channel, std::int64_t frame) {
    return static_cast<double>(channel.getAnimatedValue(static_cast<float>(frame)));
}

} // namespace

bool changes(const TnFbxChannel& channel) { return channel.getAnimated() && !channel.isConstant(); }

double staticValue(const TnFbxChannel& channel) {
    return channel.getAnimated() && channel.isConstant() ? sampleOf(channel, channel.getTime().getStartFrame())
                                                         : static_cast<double>(channel.getValue());
}

FrameRange KeyWriter::rangeOf(const TnFbxChannel& channel) const {
    const TnFbxTime time = channel.getTime();
    const double rate = exactRate(time.getFrameRate()).rate;
    return {time.getStartFrame(), time.getEndFrame(), isRate(rate) ? rate : mRate};
}

FrameRange KeyWriter::rangeOf(const std::vector<const TnFbxChannel*>& channels) {
    FrameRange common{0, 0, mRate};
    bool any = false;
    for (const TnFbxChannel* channel : channels) {
        if (!changes(*channel))
            continue;
        const FrameRange range = rangeOf(*channel);
        if (!any) {
            common = range;
            any = true;
            continue;
        }
        const double ratio = common.rate / range.rate;
        common.first = std::min(common.first, wholeFrame(std::floor(static_cast<double>(range.first) * ratio)));
        common.last = std::max(common.last, wholeFrame(std::ceil(static_cast<double>(range.last) * ratio)));
    }
    const bool isGranted = mMemory.take(static_cast<std::uint64_t>(common.count()) * kFrameBytes);
    return isGranted ? common : FrameRange{common.first, common.first, common.rate};
}

double KeyWriter::valueAt(const TnFbxChannel& channel, std::int64_t frame, const FrameRange& range) const {
    if (!changes(channel))
        return staticValue(channel);
    const double ratio = rangeOf(channel).rate / range.rate;
    return static_cast<double>(channel.getAnimatedValue(static_cast<float>(static_cast<double>(frame) * ratio)));
}

void KeyWriter::extendSpan(const FrameRange& range) {
    mSpan.add(static_cast<double>(range.first) / range.rate);
    mSpan.add(static_cast<double>(range.last) / range.rate);
}

void KeyWriter::writeKeys(fbxsdk::FbxProperty property, const char* component, const FrameRange& range,
                          const ValueAt& valueAt) {
    const auto first = static_cast<float>(valueAt(range.first));
    std::int64_t next = range.first + 1;
    const auto isFirst = [&](float value) { return !(value < first) && !(value > first); };
    while (next <= range.last && isFirst(static_cast<float>(valueAt(next))))
        ++next;
    if (next > range.last)
        return;
    extendSpan(range);
    fbxsdk::FbxAnimCurve* curve = property.GetCurve(&mLayer, property.GetName(), component, /*pCreate*/ true);
    if (curve == nullptr)
        return;
    LinearKeys keys(*curve, range.rate);
    for (std::int64_t frame = range.first; frame <= range.last; ++frame)
        keys.add(frame, static_cast<float>(valueAt(frame)));
    keys.holdLast();
}

void KeyWriter::writeKeys(fbxsdk::FbxProperty property, const char* component, const TnFbxChannel& channel,
                          double factor) {
    if (!channel.getAnimated())
        return;
    if (!changes(channel)) { // its frames belong to the animation all the same
        extendSpan(rangeOf(channel));
        return;
    }
    writeKeys(property, component, rangeOf(channel),
              [&channel, factor](std::int64_t frame) { return sampleOf(channel, frame) * factor; });
}

void KeyWriter::write(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property, const TnFbxChannel& channel, double factor) {
    property.Set(staticValue(channel) * factor);
    writeKeys(property, nullptr, channel, factor);
}

void KeyWriter::write(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property, const Channels3& channels) {
    fbxsdk::FbxDouble3 values;
    for (std::size_t i = 0; i < 3; ++i)
        values[static_cast<int>(i)] = staticValue(*channels[i]);
    property.Set(values); // before the keys: it is the value of components without any
    for (std::size_t i = 0; i < 3; ++i)
        writeKeys(property, kComponents[i], *channels[i], 1.0);
}

} // namespace Tarnell::Fbx::faithful
