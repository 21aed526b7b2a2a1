// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The library's enumerators for those of lights, markers and nulls in FBX.
#pragma once

#include "TnFbxLight.h"
#include "TnFbxMarker.h"
#include "TnFbxNull.h"

#include <fbxsdk.h>

#include <cstddef>

namespace Tarnell::Fbx::detail {

/// A number of FBX and its enumerator here. For a number that is not in a table, the value next to the table is used.
template <class Value>
struct EnumRow {
    int fbx;
    Value value;
};

template <class Value, std::size_t kCount>
constexpr Value lookUp(const EnumRow<Value> (&rows)[kCount], int number, Value otherwise) {
    for (const EnumRow<Value>& row : rows)
        if (row.fbx == number)
            return row.value;
    return otherwise;
}

inline constexpr EnumRow<TnFbxLight::EFbxLightType> kLightTypes[] = {
    {fbxsdk::FbxLight::eDirectional, TnFbxLight::kFbxLightDirectional},
    {fbxsdk::FbxLight::eSpot, TnFbxLight::kFbxLightSpot},
};
inline constexpr auto kOtherLightType = TnFbxLight::kFbxLightPoint; // kept: area and volume lights too

inline constexpr EnumRow<TnFbxLight::EFbxLightDecayType> kDecayTypes[] = {
    {fbxsdk::FbxLight::eLinear, TnFbxLight::kFbxLightDecayLinear},
    {fbxsdk::FbxLight::eQuadratic, TnFbxLight::kFbxLightDecayQuadratic},
    {fbxsdk::FbxLight::eCubic, TnFbxLight::kFbxLightDecayCubic},
};
inline constexpr auto kOtherDecayType = TnFbxLight::kFbxLightDecayNone;

inline constexpr EnumRow<TnFbxMarker::EFbxMarkerLookType> kMarkerLooks[] = {
    {fbxsdk::FbxMarker::eHardCross, TnFbxMarker::kFbxMarkerLookHardCross},
    {fbxsdk::FbxMarker::eLightCross, TnFbxMarker::kFbxMarkerLookLightCross},
    {fbxsdk::FbxMarker::eSphere, TnFbxMarker::kFbxMarkerLookSphere},
};
inline constexpr auto kOtherMarkerLook = TnFbxMarker::kFbxMarkerLookCube; // kept: capsules, boxes and the rest too

inline constexpr EnumRow<TnFbxNull::EFbxNullLookType> kNullLooks[] = {
    {fbxsdk::FbxNull::eNone, TnFbxNull::kFbxNullLookNone},
};
inline constexpr auto kOtherNullLook = TnFbxNull::kFbxNullLookCross;

} // namespace Tarnell::Fbx::detail
