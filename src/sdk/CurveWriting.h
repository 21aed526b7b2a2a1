// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From a channel to a property of the scene: its static value, and one key per sampled frame.
#pragma once

#include "FbxSdk.h"

#include <cstdint>
#include <vector>

namespace Tarnell::Fbx::detail {

/// The moments of a channel's frames. Most channels of an object have the same ones: they are worked out once.
class KeyTimes {
public:
    void begin(const TnFbxTime& range);
    /// Frames are asked for in order, from the first one of the range on.
    fbxsdk::FbxTime at(std::int64_t frame);

private:
    std::int64_t mFirstFrame = 0;
    double mRate = 0.0;
    std::vector<fbxsdk::FbxTime> mTimes; // of the first frames
};

/// The channel's static value, and a linear key for every frame of its range. False without a curve or channel.
bool writeCurve(fbxsdk::FbxAnimCurve* curve, const TnFbxChannel* channel, float scale, KeyTimes& times);

/// Writes channels into properties, with their keys on one layer.
class ChannelWriter {
public:
    /// Without a layer only static values are written.
    explicit ChannelWriter(fbxsdk::FbxAnimLayer* layer) : mLayer(layer) {}

    /// The curve of one component of a property, or of a scalar property when `component` is null. A property that
    /// cannot be animated has none.
    void key(fbxsdk::FbxProperty property, const char* component, TnFbxChannel* channel, float scale = 1.0f) {
        if (fbxsdk::FbxAnimCurve* curve = property.GetCurve(mLayer, property.GetName(), component, true)) {
            writeCurve(curve, channel, scale, mTimes);
        }
    }

    /// Value and curve of a scalar property; nothing without a channel.
    void write(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property, TnFbxChannel* channel) {
        if (channel != nullptr) {
            property.Set(static_cast<double>(channel->getValue()));
            key(property, nullptr, channel);
        }
    }

private:
    fbxsdk::FbxAnimLayer* mLayer;
    KeyTimes mTimes;
};

} // namespace Tarnell::Fbx::detail
