// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxNodeAttribute.h>

FBXSDK_NAMESPACE_BEGIN

/// A light. Points along its node's negative Y axis. Its colour (FbxNodeAttribute::Color) is white by default and may
/// be animated.
class FBXSDK_DLL FbxLight : public FbxNodeAttribute {
    FBXSDK_OBJECT_DECLARE(FbxLight, FbxNodeAttribute)

public:
    /// The kind of light. Numbers of files that are no enumerator are kept.
    enum EType : int {
        ePoint,       ///< in all directions from one point; the default
        eDirectional, ///< parallel rays
        eSpot,        ///< a cone
        eArea,        ///< from a surface; AreaLightShape says which
        eVolume       ///< within a volume
    };
    /// How the intensity falls with the distance d, from DecayStart on.
    enum EDecayType : int {
        eNone,      ///< not at all; the default
        eLinear,    ///< by 1/d
        eQuadratic, ///< by 1/d²
        eCubic      ///< by 1/d³
    };
    /// The surface of an area light.
    enum EAreaLightShape : int {
        eRectangle, ///< the default
        eSphere     ///< a sphere
    };

    FbxPropertyT<EType> LightType;                ///< ePoint by default
    FbxPropertyT<FbxBool> CastLight;              ///< in files CastLightOnObject; true: objects are lit
    FbxPropertyT<FbxBool> DrawVolumetricLight,    ///< whether the cone itself is drawn; true
        DrawGroundProjection,                     ///< whether the light's spot on the ground is drawn; true
        DrawFrontFacingVolumetricLight;           ///< whether the cone is drawn toward the viewer; false
    FbxPropertyT<FbxDouble> Intensity;            ///< percent; 100, animatable. Not changed by unit conversion
    FbxPropertyT<FbxDouble> InnerAngle,           ///< of the full cone of full light, degrees; 0, animatable
        OuterAngle;                               ///< of the full cone, degrees; 45, animatable
    FbxPropertyT<FbxDouble> Fog;                  ///< percent; 50, animatable
    FbxPropertyT<EDecayType> DecayType;           ///< eNone by default
    FbxPropertyT<FbxDouble> DecayStart;           ///< distance, scene units; 0, animatable
    FbxPropertyT<FbxString> FileName;             ///< the image that the light projects; empty for none
    FbxPropertyT<FbxBool> EnableNearAttenuation;  ///< whether the light fades in; false
    FbxPropertyT<FbxDouble> NearAttenuationStart, ///< where fading in begins, scene units; 0, animatable
        NearAttenuationEnd;                       ///< where the light is full, scene units; 0, animatable
    FbxPropertyT<FbxBool> EnableFarAttenuation;   ///< whether the light fades out; false
    FbxPropertyT<FbxDouble> FarAttenuationStart,  ///< where fading out begins, scene units; 0, animatable
        FarAttenuationEnd;                        ///< where the light ends, scene units; 0, animatable
    FbxPropertyT<FbxBool> CastShadows;            ///< false by default
    FbxPropertyT<FbxDouble3> ShadowColor;         ///< 0 to 1; black, animatable
    FbxPropertyT<EAreaLightShape> AreaLightShape; ///< of area lights; eRectangle by default
    FbxPropertyT<FbxFloat> LeftBarnDoor,          ///< degrees; 20, animatable
        RightBarnDoor,                            ///< degrees; 20, animatable
        TopBarnDoor,                              ///< degrees; 20, animatable
        BottomBarnDoor;                           ///< degrees; 20, animatable
    FbxPropertyT<FbxBool> EnableBarnDoor;         ///< whether the barn doors limit the cone; false, animatable

    [[nodiscard]] FbxNodeAttribute::EType GetAttributeType() const override; ///< eLight.
};

FBXSDK_NAMESPACE_END
