// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of values that can be computed at any time to channels: a static value, and samples where they differ.
#pragma once

#include "Scene.h"

#include "TnFbxTransform.h"
#include "access/FrameTimes.h"
#include "access/SampleRun.h"
#include "access/ToFloat.h"

#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <span>

namespace Tarnell::Fbx::faithful {

using TransformChannel = TnFbxTransform::EFbxTransformChannelType;

using detail::toFloat;

/// The values of some channels at some frames.
template <std::size_t kCount>
class Columns {
public:
    template <class Values>
    void add(const Values& values) {
        for (std::size_t i = 0; i < kCount; ++i)
            mValues[i][mSize] = sampleOf(toFloat(values[i]));
        ++mSize;
    }
    const float* operator[](std::size_t i) const { return mValues[i].data(); }
    std::size_t size() const { return mSize; }

private:
    /// Zero and minus zero are equal, and so is everything that is not a number: the sign of that depends on the
    /// compiler.
    static float sampleOf(float value) {
        return std::isnan(value) ? std::numeric_limits<float>::quiet_NaN() : value + 0.0f;
    }

    std::array<std::array<float, detail::kMostTogether>, kCount> mValues;
    std::size_t mSize = 0; // at most kMostTogether
};

inline void setStatic(TnFbxTransform& object, TransformChannel channel, float value) {
    object.setTransformValue(channel, value);
}
template <class Object, class Channel>
void setStatic(Object& object, Channel channel, float value) {
    object.setValue(channel, value);
}

/// The samples of all channels under construction. Only those that change take memory for each frame.
template <std::size_t kCount>
class Runs {
public:
    explicit Runs(Scene& scene) : mScene(scene) {
        for (detail::SampleRun& run : mRuns)
            run.begin(static_cast<std::size_t>(scene.timeline().count()));
    }

    /// False, with the reason noted, when there is not enough memory.
    bool add(const Columns<kCount>& columns) {
        for (std::size_t i = 0; i < kCount && columns.size() > 0; ++i) {
            if (mRuns[i].spreadsWith(columns[i], columns.size()) && !mScene.grantSamples(1))
                return false;
            mRuns[i].add(columns[i], columns.size());
        }
        return true;
    }

    detail::SampleRun& operator[](std::size_t i) { return mRuns[i]; }

private:
    Scene& mScene;
    std::array<detail::SampleRun, kCount> mRuns;
};

/// Fills some consecutive channels, from the first one on: `valuesAt(time)` gives an array of their values. False, with
/// the reason noted, when there is not enough memory for the samples.
template <std::size_t kCount, class Object, class Channel, class ValuesAt>
bool fillChannels(Scene& scene, bool animated, Object& object, Channel firstChannel, ValuesAt&& valuesAt) {
    const auto channelAt = [firstChannel](std::size_t i) {
        return static_cast<Channel>(static_cast<int>(firstChannel) + static_cast<int>(i));
    };
    const std::array<double, kCount> now = valuesAt(scene.now());
    for (std::size_t i = 0; i < kCount; ++i)
        setStatic(object, channelAt(i), toFloat(now[i]));
    if (!animated)
        return true;
    if (!scene.grantSamples(0))
        return false;
    Runs<kCount> samples(scene);
    const auto addPortion = [&](std::int64_t /*frame*/, std::span<const fbxsdk::FbxTime> times) {
        Columns<kCount> columns;
        for (const fbxsdk::FbxTime& time : times)
            columns.add(valuesAt(time));
        return samples.add(columns);
    };
    if (!scene.inPortions(addPortion))
        return false;
    for (std::size_t i = 0; i < kCount; ++i)
        if (!samples[i].isOneValue()) // samples that are all equal are no animation
            object.moveValuesAt(channelAt(i), scene.timeline().record(scene.frame()), samples[i].takeAll());
    return true;
}

} // namespace Tarnell::Fbx::faithful
