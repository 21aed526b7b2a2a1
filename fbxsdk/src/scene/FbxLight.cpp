// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include <fbxsdk/FbxLight.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxLight, FbxNodeAttribute, detail::kLightRows)

FbxLight::FbxLight(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), LightType(detail::bindProperty<EType>(*this, "LightType")),
      CastLight(detail::bindProperty<FbxBool>(*this, "CastLightOnObject")),
      DrawVolumetricLight(detail::bindProperty<FbxBool>(*this, "DrawVolumetricLight")),
      DrawGroundProjection(detail::bindProperty<FbxBool>(*this, "DrawGroundProjection")),
      DrawFrontFacingVolumetricLight(detail::bindProperty<FbxBool>(*this, "DrawFrontFacingVolumetricLight")),
      Intensity(detail::bindProperty<FbxDouble>(*this, "Intensity")),
      InnerAngle(detail::bindProperty<FbxDouble>(*this, "InnerAngle")),
      OuterAngle(detail::bindProperty<FbxDouble>(*this, "OuterAngle")),
      Fog(detail::bindProperty<FbxDouble>(*this, "Fog")),
      DecayType(detail::bindProperty<EDecayType>(*this, "DecayType")),
      DecayStart(detail::bindProperty<FbxDouble>(*this, "DecayStart")),
      FileName(detail::bindProperty<FbxString>(*this, "FileName")),
      EnableNearAttenuation(detail::bindProperty<FbxBool>(*this, "EnableNearAttenuation")),
      NearAttenuationStart(detail::bindProperty<FbxDouble>(*this, "NearAttenuationStart")),
      NearAttenuationEnd(detail::bindProperty<FbxDouble>(*this, "NearAttenuationEnd")),
      EnableFarAttenuation(detail::bindProperty<FbxBool>(*this, "EnableFarAttenuation")),
      FarAttenuationStart(detail::bindProperty<FbxDouble>(*this, "FarAttenuationStart")),
      FarAttenuationEnd(detail::bindProperty<FbxDouble>(*this, "FarAttenuationEnd")),
      CastShadows(detail::bindProperty<FbxBool>(*this, "CastShadows")),
      ShadowColor(detail::bindProperty<FbxDouble3>(*this, "ShadowColor")),
      AreaLightShape(detail::bindProperty<EAreaLightShape>(*this, "AreaLightShape")),
      LeftBarnDoor(detail::bindProperty<FbxFloat>(*this, "LeftBarnDoor")),
      RightBarnDoor(detail::bindProperty<FbxFloat>(*this, "RightBarnDoor")),
      TopBarnDoor(detail::bindProperty<FbxFloat>(*this, "TopBarnDoor")),
      BottomBarnDoor(detail::bindProperty<FbxFloat>(*this, "BottomBarnDoor")),
      EnableBarnDoor(detail::bindProperty<FbxBool>(*this, "EnableBarnDoor")) {}

FbxLight::~FbxLight() = default;

FbxNodeAttribute::EType FbxLight::GetAttributeType() const { return eLight; }

FBXSDK_NAMESPACE_END
