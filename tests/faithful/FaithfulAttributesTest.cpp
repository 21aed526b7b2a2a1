// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras, lights, markers and nulls.
#include "FaithfulFixture.h"

#include "TnFbxError.h"

#include <cmath>

namespace Tarnell::Fbx::test {
namespace {

constexpr double kRadians = 0.017453292519943295769;

fbxsdk::FbxCamera& addCamera(TestScene& scene) {
    fbxsdk::FbxCamera& camera = *scene.add<fbxsdk::FbxCamera>("camera")->GetCamera();
    camera.FilmWidth.Set(1.0);
    camera.FilmHeight.Set(0.5);
    return camera;
}

double valueOf(const TnFbxCamera& camera, TnFbxCamera::EFbxCameraChannelType channel) {
    return static_cast<double>(camera.getValue(channel));
}

/// Focal length, both angles and the film are consistent.
void expectLensAgrees(const TnFbxCamera& camera, double focalLength) {
    const double width = valueOf(camera, TnFbxCamera::kFbxCameraApertureWidth) * 25.4;
    const double height = valueOf(camera, TnFbxCamera::kFbxCameraApertureHeight) * 25.4;
    EXPECT_NEAR(valueOf(camera, TnFbxCamera::kFbxCameraFocalLength), focalLength, 1e-4);
    EXPECT_NEAR(std::tan(valueOf(camera, TnFbxCamera::kFbxCameraFieldOfViewX) / 2.0 * kRadians),
                width / 2.0 / focalLength, 1e-5);
    EXPECT_NEAR(std::tan(valueOf(camera, TnFbxCamera::kFbxCameraFieldOfViewY) / 2.0 * kRadians),
                height / 2.0 / focalLength, 1e-5);
}

TEST(FaithfulLens, FollowsTheAngleThatDrivesIt) {
    TestScene scene;
    fbxsdk::FbxCamera& source = addCamera(scene);
    source.FieldOfView.Set(90.0);
    source.FilmSqueezeRatio.Set(2.0);
    source.SetApertureMode(fbxsdk::FbxCamera::eHorizontal);
    expectLensAgrees(readFaithfully<TnFbxCamera>(scene)["camera"], 25.4);
    source.SetApertureMode(fbxsdk::FbxCamera::eVertical);
    auto vertical = readFaithfully<TnFbxCamera>(scene);
    expectLensAgrees(vertical["camera"], 6.35);
    EXPECT_EQ(vertical["camera"].getApertureMode(), TnFbxCamera::kFbxApertureVertical);
    EXPECT_NEAR(valueOf(vertical["camera"], TnFbxCamera::kFbxCameraFieldOfView), 90.0, 1e-4);
}

TEST(FaithfulLens, TakesTheShapeOfItsFilmFromTwoAngles) {
    TestScene scene;
    fbxsdk::FbxCamera& source = addCamera(scene);
    source.FieldOfViewX.Set(90.0);
    source.FieldOfViewY.Set(60.0);
    source.SetApertureMode(fbxsdk::FbxCamera::eHorizAndVert);
    auto read = readFaithfully<TnFbxCamera>(scene);
    expectLensAgrees(read["camera"], 12.7);
    EXPECT_NEAR(valueOf(read["camera"], TnFbxCamera::kFbxCameraFieldOfViewY), 60.0, 1e-4);
}

TEST(FaithfulLens, AgreesAtEveryFrame) {
    TestScene scene(0, 2);
    fbxsdk::FbxCamera& source = addCamera(scene);
    source.SetApertureMode(fbxsdk::FbxCamera::eFocalLength);
    scene.key(source.FocalLength, nullptr, {{0, 12.7f}, {2, 25.4f}});
    auto read = readFaithfully<TnFbxCamera>(scene);
    EXPECT_THAT(samplesOf(read["camera"], TnFbxCamera::kFbxCameraFocalLength), isNear({12.7f, 19.05f, 25.4f}));
    const auto angles = samplesOf(read["camera"], TnFbxCamera::kFbxCameraFieldOfViewX);
    ASSERT_EQ(angles.size(), 3u);
    EXPECT_NEAR(static_cast<double>(angles[0]), 90.0, 1e-4);
    EXPECT_FALSE(read["camera"].getAnimated(TnFbxCamera::kFbxCameraApertureWidth));
}

TEST(FaithfulCamera, HasBothFilmOffsetsAndItsRoll) {
    TestScene scene;
    fbxsdk::FbxCamera& source = addCamera(scene);
    source.FilmOffsetX.Set(0.25);
    source.FilmOffsetY.Set(0.5);
    source.Roll.Set(30.0);
    auto read = readFaithfully<TnFbxCamera>(scene);
    EXPECT_EQ(read["camera"].getValue(TnFbxCamera::kFbxCameraFilmOffsetX), 0.25f);
    EXPECT_EQ(read["camera"].getValue(TnFbxCamera::kFbxCameraFilmOffsetY), 0.5f);
    EXPECT_EQ(read["camera"].getValue(TnFbxCamera::kFbxCameraRoll), 30.0f);
}

TEST(FaithfulCamera, LooksAlongMinusZ) {
    TestScene scene;
    addCamera(scene); // along X in the file
    EXPECT_THAT(rotationOf(readFaithfully<TnFbxCamera>(scene)["camera"]), isNear({0.0f, -90.0f, 0.0f}));
}

TEST(FaithfulCamera, IsInTheWorldBelowAParent) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set(fbxsdk::FbxDouble3(5.0, 0.0, 0.0));
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxCamera>("camera", parent);
    node->LclTranslation.Set(fbxsdk::FbxDouble3(1.0, 0.0, 0.0));
    EXPECT_THAT(positionOf(readFaithfully<TnFbxCamera>(scene)["camera"]), isNear({6.0f, 0.0f, 0.0f}));
}

TEST(FaithfulCamera, LooksAtItsInterestInCentimetres) {
    TestScene scene(0, 2);
    scene.scene->GetGlobalSettings().SetSystemUnit(fbxsdk::FbxSystemUnit(/*pScaleFactor*/ 100.0));
    fbxsdk::FbxCamera& source = addCamera(scene);
    source.GetNode()->LclTranslation.Set(fbxsdk::FbxDouble3(1.0, 2.0, 3.0));
    source.InterestPosition.Set(fbxsdk::FbxDouble3(4.0, 2.0, 3.0));
    scene.key(source.InterestPosition, "Y", {{0, 2.0f}, {2, 6.0f}});
    auto read = readFaithfully<TnFbxCamera>(scene);
    TnFbxCamera& camera = read["camera"];
    EXPECT_NEAR(valueOf(camera, TnFbxCamera::kFbxCameraLookAtPositionX), 400.0, 1e-3);
    EXPECT_NEAR(static_cast<double>(camera.getTransformValue(TnFbxTransform::kFbxTransformPositionX)), 100.0, 1e-3);
    EXPECT_THAT(samplesOf(camera, TnFbxCamera::kFbxCameraLookAtPositionY), isNear({200.0f, 400.0f, 600.0f}));
}

TEST(FaithfulCamera, TurnsTowardItsTargetAndRolls) {
    TestScene scene(0, 4);
    fbxsdk::FbxCamera& source = addCamera(scene);
    source.Roll.Set(90.0);
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set(fbxsdk::FbxDouble3(0.0, 0.0, -10.0));
    scene.key(target->LclTranslation, "X", {{0, 0.0f}, {4, 10.0f}});
    scene.scene->GetRootNode()->FindChild("camera")->SetTarget(target);
    auto read = readFaithfully<TnFbxCamera>(scene);
    EXPECT_THAT(samplesOf(read["camera"], TnFbxCamera::kFbxCameraLookAtPositionX),
                isNear({0.0f, 2.5f, 5.0f, 7.5f, 10.0f}));
    EXPECT_EQ(read["camera"].getValue(TnFbxCamera::kFbxCameraLookAtPositionZ), -10.0f);
    EXPECT_THAT(rotationOf(read["camera"]), isNear({0.0f, 0.0f, -90.0f}));
    EXPECT_TRUE(read["camera"].getTransformAnimated(TnFbxTransform::kFbxTransformRotationX) ||
                read["camera"].getTransformAnimated(TnFbxTransform::kFbxTransformRotationY));
}

TEST(FaithfulLight, ShinesAlongMinusZWhateverItsType) {
    for (const auto type : {fbxsdk::FbxLight::ePoint, fbxsdk::FbxLight::eDirectional, fbxsdk::FbxLight::eSpot}) {
        TestScene scene(0, 1);
        fbxsdk::FbxLight& light = *scene.add<fbxsdk::FbxLight>("light")->GetLight(); // along −Y in the file
        light.LightType.Set(type);
        scene.key(light.Intensity, nullptr, {{0, 0.0f}, {1, 50.0f}});
        auto read = readFaithfully<TnFbxLight>(scene);
        EXPECT_THAT(rotationOf(read["light"]), isNear({-90.0f, 0.0f, 0.0f}));
        EXPECT_THAT(samplesOf(read["light"], TnFbxLight::kFbxLightIntensity), isNear({0.0f, 0.5f}));
    }
}

TEST(FaithfulMarkers, HaveTheirLookSizeColourAndPlace) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMarker>("marker");
    fbxsdk::FbxMarker& marker = *node->GetMarker();
    marker.Look.Set(fbxsdk::FbxMarker::eSphere);
    marker.Size.Set(12.0);
    node->LclTranslation.Set(fbxsdk::FbxDouble3(1, 2, 3));
    scene.key(marker.Color, "X", {{0, 0.25f}, {1, 0.75f}});

