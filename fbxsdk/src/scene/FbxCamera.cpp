// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras. Only the lens arithmetic reads more than one property.
#include <fbxsdk/FbxCamera.h>

#include <algorithm>
#include <cmath>

#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxCamera, FbxNodeAttribute, detail::kCameraRows)

namespace {

constexpr double kMillimetresPerInch = 25.4;
constexpr double kNearestPlane = 0.001;
constexpr double kFarthestPlane = 600000.0;

/// Film backs, inches.
constexpr struct {
    FbxCamera::EApertureFormat format;
    double width, height;
    double squeeze;
} kApertureFormats[] = {
    {FbxCamera::e16mmTheatrical, 0.404, 0.295, 1},
    {FbxCamera::eSuper16mm, 0.493, 0.292, 1},
    {FbxCamera::e35mmAcademy, 0.864, 0.630, 1},
    {FbxCamera::e35mmTVProjection, 0.816, 0.612, 1},
    {FbxCamera::e35mmFullAperture, 0.980, 0.735, 1},
    {FbxCamera::e35mm185Projection, 0.825, 0.446, 1},
    {FbxCamera::e35mmAnamorphic, 0.864, 0.732, 2},
    {FbxCamera::e70mmProjection, 2.066, 0.906, 1},
    {FbxCamera::eVistaVision, 1.485, 0.991, 1},
    {FbxCamera::eDynaVision, 2.080, 1.480, 1},
    {FbxCamera::eIMAX, 2.772, 2.072, 1},
};

/// NaN counts as too near.
double planeDistance(double distance) {
    return distance > kNearestPlane ? std::min(distance, kFarthestPlane) : kNearestPlane;
}

} // namespace

FbxCamera::FbxCamera(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo), Position(detail::bindProperty<FbxDouble3>(*this, "Position")),
      UpVector(detail::bindProperty<FbxDouble3>(*this, "UpVector")),
      InterestPosition(detail::bindProperty<FbxDouble3>(*this, "InterestPosition")),
      Roll(detail::bindProperty<FbxDouble>(*this, "Roll")),
      OpticalCenterX(detail::bindProperty<FbxDouble>(*this, "OpticalCenterX")),
      OpticalCenterY(detail::bindProperty<FbxDouble>(*this, "OpticalCenterY")),
      BackgroundColor(detail::bindProperty<FbxDouble3>(*this, "BackgroundColor")),
      AspectRatioMode(detail::bindProperty<EAspectRatioMode>(*this, "AspectRatioMode")),
      AspectWidth(detail::bindProperty<FbxDouble>(*this, "AspectWidth")),
      AspectHeight(detail::bindProperty<FbxDouble>(*this, "AspectHeight")),
      PixelAspectRatio(detail::bindProperty<FbxDouble>(*this, "PixelAspectRatio")),
      FilmOffsetX(detail::bindProperty<FbxDouble>(*this, "FilmOffsetX")),
      FilmOffsetY(detail::bindProperty<FbxDouble>(*this, "FilmOffsetY")),
      FilmWidth(detail::bindProperty<FbxDouble>(*this, "FilmWidth")),
      FilmHeight(detail::bindProperty<FbxDouble>(*this, "FilmHeight")),
      FilmAspectRatio(detail::bindProperty<FbxDouble>(*this, "FilmAspectRatio")),
      FilmSqueezeRatio(detail::bindProperty<FbxDouble>(*this, "FilmSqueezeRatio")),
      FilmFormat(detail::bindProperty<EApertureFormat>(*this, "FilmFormatIndex")),
      ApertureMode(detail::bindProperty<EApertureMode>(*this, "ApertureMode")),
      GateFit(detail::bindProperty<EGateFit>(*this, "GateFit")),
      FieldOfView(detail::bindProperty<FbxDouble>(*this, "FieldOfView")),
      FieldOfViewX(detail::bindProperty<FbxDouble>(*this, "FieldOfViewX")),
      FieldOfViewY(detail::bindProperty<FbxDouble>(*this, "FieldOfViewY")),
      FocalLength(detail::bindProperty<FbxDouble>(*this, "FocalLength")),
      CameraFormat(detail::bindProperty<EFormat>(*this, "CameraFormat")),
      NearPlane(detail::bindProperty<FbxDouble>(*this, "NearPlane")),
      FarPlane(detail::bindProperty<FbxDouble>(*this, "FarPlane")),
      BackPlaneDistance(detail::bindProperty<FbxDouble>(*this, "BackPlaneDistance")),
      FrontPlaneDistance(detail::bindProperty<FbxDouble>(*this, "FrontPlaneDistance")),
      ProjectionType(detail::bindProperty<EProjectionType>(*this, "CameraProjectionType")),
      OrthoZoom(detail::bindProperty<FbxDouble>(*this, "OrthoZoom")),
      FocusSource(detail::bindProperty<EFocusDistanceSource>(*this, "FocusSource")),
      FocusDistance(detail::bindProperty<FbxDouble>(*this, "FocusDistance")) {}

