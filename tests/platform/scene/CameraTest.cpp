// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras: defaults, names, film backs and the lens.
#include <fbxsdk/FbxCamera.h>

#include <cmath>
#include <limits>

#include <fbxsdk/FbxCameraStereo.h>
#include <fbxsdk/FbxCameraSwitcher.h>
#include <fbxsdk/FbxNode.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxCameraTest : public SceneFixture {
protected:
    FbxCamera* camera = make<FbxCamera>("camera");
};

TEST_F(FbxCameraTest, HasTheDefaultsOfFiles) {
    EXPECT_EQ(camera->GetAttributeType(), FbxNodeAttribute::eCamera);
    EXPECT_EQ(camera->Color.Get(), FbxDouble3(0.8, 0.8, 0.8));
    EXPECT_EQ(camera->Position.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(camera->UpVector.Get(), FbxDouble3(0, 1, 0));
    EXPECT_EQ(camera->InterestPosition.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(camera->BackgroundColor.Get(), FbxDouble3(0.63, 0.63, 0.63));
    const struct {
        const FbxPropertyT<FbxDouble>& member;
        const char* name;
        double value;
    } numbers[] = {{camera->Roll, "Roll", 0},
                   {camera->OpticalCenterX, "OpticalCenterX", 0},
                   {camera->OpticalCenterY, "OpticalCenterY", 0},
                   {camera->AspectWidth, "AspectWidth", 320},
                   {camera->AspectHeight, "AspectHeight", 200},
                   {camera->PixelAspectRatio, "PixelAspectRatio", 1},
                   {camera->FilmOffsetX, "FilmOffsetX", 0},
                   {camera->FilmOffsetY, "FilmOffsetY", 0},
                   {camera->FilmWidth, "FilmWidth", 0.816},
                   {camera->FilmHeight, "FilmHeight", 0.612},
                   {camera->FilmAspectRatio, "FilmAspectRatio", 4.0 / 3.0},
                   {camera->FilmSqueezeRatio, "FilmSqueezeRatio", 1},
                   {camera->FieldOfView, "FieldOfView", 25.114999771118164},
                   {camera->FieldOfViewX, "FieldOfViewX", 40},
                   {camera->FieldOfViewY, "FieldOfViewY", 40},
                   {camera->FocalLength, "FocalLength", 34.89327621672628},
                   {camera->NearPlane, "NearPlane", 10},
                   {camera->FarPlane, "FarPlane", 4000},
                   {camera->BackPlaneDistance, "BackPlaneDistance", 4000},
                   {camera->FrontPlaneDistance, "FrontPlaneDistance", 10},
                   {camera->OrthoZoom, "OrthoZoom", 1},
                   {camera->FocusDistance, "FocusDistance", 200}};
    for (const auto& each : numbers) {
        EXPECT_STREQ(each.member.GetNameAsCStr(), each.name);
        EXPECT_EQ(each.member.Get(), each.value) << each.name;
    }
}

TEST_F(FbxCameraTest, HasTheEnumerationsOfFiles) {
    EXPECT_EQ(camera->ApertureMode.Get(), FbxCamera::eVertical);
    EXPECT_EQ(camera->ApertureMode.Get<FbxEnum>(), 2);
    EXPECT_EQ(camera->FilmFormat.Get<FbxEnum>(), 0);
    EXPECT_EQ(camera->GateFit.Get<FbxEnum>(), 0);
    EXPECT_EQ(camera->ProjectionType.Get<FbxEnum>(), 0);
    EXPECT_EQ(camera->AspectRatioMode.Get<FbxEnum>(), 0);
    EXPECT_EQ(camera->FocusSource.Get<FbxEnum>(), 0);
    EXPECT_EQ(camera->CameraFormat.Get<FbxEnum>(), 0);
    EXPECT_STREQ(camera->FilmFormat.GetNameAsCStr(), "FilmFormatIndex");
    EXPECT_STREQ(camera->ProjectionType.GetNameAsCStr(), "CameraProjectionType");
    EXPECT_EQ(FbxCamera::eFocalLength, 3);
    EXPECT_EQ(FbxCamera::e35mmTVProjection, 4);
    EXPECT_EQ(FbxCamera::eIMAX, 11);
    EXPECT_EQ(FbxCamera::eFitStretch, 5);
    EXPECT_EQ(FbxCamera::eFixedHeight, 4);
}

TEST_F(FbxCameraTest, AnimatesWhatFilesAnimate) {
    EXPECT_TRUE(camera->FieldOfView.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_TRUE(camera->FocalLength.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_TRUE(camera->Roll.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_FALSE(camera->FilmWidth.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_FALSE(camera->NearPlane.GetFlag(FbxPropertyFlags::eAnimatable));
}

TEST_F(FbxCameraTest, KeepsAnglesAndFocalLengthIndependent) {
    camera->FocalLength.Set(100.0);
    EXPECT_EQ(camera->FieldOfView.Get(), 25.114999771118164);

    camera->FieldOfView.Set(60.0);
    EXPECT_EQ(camera->FocalLength.Get(), 100.0);
}

TEST_F(FbxCameraTest, ComputesTheLensOverTheHeightInVerticalMode) {
    camera->SetApertureMode(FbxCamera::eVertical);

    // Pairs that files hold for this film back. In the first the angle has been rounded to single precision.
    constexpr double kSinglePrecision = 1e-6;
    EXPECT_NEAR(camera->ComputeFocalLength(25.114999771118164), 34.89327621672628, kSinglePrecision);
    EXPECT_NEAR(camera->ComputeFieldOfView(34.89327621672628), 25.114999771118164, kSinglePrecision);
    EXPECT_DOUBLE_EQ(camera->ComputeFocalLength(40.0), 21.354493494969105);
    EXPECT_DOUBLE_EQ(camera->ComputeFieldOfView(21.354493494969105), 40.0);
}

TEST_F(FbxCameraTest, ComputesTheLensOverTheWidthInTheOtherModes) {
    camera->SetApertureWidth(1.41732);
    for (const auto mode : {FbxCamera::eHorizontal, FbxCamera::eFocalLength, FbxCamera::eHorizAndVert}) {
        camera->SetApertureMode(mode);
        EXPECT_DOUBLE_EQ(camera->ComputeFocalLength(45.0), 43.45575721102746) << mode;
        EXPECT_DOUBLE_EQ(camera->ComputeFieldOfView(43.45575721102746), 45.0) << mode;
        // A file has 43.45584 with this width, of which it stores five decimals.
        EXPECT_NEAR(camera->ComputeFocalLength(45.0), 43.45584, 43.45584 * 0.000005 / 1.41732) << mode;
    }
}

TEST_F(FbxCameraTest, SqueezesTheWidthAlone) {
    camera->SetSqueezeRatio(2.0);

    camera->SetApertureMode(FbxCamera::eHorizontal);
    EXPECT_DOUBLE_EQ(camera->ComputeFocalLength(90.0), 0.816 * 25.4);
    camera->SetApertureMode(FbxCamera::eVertical);
    EXPECT_DOUBLE_EQ(camera->ComputeFocalLength(90.0), 0.612 * 25.4 / 2);
}

TEST_F(FbxCameraTest, ToleratesInvalidLenses) {
    const double infinity = std::numeric_limits<double>::infinity();

    EXPECT_EQ(camera->ComputeFocalLength(0.0), infinity);
    EXPECT_EQ(camera->ComputeFieldOfView(0.0), 180.0);
    EXPECT_EQ(camera->ComputeFieldOfView(infinity), 0.0);
    EXPECT_TRUE(std::isnan(camera->ComputeFocalLength(std::numeric_limits<double>::quiet_NaN())));
    camera->SetApertureHeight(0.0);
    EXPECT_EQ(camera->ComputeFocalLength(40.0), 0.0);
    EXPECT_EQ(camera->ComputeFieldOfView(35.0), 0.0);
}

TEST_F(FbxCameraTest, ToleratesAnInvalidApertureMode) {
    camera->ApertureMode.FbxProperty::Set(FbxEnum{77});

    EXPECT_EQ(static_cast<int>(camera->GetApertureMode()), 77);
    EXPECT_DOUBLE_EQ(camera->ComputeFocalLength(90.0), 0.816 * 25.4 / 2);
}

TEST_F(FbxCameraTest, KnowsTheFilmBacks) {
    const struct {
        FbxCamera::EApertureFormat format;
        double width, height, squeeze;
    } formats[] = {{FbxCamera::e16mmTheatrical, .404, .295, 1},
                   {FbxCamera::eSuper16mm, .493, .292, 1},
                   {FbxCamera::e35mmAcademy, .864, .630, 1},
                   {FbxCamera::e35mmTVProjection, .816, .612, 1},
                   {FbxCamera::e35mmFullAperture, .980, .735, 1},
                   {FbxCamera::e35mm185Projection, .825, .446, 1},
                   {FbxCamera::e35mmAnamorphic, .864, .732, 2},
                   {FbxCamera::e70mmProjection, 2.066, .906, 1},
                   {FbxCamera::eVistaVision, 1.485, .991, 1},
                   {FbxCamera::eDynaVision, 2.080, 1.480, 1},
                   {FbxCamera::eIMAX, 2.772, 2.072, 1}};
    for (const auto& each : formats) {
        camera->SetApertureFormat(each.format);
        EXPECT_EQ(camera->GetApertureFormat(), each.format);
        EXPECT_EQ(camera->GetApertureWidth(), each.width);
        EXPECT_EQ(camera->GetApertureHeight(), each.height);
        EXPECT_EQ(camera->GetSqueezeRatio(), each.squeeze);
        EXPECT_EQ(camera->FilmAspectRatio.Get(), each.width / each.height);
    }
}

TEST_F(FbxCameraTest, KeepsTheFilmWithACustomFormat) {
    camera->SetApertureFormat(FbxCamera::eIMAX);

    camera->SetApertureFormat(FbxCamera::eCustomAperture);

    EXPECT_EQ(camera->GetApertureWidth(), 2.772);
    EXPECT_EQ(camera->FilmFormat.Get<FbxEnum>(), 0);
}

TEST_F(FbxCameraTest, HoldsPlanesInRangeThroughTheSettersAlone) {
    camera->SetNearPlane(0.0);
    EXPECT_EQ(camera->GetNearPlane(), 0.001);
    camera->SetFarPlane(1e9);
    EXPECT_EQ(camera->GetFarPlane(), 600000.0);
    camera->SetNearPlane(std::numeric_limits<double>::quiet_NaN());
    EXPECT_EQ(camera->GetNearPlane(), 0.001);
    camera->SetNearPlane(25.5);
    EXPECT_EQ(camera->GetNearPlane(), 25.5);

    camera->NearPlane.Set(-1.0);
    camera->FarPlane.Set(1e9);
    EXPECT_EQ(camera->GetNearPlane(), -1.0);
    EXPECT_EQ(camera->GetFarPlane(), 1e9);
}

TEST_F(FbxCameraTest, SetsTheAspect) {
    camera->SetAspect(FbxCamera::eFixedResolution, 1920, 1080);
    camera->SetPixelRatio(1.5);

    EXPECT_EQ(camera->AspectRatioMode.Get(), FbxCamera::eFixedResolution);
    EXPECT_EQ(camera->AspectWidth.Get(), 1920.0);
    EXPECT_EQ(camera->AspectHeight.Get(), 1080.0);
    EXPECT_EQ(camera->GetPixelRatio(), 1.5);
}

TEST_F(FbxCameraTest, HasNoFilmOffsetOfTwoNumbers) { EXPECT_FALSE(camera->FindProperty("FilmOffset").IsValid()); }

using FbxCameraStereoTest = SceneFixture;

TEST_F(FbxCameraStereoTest, IsACameraWithTwoEyes) {
    FbxCameraStereo* rig = make<FbxCameraStereo>("rig");
    FbxCamera* left = make<FbxCamera>("left");
    FbxCamera* right = make<FbxCamera>("right");

    EXPECT_EQ(rig->GetAttributeType(), FbxNodeAttribute::eCameraStereo);
    EXPECT_TRUE(rig->Is<FbxCamera>());
    EXPECT_EQ(rig->FieldOfView.Get(), 25.114999771118164);
    EXPECT_EQ(rig->Stereo.Get(), 0);
    EXPECT_EQ(rig->InteraxialSeparation.Get(), 0.0);
    EXPECT_TRUE(rig->ZeroParallax.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_EQ(rig->GetLeftCamera(), nullptr);

    rig->SetLeftCamera(left);
    rig->SetRightCamera(left);
    rig->SetRightCamera(right);
    EXPECT_EQ(rig->GetLeftCamera(), left);
    EXPECT_EQ(rig->GetRightCamera(), right);
    EXPECT_EQ(rig->FindProperty("RightCamera").GetSrcObjectCount(), 1);

    rig->SetLeftCamera(nullptr);
    EXPECT_EQ(rig->GetLeftCamera(), nullptr);
    EXPECT_EQ(rig->GetRightCamera(), right);
}

using FbxCameraSwitcherTest = SceneFixture;

TEST_F(FbxCameraSwitcherTest, HasAnAnimatableIndex) {
    FbxCameraSwitcher* switcher = make<FbxCameraSwitcher>("Camera Switcher");

    EXPECT_EQ(switcher->GetAttributeType(), FbxNodeAttribute::eCameraSwitcher);
    EXPECT_STREQ(switcher->CameraIndex.GetNameAsCStr(), "Camera Index");
    EXPECT_EQ(switcher->CameraIndex.Get(), 0);
    EXPECT_TRUE(switcher->CameraIndex.GetFlag(FbxPropertyFlags::eAnimatable));
    switcher->CameraIndex.Set(3);
    EXPECT_EQ(switcher->CameraIndex.Get(), 3);
}

} // namespace
