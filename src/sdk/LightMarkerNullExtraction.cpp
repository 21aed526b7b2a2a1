// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lights, markers and nulls: a transform and a few properties of the node's attribute each.
#include "FbxSdk.h"

#include "PropertySampling.h"
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

/// A number of FBX and what it is called here. What a table does not hold has the value that stands beside it.
template <class Value>
struct EnumRow {
    int fbx;
    Value value;
};

template <class Value, std::size_t kCount>
constexpr Value lookUp(const EnumRow<Value> (&rows)[kCount], int number, Value otherwise) {
    for (const EnumRow<Value>& row : rows) {
        if (row.fbx == number) {
            return row.value;
        }
    }
    return otherwise;
}

constexpr EnumRow<TnFbxLight::EFbxLightType> kLightTypes[] = {
    {Light::eDirectional, TnFbxLight::kFbxLightDirectional},
    {Light::eSpot, TnFbxLight::kFbxLightSpot},
};
constexpr auto kOtherLightType = TnFbxLight::kFbxLightPoint; // kept: area and volume lights too

constexpr EnumRow<TnFbxLight::EFbxLightDecayType> kDecayTypes[] = {
    {Light::eLinear, TnFbxLight::kFbxLightDecayLinear},
    {Light::eQuadratic, TnFbxLight::kFbxLightDecayQuadratic},
    {Light::eCubic, TnFbxLight::kFbxLightDecayCubic},
};
constexpr auto kOtherDecayType = TnFbxLight::kFbxLightDecayNone;

constexpr EnumRow<TnFbxMarker::EFbxMarkerLookType> kMarkerLooks[] = {
    {Marker::eHardCross, TnFbxMarker::kFbxMarkerLookHardCross},
    {Marker::eLightCross, TnFbxMarker::kFbxMarkerLookLightCross},
    {Marker::eSphere, TnFbxMarker::kFbxMarkerLookSphere},
};
constexpr auto kOtherMarkerLook = TnFbxMarker::kFbxMarkerLookCube; // kept: capsules, boxes and the rest too

constexpr EnumRow<TnFbxNull::EFbxNullLookType> kNullLooks[] = {
    {fbxsdk::FbxNull::eNone, TnFbxNull::kFbxNullLookNone},
};
constexpr auto kOtherNullLook = TnFbxNull::kFbxNullLookCross;

/// The colour channels, from red on: three from the property, and an alpha that no property holds.
template <class Object, class Channel>
void readColour(PropertySampler& properties, Object& object, Channel red,
                const fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property) {
    const fbxsdk::FbxDouble3 colour = property.Get();
    for (int i = 0; i < 3; ++i) {
        object.setValue(channelAfter(red, i), toFloat(colour[i]));
    }
    object.setValue(channelAfter(red, 3), 1.0f); // kept: always opaque
    properties.sampleVectorInto(object, red, property);
}

/// From percent to 1; the factor is applied in single precision.
void readIntensity(PropertySampler& properties, TnFbxLight& light, const Light& source) {
    light.setValue(TnFbxLight::kFbxLightIntensity,
                   toFloat(source.Intensity.Get()) * TnFbxLight::kNormalizeLightIntensity);
    if (properties.sample(source.Intensity, nullptr)) {
        for (float& sample : properties.samples()) {
            sample *= TnFbxLight::kNormalizeLightIntensity;
        }
        light.setValueAt(TnFbxLight::kFbxLightIntensity, properties.time(), std::move(properties.samples()));
    }
}

} // namespace

bool FbxSdk::getLight(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                      TnFbxLight& light, fbxsdk::FbxAMatrix& geometric) {
    auto* source = fbxsdk::FbxCast<Light>(node != nullptr ? node->GetNodeAttribute() : nullptr);
    if (source == nullptr) {
        return fail("no node with a light to read");
    }
    light.setName(node->GetName());
    if (!getTransform(time, global, useSampleFPS, sampleFPS, node, light, geometric)) {
        return false;
    }
    PropertySampler properties = sampler(time, useSampleFPS, sampleFPS);
    readColour(properties, light, TnFbxLight::kFbxLightRed, source->Color);
    readIntensity(properties, light, *source);
    properties.readInto(light, TnFbxLight::kFbxLightConeAngle, source->OuterAngle);
    light.setLightType(lookUp(kLightTypes, enumNumber(source->LightType), kOtherLightType));
    light.setDecayType(lookUp(kDecayTypes, enumNumber(source->DecayType), kOtherDecayType));
    return succeed();
}

bool FbxSdk::getMarker(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                       TnFbxMarker& marker, fbxsdk::FbxAMatrix& geometric) {
    auto* source = fbxsdk::FbxCast<Marker>(node != nullptr ? node->GetNodeAttribute() : nullptr);
    if (source == nullptr) {
        return fail("no node with a marker to read");
    }
    marker.setName(node->GetName());
    if (!getTransform(time, global, useSampleFPS, sampleFPS, node, marker, geometric)) {
        return false;
    }
    PropertySampler properties = sampler(time, useSampleFPS, sampleFPS);
    readColour(properties, marker, TnFbxMarker::kFbxMarkerRed, source->Color);
    marker.setMarkerSize(toFloat(source->Size.Get()));
    marker.setMarkerLookType(lookUp(kMarkerLooks, enumNumber(source->Look), kOtherMarkerLook));
    return succeed();
}

bool FbxSdk::getNull(TnFbxTime& time, bool global, bool useSampleFPS, float sampleFPS, fbxsdk::FbxNode* node,
                     TnFbxNull& null, fbxsdk::FbxAMatrix& geometric) {
    if (node == nullptr) {
        return fail("no node to read a null from");
    }
    fbxsdk::FbxNodeAttribute* attribute = node->GetNodeAttribute();
    auto* source = fbxsdk::FbxCast<fbxsdk::FbxNull>(attribute);
    if (attribute != nullptr && source == nullptr) {
        return fail("the node is no null");
    }
    null.setName(node->GetName());
    if (!getTransform(time, global, useSampleFPS, sampleFPS, node, null, geometric)) {
        return false;
    }
    if (source == nullptr) { // kept: a node that carries nothing is a null
        null.setNullSize(TnFbxNull::kDefaultNullSize);
        null.setNullLookType(TnFbxNull::kFbxNullLookCross);
        return succeed();
    }
    null.setNullSize(toFloat(source->Size.Get()));
    null.setNullLookType(lookUp(kNullLooks, enumNumber(source->Look), kOtherNullLook));
    return succeed();
}

} // namespace Tarnell::Fbx
