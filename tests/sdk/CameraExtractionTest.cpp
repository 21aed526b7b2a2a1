// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading cameras from nodes: their placement, lens and film.
#include "CameraScenes.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using namespace test;

constexpr auto kPositionX = Transform::kFbxTransformPositionX;
constexpr auto kRotationY = Transform::kFbxTransformRotationY;

// ---- Placement ----

TEST(CameraExtraction, ReadsNamePlacementAndOrder) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    node->LclTranslation.Set({1.0, 2.0, 3.0});
    node->LclRotation.Set({10.0, 20.0, 30.0});
    node->LclScaling.Set({2.0, 3.0, 4.0});
    node->SetRotationOrder(fbxsdk::FbxNode::eSourcePivot, fbxsdk::FbxEuler::eOrderYXZ);

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getName(), "shot");
    EXPECT_EQ(camera.getTransformValue(kPositionX), 1.0f);
    EXPECT_EQ(rotationOf(camera), Samples({10.0f, 20.0f, 30.0f}));
    EXPECT_EQ(camera.getTransformValue(Transform::kFbxTransformScaleZ), 4.0f);
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderYXZ);
    EXPECT_EQ(camera.getTransformTransformOrder(), Transform::kFbxTransformOrderDefault);
}

TEST(CameraExtraction, ReadsItsOwnPlacementLocallyAlsoInTheWorld) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set({100.0, 0.0, 0.0});
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxCamera>("shot", parent);
    node->LclTranslation.Set({1.0, 0.0, 0.0});

    EXPECT_EQ(readCamera(scene, node, {/*global*/ true}).getTransformValue(kPositionX), 1.0f);
}

TEST(CameraExtraction, SamplesPlacement) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene);
    scene.key(node->LclTranslation, "X", {{0, 1.0f}, {1, 2.0f}});
    scene.key(node->LclRotation, "Y", {{0, 3.0f}, {1, 4.0f}});
    scene.key(node->LclScaling, "Z", {{0, 5.0f}, {1, 6.0f}});

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(samplesOf(camera, kPositionX), Samples({1.0f, 2.0f}));
    EXPECT_EQ(samplesOf(camera, kRotationY), Samples({3.0f, 4.0f}));
    EXPECT_EQ(samplesOf(camera, Transform::kFbxTransformScaleZ), Samples({5.0f, 6.0f}));
}

// ---- Lens and film ----

TEST(CameraExtraction, ReadsAperturePlanesAndProjection) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    fbxsdk::FbxCamera* source = node->GetCamera();
    source->SetApertureWidth(1.25);
    source->SetApertureHeight(0.75);
    source->SetNearPlane(0.5);
    source->SetFarPlane(1234.0);
    source->ProjectionType.Set(fbxsdk::FbxCamera::eOrthogonal);

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraApertureWidth), 1.25f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraApertureHeight), 0.75f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraNearPlane), 0.5f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFarPlane), 1234.0f);
    EXPECT_EQ(camera.getProjectionType(), Camera::kFbxCameraOrthographic);
}

TEST(CameraExtraction, MapsProjections) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    Camera camera = cameraInOtherModes();

    node->GetCamera()->ProjectionType.Set(fbxsdk::FbxCamera::ePerspective);
    EXPECT_TRUE(readInto(scene, node, camera));
    EXPECT_EQ(camera.getProjectionType(), Camera::kFbxCameraPerspective);

    node->GetCamera()->ProjectionType.Set(fbxsdk::FbxCamera::eOrthogonal);
    EXPECT_TRUE(readInto(scene, node, camera));
    EXPECT_EQ(camera.getProjectionType(), Camera::kFbxCameraOrthographic);
}

TEST(CameraExtraction, MapsApertureModes) {
    struct Row {
        fbxsdk::FbxCamera::EApertureMode fbx;
        Camera::EFbxCameraApertureMode mode;
    };
    const Row rows[] = {{fbxsdk::FbxCamera::eHorizAndVert, Camera::kFbxApertureHorizontalAndVertical},
                        {fbxsdk::FbxCamera::eHorizontal, Camera::kFbxApertureFocalLength},
                        {fbxsdk::FbxCamera::eVertical, Camera::kFbxApertureFocalLength},
                        {fbxsdk::FbxCamera::eFocalLength, Camera::kFbxApertureFocalLength}};
    for (const Row& row : rows) {
        TestScene scene;
        Camera camera = cameraInOtherModes();
        EXPECT_TRUE(readInto(scene, addCamera(scene, row.fbx), camera));
        EXPECT_EQ(camera.getApertureMode(), row.mode) << row.fbx;
    }
}

