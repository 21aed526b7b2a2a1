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

template <class T, detail::NameLiteral name>
FbxPropertyT<T> bind(FbxCamera& camera) {
    return detail::bindRow<T, detail::kCameraRows, name>(camera);
}

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
    : FbxNodeAttribute(pManager, pInfo), Position(bind<FbxDouble3, "Position">(*this)),
      UpVector(bind<FbxDouble3, "UpVector">(*this)), InterestPosition(bind<FbxDouble3, "InterestPosition">(*this)),
      Roll(bind<FbxDouble, "Roll">(*this)), OpticalCenterX(bind<FbxDouble, "OpticalCenterX">(*this)),
      OpticalCenterY(bind<FbxDouble, "OpticalCenterY">(*this)),
      BackgroundColor(bind<FbxDouble3, "BackgroundColor">(*this)),
      AspectRatioMode(bind<EAspectRatioMode, "AspectRatioMode">(*this)),
      AspectWidth(bind<FbxDouble, "AspectWidth">(*this)), AspectHeight(bind<FbxDouble, "AspectHeight">(*this)),
      PixelAspectRatio(bind<FbxDouble, "PixelAspectRatio">(*this)), FilmOffsetX(bind<FbxDouble, "FilmOffsetX">(*this)),
      FilmOffsetY(bind<FbxDouble, "FilmOffsetY">(*this)), FilmWidth(bind<FbxDouble, "FilmWidth">(*this)),
      FilmHeight(bind<FbxDouble, "FilmHeight">(*this)), FilmAspectRatio(bind<FbxDouble, "FilmAspectRatio">(*this)),
      FilmSqueezeRatio(bind<FbxDouble, "FilmSqueezeRatio">(*this)),
      FilmFormat(bind<EApertureFormat, "FilmFormatIndex">(*this)),
      ApertureMode(bind<EApertureMode, "ApertureMode">(*this)), GateFit(bind<EGateFit, "GateFit">(*this)),
      FieldOfView(bind<FbxDouble, "FieldOfView">(*this)), FieldOfViewX(bind<FbxDouble, "FieldOfViewX">(*this)),
      FieldOfViewY(bind<FbxDouble, "FieldOfViewY">(*this)), FocalLength(bind<FbxDouble, "FocalLength">(*this)),
      CameraFormat(bind<EFormat, "CameraFormat">(*this)), NearPlane(bind<FbxDouble, "NearPlane">(*this)),
      FarPlane(bind<FbxDouble, "FarPlane">(*this)), BackPlaneDistance(bind<FbxDouble, "BackPlaneDistance">(*this)),
      FrontPlaneDistance(bind<FbxDouble, "FrontPlaneDistance">(*this)),
      ProjectionType(bind<EProjectionType, "CameraProjectionType">(*this)),
      OrthoZoom(bind<FbxDouble, "OrthoZoom">(*this)), FocusSource(bind<EFocusDistanceSource, "FocusSource">(*this)),
      FocusDistance(bind<FbxDouble, "FocusDistance">(*this)) {}

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
