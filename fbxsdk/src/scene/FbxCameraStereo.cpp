// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Stereo rigs: the eyes are cameras connected to two properties of the rig.
#include <fbxsdk/FbxCameraStereo.h>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxCameraStereo, FbxCamera, detail::kCameraStereoRows)

namespace {

FbxCamera* cameraAt(const FbxProperty& property) { return property.GetSrcObject<FbxCamera>(); }

void setCamera(FbxProperty property, FbxCamera* camera) {
    while (FbxCamera* former = cameraAt(property))
        if (!property.DisconnectSrcObject(former))
            break;
    if (camera)
        property.ConnectSrcObject(camera);
}

} // namespace

FbxCameraStereo::FbxCameraStereo(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxCamera(pManager, pInfo), Stereo(detail::bindProperty<FbxEnum>(*this, "Stereo")),
      InteraxialSeparation(detail::bindProperty<FbxDouble>(*this, "InteraxialSeparation")),
      ZeroParallax(detail::bindProperty<FbxDouble>(*this, "ZeroParallax")),
      ToeInAdjust(detail::bindProperty<FbxDouble>(*this, "ToeInAdjust")),
      FilmOffsetRightCam(detail::bindProperty<FbxDouble>(*this, "FilmOffsetRightCam")),
      FilmOffsetLeftCam(detail::bindProperty<FbxDouble>(*this, "FilmOffsetLeftCam")),
      PrecompFileName(detail::bindProperty<FbxString>(*this, "PrecompFileName")),
      RelativePrecompFileName(detail::bindProperty<FbxString>(*this, "RelativePrecompFileName")) {}

FbxCameraStereo::~FbxCameraStereo() = default;

FbxNodeAttribute::EType FbxCameraStereo::GetAttributeType() const { return eCameraStereo; }

void FbxCameraStereo::SetLeftCamera(FbxCamera* pCamera) { setCamera(FindProperty("LeftCamera"), pCamera); }

FbxCamera* FbxCameraStereo::GetLeftCamera() const { return cameraAt(FindProperty("LeftCamera")); }

void FbxCameraStereo::SetRightCamera(FbxCamera* pCamera) { setCamera(FindProperty("RightCamera"), pCamera); }

FbxCamera* FbxCameraStereo::GetRightCamera() const { return cameraAt(FindProperty("RightCamera")); }

FBXSDK_NAMESPACE_END
