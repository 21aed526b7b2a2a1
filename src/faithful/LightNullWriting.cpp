// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lights, nulls and plain transforms.
#include "PlacementWriting.h"
#include "Writing.h"
#include "access/AttributeEnums.h"
#include "access/WriteChecks.h"

namespace Tarnell::Fbx::faithful {

namespace {

constexpr double kFullIntensity = 100.0; // of a light in a file
constexpr const char* kAlpha = "the alpha of lights is not written: FBX files have none";

/// The reverse direction of a table for reading.
template <class Value, std::size_t kCount>
int numberOf(const detail::EnumRow<Value> (&rows)[kCount], Value value, int otherwise) {
    for (const detail::EnumRow<Value>& row : rows)
        if (row.value == value)
            return row.fbx;
    return otherwise;
}

} // namespace

void addObject(WrittenScene& scene, TnFbxLight& source) {
    const auto channel = [&source](TnFbxLight::EFbxLightChannelType type) { return source.getLightChannel(type); };
    KeyWriter& keys = scene.keys();
    auto& light = scene.add<fbxsdk::FbxLight>(addPlacedNode(scene, source, kLightAxes));
    light.LightType.Set(static_cast<fbxsdk::FbxLight::EType>(
        numberOf(detail::kLightTypes, source.getLightType(), fbxsdk::FbxLight::ePoint)));
    light.DecayType.Set(static_cast<fbxsdk::FbxLight::EDecayType>(
        numberOf(detail::kDecayTypes, source.getDecayType(), fbxsdk::FbxLight::eNone)));
    light.CastLight.Set(true);
    keys.write(light.Color, {channel(TnFbxLight::kFbxLightRed), channel(TnFbxLight::kFbxLightGreen),
                             channel(TnFbxLight::kFbxLightBlue)});
    keys.write(light.Intensity, *channel(TnFbxLight::kFbxLightIntensity), kFullIntensity);
    keys.write(light.OuterAngle, *channel(TnFbxLight::kFbxLightConeAngle));
    const TnFbxChannel& alpha = *channel(TnFbxLight::kFbxLightAlpha);
    if (changes(alpha) || staticValue(alpha) != 1.0)
        scene.warnings().add(source.getName(), kAlpha);
    detail::check(source, scene.warnings());
}

void addObject(WrittenScene& scene, TnFbxTransform& source) {
    addPlacedNode(scene, source, kSameAxes);
    detail::check(source, scene.warnings());
}

void addObject(WrittenScene& scene, TnFbxNull& source) {
    auto& null = scene.add<fbxsdk::FbxNull>(addPlacedNode(scene, source, kSameAxes));
    null.Look.Set(static_cast<fbxsdk::FbxNull::ELook>(
        numberOf(detail::kNullLooks, source.getNullLookType(), fbxsdk::FbxNull::eCross)));
    null.Size.Set(static_cast<double>(source.getNullSize()));
    detail::check(source, scene.warnings());
}

} // namespace Tarnell::Fbx::faithful
