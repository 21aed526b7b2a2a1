// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Animation layers: how a layer combines with those below, and the curve nodes that belong to it.
#include <fbxsdk/FbxAnimLayer.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxAnimLayer, FbxCollection, detail::kAnimLayerRows)

FbxAnimLayer::FbxAnimLayer(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxCollection(pManager, pInfo), Weight(detail::bindProperty<FbxDouble>(*this, "Weight")),
      Mute(detail::bindProperty<FbxBool>(*this, "Mute")), Solo(detail::bindProperty<FbxBool>(*this, "Solo")),
      Lock(detail::bindProperty<FbxBool>(*this, "Lock")), Color(detail::bindProperty<FbxDouble3>(*this, "Color")),
      BlendMode(detail::bindProperty<FbxEnum>(*this, "BlendMode")),
      RotationAccumulationMode(detail::bindProperty<FbxEnum>(*this, "RotationAccumulationMode")),
      ScaleAccumulationMode(detail::bindProperty<FbxEnum>(*this, "ScaleAccumulationMode")) {}

FbxAnimLayer::~FbxAnimLayer() = default;

void FbxAnimLayer::Reset() {
    Weight.Set(100.0);
    Mute.Set(false);
    Solo.Set(false);
    Lock.Set(false);
    Color.Set(FbxDouble3(0.8, 0.8, 0.8));
    BlendMode.Set(eBlendAdditive);
    RotationAccumulationMode.Set(eRotationByLayer);
    ScaleAccumulationMode.Set(eScaleMultiply);
    FindProperty("BlendModeBypass").Set(FbxULongLong{0});
}

void FbxAnimLayer::SetBlendModeBypass(EFbxType pType, bool pState) {
    const int bit = static_cast<int>(pType);
    if (bit < 0 || bit >= eFbxTypeCount)
        return;
    FbxProperty property = FindProperty("BlendModeBypass");
    const FbxULongLong mask = FbxULongLong{1} << bit;
    const FbxULongLong old = property.Get<FbxULongLong>();
    property.Set(pState ? old | mask : old & ~mask);
}

bool FbxAnimLayer::GetBlendModeBypass(EFbxType pType) const {
    const int bit = static_cast<int>(pType);
    if (bit < 0 || bit >= eFbxTypeCount)
        return false;
    return (FindProperty("BlendModeBypass").Get<FbxULongLong>() >> bit & 1U) != 0;
}

FBXSDK_NAMESPACE_END
