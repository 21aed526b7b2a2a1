// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of a channel to a property of the scene: its static value, and one key per sampled frame.
#pragma once

#include "FbxSdk.h"

#include "access/FrameTimes.h"
#include "calls/MemoryLimit.h"

namespace Tarnell::Fbx::detail {

/// The channel's static value, and a linear key for every frame of its range. False without a curve or channel, and
/// without keys when they are too many for the account.
bool writeCurve(fbxsdk::FbxAnimCurve* curve, const TnFbxChannel* channel, float scale, FrameTimes& times,
                MemoryAccount& memory);

/// Writes channels into properties, with their keys on one layer.
class ChannelWriter {
public:
    /// Without a layer only static values are written.
    ChannelWriter(fbxsdk::FbxAnimLayer* layer, FrameTimes& times, MemoryAccount& memory)
        : mLayer(layer), mTimes(times), mMemory(memory) {}

    /// The curve of one component of a property, or of a scalar property when `component` is null. A property
    /// that holds no number has none.
    void key(fbxsdk::FbxProperty property, const char* component, TnFbxChannel* channel, float scale = 1.0f) {
        if (fbxsdk::FbxAnimCurve* curve = property.GetCurve(mLayer, property.GetName(), component, true))
            writeCurve(curve, channel, scale, mTimes, mMemory);
    }

    /// Value and curve of a scalar property; no effect without a channel.
    void write(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property, TnFbxChannel* channel) {
        if (channel != nullptr) {
            property.Set(static_cast<double>(channel->getValue()));
            key(property, nullptr, channel);
        }
    }

private:
    fbxsdk::FbxAnimLayer* mLayer;
    FrameTimes& mTimes;
    MemoryAccount& mMemory;
};

} // namespace Tarnell::Fbx::detail