TEST(CameraExtraction, KeepsTheProjectionForAnInvalidNumber) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    static_cast<fbxsdk::FbxProperty&>(node->GetCamera()->ProjectionType).Set(5);
    Camera camera;
    camera.setProjectionType(Camera::kFbxCameraOrthographic);

    EXPECT_TRUE(readInto(scene, node, camera));

    EXPECT_EQ(camera.getProjectionType(), Camera::kFbxCameraOrthographic);
}

TEST(CameraExtraction, ReadsTheFocalLengthInItsMode) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene, fbxsdk::FbxCamera::eFocalLength);
    node->GetCamera()->FocalLength.Set(35.0);
    scene.key(node->GetCamera()->FocalLength, nullptr, {{0, 40.0f}, {1, 50.0f}});
    scene.key(node->GetCamera()->FieldOfView, nullptr, {{0, 60.0f}, {1, 70.0f}});

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getApertureMode(), Camera::kFbxApertureFocalLength);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFocalLength), 35.0f);
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraFocalLength), Samples({40.0f, 50.0f}));
}

TEST(CameraExtraction, TurnsASampledFieldOfViewIntoFocalLengthsButNotAStaticOne) {
    struct Row {
        fbxsdk::FbxCamera::EApertureMode mode;
        double aperture;
    };
    for (const Row& row : {Row{fbxsdk::FbxCamera::eHorizontal, 0.816}, Row{fbxsdk::FbxCamera::eVertical, 0.612}}) {
        TestScene scene(0, 1);
        fbxsdk::FbxNode* node = addCamera(scene, row.mode);
        node->GetCamera()->SetApertureWidth(0.816);
        node->GetCamera()->SetApertureHeight(0.612);
        node->GetCamera()->FieldOfView.Set(30.0);
        scene.key(node->GetCamera()->FieldOfView, nullptr, {{0, 60.0f}, {1, 90.0f}});

        const Camera camera = readCamera(scene, node);

        EXPECT_EQ(camera.getApertureMode(), Camera::kFbxApertureFocalLength);
        EXPECT_EQ(camera.getValue(Camera::kFbxCameraFocalLength), Camera::kDefaultCameraFocalLength);
        const Samples samples = samplesOf(camera, Camera::kFbxCameraFocalLength);
        ASSERT_EQ(samples.size(), 2u);
        const double halfFilm = row.aperture * 25.4 / 2.0;
        EXPECT_FLOAT_EQ(samples[0], static_cast<float>(halfFilm / std::tan(30.0 * M_PI / 180.0)));
        EXPECT_FLOAT_EQ(samples[1], static_cast<float>(halfFilm));
    }
}

TEST(CameraExtraction, LeavesTheFocalLengthAloneForAFieldOfViewThatIsNotAnimated) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene, fbxsdk::FbxCamera::eVertical);
    node->GetCamera()->FieldOfView.Set(30.0);

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getApertureMode(), Camera::kFbxApertureFocalLength);
    EXPECT_FALSE(camera.getAnimated(Camera::kFbxCameraFocalLength));
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFocalLength), Camera::kDefaultCameraFocalLength);
}

TEST(CameraExtraction, SamplesBothFieldsOfViewWithoutStaticValues) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene, fbxsdk::FbxCamera::eHorizAndVert);
    node->GetCamera()->FieldOfViewX.Set(11.0);
    node->GetCamera()->FieldOfViewY.Set(12.0);
    scene.key(node->GetCamera()->FieldOfViewX, nullptr, {{0, 60.0f}, {1, 70.0f}});
    scene.key(node->GetCamera()->FieldOfViewY, nullptr, {{0, 30.0f}, {1, 35.0f}});

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getApertureMode(), Camera::kFbxApertureHorizontalAndVertical);
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraFieldOfViewX), Samples({60.0f, 70.0f}));
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraFieldOfViewY), Samples({30.0f, 35.0f}));
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFieldOfViewX), Camera::kDefaultCameraFieldOfViewX);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFieldOfViewY), Camera::kDefaultCameraFieldOfViewY);
}

TEST(CameraExtraction, NeverReadsTheSingleFieldOfView) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->FieldOfView.Set(30.0);
    scene.key(node->GetCamera()->FieldOfView, nullptr, {{0, 60.0f}, {1, 90.0f}});

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFieldOfView), Camera::kDefaultCameraFieldOfView);
    EXPECT_FALSE(camera.getAnimated(Camera::kFbxCameraFieldOfView));
}

