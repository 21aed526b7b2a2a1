// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxCollection.h>

FBXSDK_NAMESPACE_BEGIN

class FbxAnimCurveNode;

/// A layer of a stack: a collection of curve nodes. The first layer of a stack, its base layer, replaces the static
/// values of what it animates; each further one adds to what is below it, or overrides it, by its weight.
class FBXSDK_DLL FbxAnimLayer : public FbxCollection {
    FBXSDK_OBJECT_DECLARE(FbxAnimLayer, FbxCollection)

public:
    /// How the layer's values combine with those below.
    enum EBlendMode {
        eBlendAdditive,           ///< they are added, by weight
        eBlendOverride,           ///< they replace them, whatever the weight
        eBlendOverridePassthrough ///< they replace them by weight
    };
    /// How LclRotation adds up.
    enum ERotationAccumulationMode {
        eRotationByLayer,  ///< as rotations, one applied after the other
        eRotationByChannel ///< angle by angle
    };
    /// How LclScaling adds up.
    enum EScaleAccumulationMode {
        eScaleMultiply, ///< by products
        eScaleAdditive  ///< by sums
    };

    FbxPropertyT<FbxDouble> Weight;  ///< percent, 0 to 100; 100, animatable. Of no effect on the base layer
    FbxPropertyT<FbxBool> Mute,      ///< true: the layer is ignored
        Solo,                        ///< true: only layers with this flag are used
        Lock;                        ///< true: applications do not edit the layer
    FbxPropertyT<FbxDouble3> Color;  ///< for display, 0 to 1; (0.8, 0.8, 0.8)
    FbxPropertyT<FbxEnum> BlendMode, ///< EBlendMode; eBlendAdditive
        RotationAccumulationMode,    ///< ERotationAccumulationMode; eRotationByLayer
        ScaleAccumulationMode;       ///< EScaleAccumulationMode; eScaleMultiply

    void Reset(); ///< Sets all of these and the bypasses to their defaults; curves stay.
    /// With the bypass on, values of that type override instead of blending. Numbers that are no type are ignored.
    void SetBlendModeBypass(EFbxType pType, bool pState);
    [[nodiscard]] bool GetBlendModeBypass(EFbxType pType) const; ///< False by default and for numbers that are no type.

    /// The layer's curve node for the property, created when there is none, also when the property is not marked as
    /// animatable; null for an invalid property and one that holds no number.
    FbxAnimCurveNode* CreateCurveNode(FbxProperty& pProperty);
};

FBXSDK_NAMESPACE_END