    auto read = readFaithfully<TnFbxMarker>(scene);

    ASSERT_EQ(read.count, 1);
    EXPECT_EQ(read["marker"].getMarkerLookType(), TnFbxMarker::kFbxMarkerLookSphere);
    EXPECT_EQ(read["marker"].getMarkerSize(), 12.0f);
    EXPECT_EQ(read["marker"].getTransformValue(TnFbxTransform::kFbxTransformPositionY), 2.0f);
    EXPECT_EQ(read["marker"].getValueAt(TnFbxMarker::kFbxMarkerRed, 0.0f), 0.25f);
    EXPECT_EQ(read["marker"].getValueAt(TnFbxMarker::kFbxMarkerRed, 1.0f), 0.75f);
    EXPECT_EQ(read["marker"].getValue(TnFbxMarker::kFbxMarkerAlpha), 1.0f) << "files have none";
}

TEST(FaithfulSizes, AreThoseOfTheFrameAndReportedAsAnimated) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxNull>("null");
    scene.key(node->GetNull()->Size, nullptr, {{0, 10.0f}, {10, 20.0f}});
    const SavedScene saved(scene);
    TnFbxReadInfo info = saved.info();
    info.setFrame(5.0f);
    EXPECT_EQ(FacadeRead<TnFbxNull>(info)["null"].getNullSize(), 15.0f);
    EXPECT_THAT(lastWarnings(), testing::ElementsAre(testing::HasSubstr("the size of \"null\" is animated")));
}

} // namespace
} // namespace Tarnell::Fbx::test
