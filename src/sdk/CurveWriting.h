// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From a channel to a property of the scene: its static value, and one key per sampled frame.
#pragma once

#include "FbxSdk.h"

namespace Tarnell::Fbx::detail {

/// Writes channels into properties, with their keys on one layer.
class ChannelWriter {
public:
    /// Without a layer only static values are written.
    ChannelWriter(const FbxSdk& sdk, fbxsdk::FbxAnimLayer* layer) : mSdk(sdk), mLayer(layer) {}

    /// The curve of one component of a property, or of a scalar property when `component` is null. A property that
    /// cannot be animated has none.
    void key(fbxsdk::FbxProperty property, const char* component, TnFbxChannel* channel, float scale = 1.0f) const {
        if (fbxsdk::FbxAnimCurve* curve = property.GetCurve(mLayer, property.GetName(), component, true)) {
            mSdk.setCurveValues(curve, channel, scale);
        }
    }

    /// Value and curve of a scalar property; nothing without a channel.
    void write(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property, TnFbxChannel* channel) const {
        if (channel != nullptr) {
            property.Set(static_cast<double>(channel->getValue()));
            key(property, nullptr, channel);
        }
    }

private:
    const FbxSdk& mSdk;
    fbxsdk::FbxAnimLayer* mLayer;
};

} // namespace Tarnell::Fbx::detail