TEST(CameraExtraction, KeepsTheLensForAnInvalidApertureMode) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene);
    static_cast<fbxsdk::FbxProperty&>(node->GetCamera()->ApertureMode).Set(9);
    node->GetCamera()->FocalLength.Set(35.0);
    Camera camera;
    camera.setApertureMode(Camera::kFbxApertureVertical);

    EXPECT_TRUE(readInto(scene, node, camera));

    EXPECT_EQ(camera.getApertureMode(), Camera::kFbxApertureVertical);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFocalLength), Camera::kDefaultCameraFocalLength);
}

TEST(CameraExtraction, ReadsFilmOffsets) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->FilmOffsetX.Set(0.25);
    node->GetCamera()->FilmOffsetY.Set(0.5);
    scene.key(node->GetCamera()->FilmOffsetX, nullptr, {{0, 1.0f}, {1, 2.0f}});
    scene.key(node->GetCamera()->FilmOffsetY, nullptr, {{0, 3.0f}, {1, 4.0f}});

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFilmOffsetX), 0.25f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFilmOffsetY), 0.5f);
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraFilmOffsetX), Samples({1.0f, 2.0f}));
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraFilmOffsetY), Samples({3.0f, 4.0f}));
}

TEST(CameraExtraction, OverwritesTheFilmOffsetYWithXWhenThereIsAPropertyFilmOffset) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->FilmOffsetX.Set(0.25);
    node->GetCamera()->FilmOffsetY.Set(0.5);
    scene.key(node->GetCamera()->FilmOffsetY, nullptr, {{0, 3.0f}, {1, 4.0f}});
    fbxsdk::FbxProperty::Create(node->GetCamera(), fbxsdk::FbxDouble2DT, "FilmOffset");

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFilmOffsetX), 0.25f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFilmOffsetY), 0.25f);
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraFilmOffsetY), Samples({3.0f, 4.0f}));
}

TEST(CameraExtraction, LooksForTheFilmOffsetWithItsCase) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->FilmOffsetX.Set(0.25);
    node->GetCamera()->FilmOffsetY.Set(0.5);
    fbxsdk::FbxProperty::Create(node->GetCamera(), fbxsdk::FbxDouble2DT, "filmoffset");

    EXPECT_EQ(readCamera(scene, node).getValue(Camera::kFbxCameraFilmOffsetY), 0.5f);
}

TEST(CameraExtraction, WithoutCurvesLeavesEveryChannelUnanimated) {
    TestScene scene(0, 10);

    const Camera camera = readCamera(scene, addCamera(scene));

    for (int i = 0; i <= Camera::kFbxCameraFilmOffsetY; ++i)
        EXPECT_FALSE(camera.getAnimated(static_cast<Camera::EFbxCameraChannelType>(i))) << i;
    for (int i = 0; i <= Transform::kFbxTransformPivotZ; ++i)
        EXPECT_FALSE(camera.getTransformAnimated(static_cast<Transform::EFbxTransformChannelType>(i))) << i;
}

TEST(CameraExtraction, KeepsWhatTheObjectHeldInChannelsItDoesNotFill) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    Camera camera;
    camera.setValue(Camera::kFbxCameraFieldOfView, 77.0f);
    camera.setValue(Camera::kFbxCameraLookAtPositionX, 78.0f);

    EXPECT_TRUE(readInto(scene, node, camera));

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFieldOfView), 77.0f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionX), 78.0f);
}

TEST(CameraExtraction, ConvertsKeyFramesToTheSampleRate) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = addCamera(scene);
    scene.key(node->GetCamera()->Roll, nullptr, {{0, 0.0f}, {10, 10.0f}});

    const Camera camera = readCamera(scene, node, {false, false, /*useSampleRate*/ true, 48.0f});

    test::expectRange(camera.getTime(Camera::kFbxCameraRoll), 0, 20, 24.0f);
}

TEST(CameraExtraction, FailsWithoutANodeOrACamera) {
    TestScene scene;
    Camera camera;

    EXPECT_FALSE(readInto(scene, nullptr, camera));
    EXPECT_FALSE(readInto(scene, scene.addNode("bare"), camera));
    EXPECT_FALSE(readInto(scene, scene.add<fbxsdk::FbxLight>("light"), camera));
    EXPECT_EQ(camera.getName(), "");
    EXPECT_FALSE(lastError().empty());
}

} // namespace
} // namespace Tarnell::Fbx
