// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A light.
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// Points along its node's negative Y axis. Its colour is white by default and may be animated.
class FBXSDK_DLL FbxLight : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxLight, FbxNodeAttribute)

public:
    enum EType : int { ePoint, eDirectional, eSpot, eArea, eVolume };
    enum EDecayType : int { eNone, eLinear, eQuadratic, eCubic };
    enum EAreaLightShape : int { eRectangle, eSphere };

    FbxPropertyT<EType> LightType;
    FbxPropertyT<FbxBool> CastLight; ///< in files CastLightOnObject
    FbxPropertyT<FbxBool> DrawVolumetricLight, DrawGroundProjection, DrawFrontFacingVolumetricLight;
    FbxPropertyT<FbxDouble> Intensity;              ///< percent
    FbxPropertyT<FbxDouble> InnerAngle, OuterAngle; ///< of the full cone, degrees
    FbxPropertyT<FbxDouble> Fog;
    FbxPropertyT<EDecayType> DecayType;
    FbxPropertyT<FbxDouble> DecayStart;
    FbxPropertyT<FbxString> FileName;
    FbxPropertyT<FbxBool> EnableNearAttenuation;
    FbxPropertyT<FbxDouble> NearAttenuationStart, NearAttenuationEnd;
    FbxPropertyT<FbxBool> EnableFarAttenuation;
    FbxPropertyT<FbxDouble> FarAttenuationStart, FarAttenuationEnd;
    FbxPropertyT<FbxBool> CastShadows;
    FbxPropertyT<FbxDouble3> ShadowColor;
    FbxPropertyT<EAreaLightShape> AreaLightShape;
    FbxPropertyT<FbxFloat> LeftBarnDoor, RightBarnDoor, TopBarnDoor, BottomBarnDoor;
    FbxPropertyT<FbxBool> EnableBarnDoor;

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override;
};

FBXSDK_NAMESPACE_END
