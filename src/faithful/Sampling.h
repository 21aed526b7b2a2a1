// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From values that can be worked out at any time to channels: a static value, and samples where they differ.
#pragma once

#include "Scene.h"

#include "TnFbxTransform.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <utility>
#include <vector>

namespace Tarnell::Fbx::faithful {

using TransformChannel = TnFbxTransform::EFbxTransformChannelType;

/// Rounds to the nearest float; what is too large becomes infinite, as IEEE 754 has it.
inline float toFloat(double value) { return static_cast<float>(value); }

inline void setStatic(TnFbxTransform& object, TransformChannel channel, float value) {
    object.setTransformValue(channel, value);
}
template <class Object, class Channel>
void setStatic(Object& object, Channel channel, float value) {
    object.setValue(channel, value);
}

inline void setSamples(TnFbxTransform& object, TransformChannel channel, const TnFbxTime& time,
                       std::vector<float>&& samples) {
    object.setTransformValueAt(channel, time, std::move(samples));
}
template <class Object, class Channel>
void setSamples(Object& object, Channel channel, const TnFbxTime& time, std::vector<float>&& samples) {
    object.setValueAt(channel, time, std::move(samples));
}

/// Samples that are all alike are no animation.
template <class Object, class Channel>
void setSamplesThatDiffer(Object& object, Channel channel, const TnFbxTime& time, std::vector<float>&& samples) {
    if (std::adjacent_find(samples.begin(), samples.end(), std::not_equal_to<>()) != samples.end()) {
        setSamples(object, channel, time, std::move(samples));
    }
}

/// Fills some consecutive channels, from the first one on: `valuesAt(time)` gives an array of their values. False, with
/// the reason noted, when there is no room for the samples.
template <std::size_t kCount, class Object, class Channel, class ValuesAt>
bool fillChannels(Scene& scene, bool animated, Object& object, Channel firstChannel, ValuesAt&& valuesAt) {
    const auto channelAt = [firstChannel](std::size_t i) {
        return static_cast<Channel>(static_cast<int>(firstChannel) + static_cast<int>(i));
    };
    const std::array<double, kCount> now = valuesAt(scene.now());
    for (std::size_t i = 0; i < kCount; ++i) {
        setStatic(object, channelAt(i), toFloat(now[i]));
    }
    if (!animated) {
        return true;
    }
    if (!scene.grantSamples(static_cast<std::int64_t>(kCount))) {
        return false;
    }
    const Timeline& timeline = scene.timeline();
    std::array<std::vector<float>, kCount> samples;
    for (std::vector<float>& channel : samples) {
        channel.reserve(static_cast<std::size_t>(timeline.count()));
    }
    for (std::int64_t frame = timeline.first(); frame <= timeline.last(); ++frame) {
        const std::array<double, kCount> values = valuesAt(timeline.at(static_cast<double>(frame)));
        for (std::size_t i = 0; i < kCount; ++i) {
            samples[i].push_back(toFloat(values[i]));
        }
    }
    for (std::size_t i = 0; i < kCount; ++i) {
        setSamplesThatDiffer(object, channelAt(i), timeline.record(scene.frame()), std::move(samples[i]));
    }
    return true;
}

} // namespace Tarnell::Fbx::faithful
