// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of a light to a node's light attribute: colour, intensity, cone and decay, static and keyed.
#include "CurveWriting.h"

#include "PropertySampling.h"
#include "calls/LastError.h"

#include <array>

namespace Tarnell::Fbx {

using detail::channelAfter;
using detail::ChannelWriter;
using detail::fail;
using detail::kComponents;
using detail::succeed;

namespace {

using Light = fbxsdk::FbxLight;

/// kept: the alpha is not written
bool writeColour(ChannelWriter& writer, TnFbxLight& source, Light& light) {
    std::array<TnFbxChannel*, 3> channels{};
    fbxsdk::FbxDouble3 colour;
    for (int i = 0; i < 3; ++i) {
        TnFbxChannel* channel = source.getLightChannel(channelAfter(TnFbxLight::kFbxLightRed, i));
        if (channel == nullptr)
            return false;
        channels[static_cast<std::size_t>(i)] = channel;
        colour[i] = static_cast<double>(channel->getValue());
    }
    light.Color.Set(colour);
    for (std::size_t i = 0; i < channels.size(); ++i)
        writer.key(light.Color, kComponents[i], channels[i]);
    return true;
}

/// From 1 to percent, in single precision.
bool writeIntensity(ChannelWriter& writer, TnFbxLight& source, Light& light) {
    TnFbxChannel* intensity = source.getLightChannel(TnFbxLight::kFbxLightIntensity);
    if (intensity == nullptr)
        return false;
    light.Intensity.Set(static_cast<double>(intensity->getValue() / TnFbxLight::kNormalizeLightIntensity));
    writer.key(light.Intensity, nullptr, intensity, 1.0f / TnFbxLight::kNormalizeLightIntensity);
    return true;
}

void writeDecay(const TnFbxLight& source, Light& light) {
    switch (source.getDecayType()) {
    case TnFbxLight::kFbxLightDecayNone:
        light.DecayType.Set(Light::eNone);
        break;
    case TnFbxLight::kFbxLightDecayLinear:
        light.DecayType.Set(Light::eLinear);
        break;
    case TnFbxLight::kFbxLightDecayQuadratic:
        light.DecayType.Set(Light::eQuadratic);
        break;
    case TnFbxLight::kFbxLightDecayCubic:
        light.DecayType.Set(Light::eCubic);
        break;
    default: // a number that is no decay: the light keeps its decay
        break;
    }
}

/// The differences between the types of lights.
bool writeType(ChannelWriter& writer, TnFbxLight& source, Light& light) {
    const TnFbxLight::EFbxLightType type = source.getLightType();
    if (type == TnFbxLight::kFbxLightSpot) {
        TnFbxChannel* cone = source.getLightChannel(TnFbxLight::kFbxLightConeAngle);
        if (cone == nullptr)
            return false;
        writer.write(light.OuterAngle, cone);
    }
    if (type == TnFbxLight::kFbxLightSpot || type == TnFbxLight::kFbxLightPoint) // kept: not of directional lights
        writeDecay(source, light);
    return true;
}

/// Whether the light shines along an axis: -Y of its node in the scene, -Z of its own here.
bool hasDirection(const TnFbxLight& light) {
    return light.getLightType() == TnFbxLight::kFbxLightDirectional ||
           light.getLightType() == TnFbxLight::kFbxLightSpot;
}

} // namespace

bool FbxSdk::setLightCurveValues(fbxsdk::FbxNode* node, TnFbxLight* light) {
    Light* target = node != nullptr ? node->GetLight() : nullptr;
    if (target == nullptr || light == nullptr)
        return fail("no node with a light, or no light to write");
    if (!setTransformCurveValues(node, light))
        return false;
    ChannelWriter writer(currentLayer(), *mFrameTimes, *mMemory);
    if (!writeColour(writer, *light, *target) || !writeIntensity(writer, *light, *target) ||
        !writeType(writer, *light, *target))
        return fail("the light lacks a channel");
    if (hasDirection(*light)) {
        node->SetPostRotation(fbxsdk::FbxNode::eSourcePivot, fbxsdk::FbxVector4(-90.0, 0.0, 0.0, 1.0));
        node->SetRotationActive(true);
    }
    return succeed();
}

} // namespace Tarnell::Fbx