FbxCamera::~FbxCamera() = default;

FbxNodeAttribute::EType FbxCamera::GetAttributeType() const { return eCamera; }

void FbxCamera::SetAspect(EAspectRatioMode pRatioMode, double pWidth, double pHeight) {
    AspectRatioMode.Set(pRatioMode);
    AspectWidth.Set(pWidth);
    AspectHeight.Set(pHeight);
}

void FbxCamera::SetPixelRatio(double pRatio) { PixelAspectRatio.Set(pRatio); }

double FbxCamera::GetPixelRatio() const { return PixelAspectRatio.Get(); }

void FbxCamera::SetNearPlane(double pDistance) { NearPlane.Set(planeDistance(pDistance)); }

double FbxCamera::GetNearPlane() const { return NearPlane.Get(); }

void FbxCamera::SetFarPlane(double pDistance) { FarPlane.Set(planeDistance(pDistance)); }

double FbxCamera::GetFarPlane() const { return FarPlane.Get(); }

void FbxCamera::SetApertureMode(EApertureMode pMode) { ApertureMode.Set(pMode); }

FbxCamera::EApertureMode FbxCamera::GetApertureMode() const { return ApertureMode.Get(); }

void FbxCamera::SetApertureFormat(EApertureFormat pFormat) {
    FilmFormat.Set(pFormat);
    for (const auto& row : kApertureFormats) {
        if (row.format != pFormat)
            continue;
        FilmWidth.Set(row.width);
        FilmHeight.Set(row.height);
        FilmAspectRatio.Set(row.width / row.height);
        FilmSqueezeRatio.Set(row.squeeze);
    }
}

FbxCamera::EApertureFormat FbxCamera::GetApertureFormat() const { return FilmFormat.Get(); }

void FbxCamera::SetApertureWidth(double pWidth) { FilmWidth.Set(pWidth); }

double FbxCamera::GetApertureWidth() const { return FilmWidth.Get(); }

void FbxCamera::SetApertureHeight(double pHeight) { FilmHeight.Set(pHeight); }

double FbxCamera::GetApertureHeight() const { return FilmHeight.Get(); }

void FbxCamera::SetSqueezeRatio(double pRatio) { FilmSqueezeRatio.Set(pRatio); }

double FbxCamera::GetSqueezeRatio() const { return FilmSqueezeRatio.Get(); }

double FbxCamera::apertureMillimetres() const {
    const double inches = GetApertureMode() == eVertical ? GetApertureHeight() : GetApertureWidth() * GetSqueezeRatio();
    return inches * kMillimetresPerInch;
}

double FbxCamera::ComputeFieldOfView(double pFocalLength) const {
    return 2.0 * std::atan(apertureMillimetres() / (2.0 * pFocalLength)) * FBXSDK_180_DIV_PI;
}

double FbxCamera::ComputeFocalLength(double pAngleOfView) const {
    return apertureMillimetres() / (2.0 * std::tan(pAngleOfView * 0.5 * FBXSDK_PI_DIV_180));
}

FBXSDK_NAMESPACE_END
