// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of an animated property of the scene to a channel: its static value, and one sample per whole frame.
#pragma once

#include "SampleAccount.h"
#include "SampleRange.h"
#include "access/FrameTimes.h"
#include "access/SampleRun.h"
#include "access/TimeModeScope.h"
#include "access/ToFloat.h"

#include "TnFbxCamera.h"
#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxTime.h"
#include "TnFbxTransform.h"

#include <fbxsdk.h>

#include <cstdint>
#include <vector>

namespace Tarnell::Fbx::detail {

/// The channel that many positions after another one in its enumeration.
template <class Channel>
constexpr Channel channelAfter(Channel channel, int offset) {
    return static_cast<Channel>(static_cast<int>(channel) + offset);
}

/// The number of an enumeration property, which in a file can be any.
inline int enumNumber(const fbxsdk::FbxProperty& property) { return property.Get<fbxsdk::FbxEnum>(); }

/// The layers of an animation stack, in order; none of a null stack.
std::vector<fbxsdk::FbxAnimLayer*> layersOf(fbxsdk::FbxAnimStack* stack);

/// The channels of a marker, which are not accessible otherwise.
struct MarkerChannels {
    static TnFbxChannel& of(TnFbxMarker& marker, TnFbxMarker::EFbxMarkerChannelType channel) {
        return marker.mChannels[static_cast<std::size_t>(channel)];
    }
};

/// A channel of an object, which must have it.
inline TnFbxChannel& channelOf(TnFbxTransform& object, TnFbxTransform::EFbxTransformChannelType channel) {
    return *object.getTransformChannel(channel);
}
inline TnFbxChannel& channelOf(TnFbxCamera& object, TnFbxCamera::EFbxCameraChannelType channel) {
    return *object.getCameraChannel(channel);
}
inline TnFbxChannel& channelOf(TnFbxLight& object, TnFbxLight::EFbxLightChannelType channel) {
    return *object.getLightChannel(channel);
}
inline TnFbxChannel& channelOf(TnFbxMarker& object, TnFbxMarker::EFbxMarkerChannelType channel) {
    return MarkerChannels::of(object, channel);
}

/// The names under which a vector's components are keyed.
inline constexpr const char* kComponents[] = {"X", "Y", "Z"};

/// All channels are read through a sampler. It looks up once what all properties of a read share (layers, time mode,
/// rate) and keeps its buffers from one property to the next.
class PropertySampler {
public:
    /// `requested` is the range to cover at least. Key frames are converted to `sampleRate` when `useSampleRate` is set
    /// and the rate above 0. `account` is shared by all samplers of a call, `frameTimes` by any.
    PropertySampler(fbxsdk::FbxScene* scene, fbxsdk::FbxAnimStack* stack, const TnFbxTime& requested,
                    bool useSampleRate, float sampleRate, SampleAccount& account, FrameTimes& frameTimes);

    /// Samples one component of a property, or a scalar property when `component` is null; `time` and `samples` hold
    /// the result until the next call.
    ///
    /// False for a range of a single frame, and when the account refuses the samples. A property without keys gives
    /// true, no samples and an inverted range, which no channel accepts.
    bool sample(const fbxsdk::FbxProperty& property, const char* component);

    const TnFbxTime& time() const { return mTime; }
    SampleRun& samples() { return mSamples; }

    /// Samples directly into a channel of an object, which stays unchanged when there is nothing to store.
    template <class Object, class Channel>
    void sampleInto(Object& object, Channel channel, const fbxsdk::FbxProperty& property,
                    const char* component = nullptr) {
        if (sample(property, component))
            mSamples.moveInto(channelOf(object, channel), mTime);
    }

    /// The three components of a vector into three consecutive channels.
    template <class Object, class Channel>
    void sampleVectorInto(Object& object, Channel firstChannel, const fbxsdk::FbxProperty& property) {
        for (int i = 0; i < 3; ++i)
            sampleInto(object, channelAfter(firstChannel, i), property, kComponents[i]);
    }

    /// Static value and samples of a scalar property.
    template <class Object, class Channel>
    void readInto(Object& object, Channel channel, const fbxsdk::FbxPropertyT<fbxsdk::FbxDouble>& property) {
        object.setValue(channel, toFloat(property.Get()));
        sampleInto(object, channel, property);
    }

    /// Static values and samples of a vector into three consecutive channels of a transform.
    void readIntoTransform(TnFbxTransform& transform, TnFbxTransform::EFbxTransformChannelType firstChannel,
                           const fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property);

private:
    TimeModeScope mTimeModeScope; // first: the scene's rate is set while it samples

    void collectCurves(const fbxsdk::FbxProperty& property, const char* component);
    SampleRange keyedRange() const;
    float valueAt(const fbxsdk::FbxTime& moment) const;
    bool isConstant() const;
    bool sampleFrames(const SampleRange& range);

    std::vector<fbxsdk::FbxAnimLayer*> mLayers;
    fbxsdk::FbxTime::EMode mTimeMode;
    float mRate; // of the scene
    TnFbxTime mRequested;
    bool mConvert;
    float mSampleRate;
    SampleAccount& mAccount;
    FrameTimes& mFrameTimes;

    std::vector<fbxsdk::FbxAnimCurve*> mCurves; // of the component being sampled, with and without keys
    TnFbxTime mTime;
    SampleRun mSamples;
};

} // namespace Tarnell::Fbx::detail
