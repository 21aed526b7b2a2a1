// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lights, markers and nulls: a transform and a few properties of the node's attribute each.
#include "FbxSdk.h"

#include "PropertySampling.h"
#include "ReadScope.h"
#include "access/AttributeEnums.h"
#include "calls/LastError.h"

namespace Tarnell::Fbx {

using detail::channelAfter;
using detail::enumNumber;
using detail::fail;
using detail::PropertySampler;
using detail::succeed;
using detail::toFloat;

namespace {

using Light = fbxsdk::FbxLight;
using Marker = fbxsdk::FbxMarker;

/// The colour channels, from red on: three from the property, and an alpha without a property.
template <class Object, class Channel>
void readColour(PropertySampler& properties, Object& object, Channel red,
                const fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property) {
    const fbxsdk::FbxDouble3 colour = property.Get();
    for (int i = 0; i < 3; ++i)
        object.setValue(channelAfter(red, i), toFloat(colour[i]));
    object.setValue(channelAfter(red, 3), 1.0f); // kept: always opaque
    properties.sampleVectorInto(object, red, property);
}

/// From percent to 1; the factor is applied in single precision.
void readIntensity(PropertySampler& properties, TnFbxLight& light, const Light& source) {
    light.setValue(TnFbxLight::kFbxLightIntensity,
                   toFloat(source.Intensity.Get()) * TnFbxLight::kNormalizeLightIntensity);
    if (properties.sample(source.Intensity, nullptr)) {
        properties.samples().transform([](float sample) { return sample * TnFbxLight::kNormalizeLightIntensity; });
        properties.samples().moveInto(*light.getLightChannel(TnFbxLight::kFbxLightIntensity), properties.time());
    }
}

} // namespace

bool FbxSdk::getLight(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                      TnFbxLight& light, fbxsdk::FbxAMatrix& geometric) {
    auto* source = fbxsdk::FbxCast<Light>(node != nullptr ? node->GetNodeAttribute() : nullptr);
    if (source == nullptr)
        return fail("no node with a light to read");
    const detail::ReadScope scope(*this);
    light.setName(node->GetName());
    if (!getTransform(time, global, useSampleFPS, sampleFPS, node, light, geometric))
        return false;
    PropertySampler properties = sampler(time, useSampleFPS, sampleFPS);
    readColour(properties, light, TnFbxLight::kFbxLightRed, source->Color);
    readIntensity(properties, light, *source);
    properties.readInto(light, TnFbxLight::kFbxLightConeAngle, source->OuterAngle);
    light.setLightType(detail::lookUp(detail::kLightTypes, enumNumber(source->LightType), detail::kOtherLightType));
    light.setDecayType(detail::lookUp(detail::kDecayTypes, enumNumber(source->DecayType), detail::kOtherDecayType));
    return scope.finish(succeed());
}

bool FbxSdk::getMarker(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                       TnFbxMarker& marker, fbxsdk::FbxAMatrix& geometric) {
    auto* source = fbxsdk::FbxCast<Marker>(node != nullptr ? node->GetNodeAttribute() : nullptr);
    if (source == nullptr)
        return fail("no node with a marker to read");
    const detail::ReadScope scope(*this);
    marker.setName(node->GetName());
    if (!getTransform(time, global, useSampleFPS, sampleFPS, node, marker, geometric))
        return false;
    PropertySampler properties = sampler(time, useSampleFPS, sampleFPS);
    readColour(properties, marker, TnFbxMarker::kFbxMarkerRed, source->Color);
    marker.setMarkerSize(toFloat(source->Size.Get()));
    marker.setMarkerLookType(detail::lookUp(detail::kMarkerLooks, enumNumber(source->Look), detail::kOtherMarkerLook));
    return scope.finish(succeed());
}

bool FbxSdk::getNull(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                     TnFbxNull& null, fbxsdk::FbxAMatrix& geometric) {
    if (node == nullptr)
        return fail("no node to read a null from");
    fbxsdk::FbxNodeAttribute* attribute = node->GetNodeAttribute();
    auto* source = fbxsdk::FbxCast<fbxsdk::FbxNull>(attribute);
    if (attribute != nullptr && source == nullptr)
        return fail("the node is not a null");
    null.setName(node->GetName());
    if (!getTransform(time, global, useSampleFPS, sampleFPS, node, null, geometric))
        return false;
    if (source == nullptr) { // kept: a node without an attribute is a null
        null.setNullSize(TnFbxNull::kDefaultNullSize);
        null.setNullLookType(TnFbxNull::kFbxNullLookCross);
        return succeed();
    }
    null.setNullSize(toFloat(source->Size.Get()));
    null.setNullLookType(detail::lookUp(detail::kNullLooks, enumNumber(source->Look), detail::kOtherNullLook));
    return succeed();
}

} // namespace Tarnell::Fbx
