// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of values that can be computed at any time to channels: a static value, and samples where they differ.
#pragma once

#include "Scene.h"

#include "TnFbxTransform.h"
#include "access/SampleRun.h"

#include <array>
#include <cstddef>

namespace Tarnell::Fbx::faithful {

using TransformChannel = TnFbxTransform::EFbxTransformChannelType;

/// Rounds to the nearest float; a value out of range becomes infinite, as in IEEE 754.
inline float toFloat(double value) { return static_cast<float>(value); }

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
    template <class Values>
    bool add(const Values& values) {
        for (std::size_t i = 0; i < kCount; ++i) {
            const float value = toFloat(values[i]) + 0.0f; // zero and minus zero are equal
            if (mRuns[i].spreadsWith(value) && !mScene.grantSamples(1))
                return false;
            mRuns[i].add(value);
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
    const Timeline& timeline = scene.timeline();
    Runs<kCount> samples(scene);
    for (std::int64_t frame = timeline.first(); frame <= timeline.last(); ++frame)
        if (!samples.add(valuesAt(timeline.at(static_cast<double>(frame)))))
            return false;
    for (std::size_t i = 0; i < kCount; ++i)
        if (!samples[i].isOneValue()) // samples that are all equal are no animation
            object.moveValuesAt(channelAt(i), timeline.record(scene.frame()), samples[i].takeAll());
    return true;
}

} // namespace Tarnell::Fbx::faithful
