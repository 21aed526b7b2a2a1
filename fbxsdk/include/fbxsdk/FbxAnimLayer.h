// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One layer of animation: a collection of curve nodes and how it combines with the layers below.
#pragma once

#include <fbxsdk/FbxCollection.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimCurveNode;

class FBXSDK_DLL FbxAnimLayer : public FbxCollection {
    FBXSDK_OBJECT_DECLARE(FbxAnimLayer, FbxCollection)

public:
    enum EBlendMode { eBlendAdditive, eBlendOverride, eBlendOverridePassthrough };
    enum ERotationAccumulationMode { eRotationByLayer, eRotationByChannel };
    enum EScaleAccumulationMode { eScaleMultiply, eScaleAdditive };

    FbxPropertyT<FbxDouble> Weight; ///< percent
    FbxPropertyT<FbxBool> Mute, Solo, Lock;
    FbxPropertyT<FbxDouble3> Color;
    FbxPropertyT<FbxEnum> BlendMode, RotationAccumulationMode, ScaleAccumulationMode;

    void Reset();
    /// With the bypass on, values of that type override instead of blending.
    void SetBlendModeBypass(EFbxType pType, bool pState);
    [[nodiscard]] bool GetBlendModeBypass(EFbxType pType) const;

    /// The layer's curve node for the property, made when there is none, also when the property is not marked as
    /// animatable; null for an invalid property and one that holds no number.
    FbxAnimCurveNode* CreateCurveNode(FbxProperty& pProperty);
};

FBXSDK_NAMESPACE_END
