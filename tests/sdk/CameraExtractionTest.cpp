// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cameras out of nodes, and producer cameras.
#include "support/MemoryLimitScope.h"
#include "support/SceneBuilders.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace Tarnell::Fbx {
namespace {

using test::samplesOf;
using test::TestScene;
using Camera = TnFbxCamera;
using Samples = std::vector<float>;
using Transform = TnFbxTransform;

constexpr auto kPositionX = Transform::kFbxTransformPositionX;
constexpr auto kRotationX = Transform::kFbxTransformRotationX;
constexpr auto kRotationY = Transform::kFbxTransformRotationY;
constexpr auto kRotationZ = Transform::kFbxTransformRotationZ;

struct ReadOptions {
    bool global = false;
    bool useInterestPosition = false;
    bool useSampleRate = false;
    float sampleRate = 0.0f;
};

bool readInto(TestScene& scene, fbxsdk::FbxNode* node, Camera& camera, ReadOptions options = {}) {
    TnFbxTime time = scene.time();
    fbxsdk::FbxAMatrix geometric;
    return scene.sdk.getCamera(time, options.global, options.useSampleRate, options.sampleRate,
                               options.useInterestPosition, node, camera, geometric);
}

Camera readCamera(TestScene& scene, fbxsdk::FbxNode* node, ReadOptions options = {}) {
    Camera camera;
    EXPECT_TRUE(readInto(scene, node, camera, options));
    return camera;
}

fbxsdk::FbxNode* addCamera(TestScene& scene, fbxsdk::FbxCamera::EApertureMode mode = fbxsdk::FbxCamera::eFocalLength) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxCamera>("shot");
    node->GetCamera()->SetApertureMode(mode);
    return node;
}

Samples rotationAt(const Camera& camera, float frame) {
    float x = 0.0f, y = 0.0f, z = 0.0f;
    camera.calculateCameraRotationAt(x, y, z, frame);
    return {x, y, z};
}

Samples rotationOf(const Camera& camera) {
    return {camera.getTransformValue(kRotationX), camera.getTransformValue(kRotationY),
            camera.getTransformValue(kRotationZ)};
}

/// A camera whose modes are not those of a new one nor any that is read.
Camera cameraInOtherModes() {
    Camera camera;
    camera.setApertureMode(Camera::kFbxApertureVertical);
    camera.setProjectionType(Camera::kFbxCameraOrthographic);
    camera.setTransformRotationOrder(Transform::kFbxRotationOrderXYZ);
    return camera;
}

TnFbxTime timeRecord(int startFrame, int endFrame, float rate) {
    TnFbxTime time;
    time.setTime(0.0f, startFrame, endFrame, rate);
    return time;
}

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

// ---- Looking at something ----

TEST(CameraExtraction, ReadsNoLookAtPointWithoutATarget) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->InterestPosition.Set({1.0, 2.0, 3.0});

    EXPECT_EQ(readCamera(scene, node).getValue(Camera::kFbxCameraLookAtPositionX), 0.0f);
}

TEST(CameraExtraction, ComputesTheRotationTowardItsInterestPositionWhenAsked) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    node->LclTranslation.Set({0.0, 0.0, 10.0});
    node->LclRotation.Set({77.0, 77.0, 77.0});
    node->GetCamera()->InterestPosition.Set({10.0, 0.0, 10.0});

    const Camera camera = readCamera(scene, node, {false, /*useInterestPosition*/ true});

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionX), 10.0f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionZ), 10.0f);
    EXPECT_EQ(rotationOf(camera), rotationAt(camera, 0.0f));
    EXPECT_FLOAT_EQ(camera.getTransformValue(kRotationY), -90.0f);
    EXPECT_FALSE(camera.getTransformAnimated(kRotationY));
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
}

TEST(CameraExtraction, ComputesTheRotationOnceAtFrameZeroWhenNothingIsAnimated) {
    TestScene scene(5, 9);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->InterestPosition.Set({0.0, 5.0, 0.0});

    const Camera camera = readCamera(scene, node, {false, true});

    EXPECT_EQ(rotationOf(camera), rotationAt(camera, 0.0f));
    EXPECT_EQ(camera.getTransformValue(kRotationX), 90.0f);
    for (const auto channel : {kRotationX, kRotationY, kRotationZ}) {
        EXPECT_FALSE(camera.getTransformAnimated(channel));
    }
}

TEST(CameraExtraction, ComputesTheRotationForEveryFrameOfAnimatedIngredients) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->InterestPosition.Set({0.0, 0.0, -100.0});
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {3, 30.0f}});
    scene.key(node->GetCamera()->Roll, nullptr, {{-1, 0.0f}, {2, 90.0f}});
    Camera camera;
    for (const auto channel : {kRotationX, kRotationY, kRotationZ}) {
        camera.setTransformValue(channel, 77.0f);
    }

    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));

    for (const auto channel : {kRotationX, kRotationY, kRotationZ}) {
        test::expectRange(camera.getTransformTime(channel), -1, 3, 24.0f);
    }
    for (int frame = -1; frame <= 3; ++frame) {
        const auto at = static_cast<float>(frame);
        const Samples expected = rotationAt(camera, at);
        EXPECT_EQ(camera.getTransformValueAt(kRotationX, at), expected[0]);
        EXPECT_EQ(camera.getTransformValueAt(kRotationY, at), expected[1]);
        EXPECT_EQ(camera.getTransformValueAt(kRotationZ, at), expected[2]);
    }
    EXPECT_NE(camera.getTransformValueAt(kRotationY, 0.0f), camera.getTransformValueAt(kRotationY, 3.0f));
    EXPECT_EQ(rotationOf(camera), Samples({77.0f, 77.0f, 77.0f})); // no static values
}

TEST(CameraExtraction, ComputesTheRotationOnceForIngredientsThatStartAtFrameTenMillion) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set({0.0, 0.0, -10.0});
    node->SetTarget(target);
    for (const int start : {9999999, 10000000}) {
        SCOPED_TRACE(start);
        TnFbxTime time = timeRecord(start, start + 1, 24.0f);
        fbxsdk::FbxAMatrix geometric;
        Camera camera;

        EXPECT_TRUE(scene.sdk.getCamera(time, /*global*/ true, false, 0.0f, false, node, camera, geometric));

        EXPECT_TRUE(camera.getAnimated(Camera::kFbxCameraLookAtPositionX));
        EXPECT_EQ(camera.getTransformAnimated(kRotationX), start == 9999999);
    }
}

TEST(CameraExtraction, GivesAComputedRotationTheRateOfItsLastAnimatedIngredient) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = addCamera(scene);
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {2, 20.0f}});
    Camera camera; // the up vector is never sampled: these are the samples that the object brings
    camera.setValueAt(Camera::kFbxCameraUpPositionX, timeRecord(1, 2, 60.0f), {0.0f, 0.0f});
    camera.setValueAt(Camera::kFbxCameraUpPositionY, timeRecord(1, 5, 30.0f), Samples(5, 1.0f));
    camera.setValueAt(Camera::kFbxCameraFarPlane, timeRecord(-9, 9, 120.0f), Samples(19, 1.0f)); // no ingredient

    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));
    test::expectRange(camera.getTransformTime(kRotationX), 0, 5, 30.0f);

    scene.key(node->GetCamera()->Roll, nullptr, {{0, 0.0f}, {1, 9.0f}});
    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));
    test::expectRange(camera.getTransformTime(kRotationX), 0, 5, 24.0f);
}

TEST(CameraExtraction, TurnsInTheOrderZXYOnlyWhenItLooksAtSomething) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    node->SetRotationOrder(fbxsdk::FbxNode::eSourcePivot, fbxsdk::FbxEuler::eOrderYXZ);
    const auto orderReadWith = [&](ReadOptions options) {
        Camera camera = cameraInOtherModes();
        EXPECT_TRUE(readInto(scene, node, camera, options));
        return camera.getTransformRotationOrder();
    };

    EXPECT_EQ(orderReadWith({}), Transform::kFbxRotationOrderYXZ);
    EXPECT_EQ(orderReadWith({/*global*/ false, /*useInterestPosition*/ true}), Transform::kFbxRotationOrderZXY);
    node->SetTarget(scene.addNode("target"));
    EXPECT_EQ(orderReadWith({/*global*/ false}), Transform::kFbxRotationOrderZXY);
    EXPECT_EQ(orderReadWith({/*global*/ true}), Transform::kFbxRotationOrderZXY);
}

TEST(CameraExtraction, LooksAtTheTargetInTheWorld) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = addCamera(scene);
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set({0.0, 0.0, -10.0});
    fbxsdk::FbxNode* target = scene.addNode("target", parent);
    scene.key(target->LclTranslation, "X", {{0, 0.0f}, {2, 20.0f}});
    node->SetTarget(target);

    const Camera camera = readCamera(scene, node, {/*global*/ true});

    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraLookAtPositionX), Samples({0.0f, 10.0f, 20.0f}));
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraLookAtPositionZ), Samples({-10.0f, -10.0f, -10.0f}));
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionZ), -10.0f);
    test::expectRange(camera.getTime(Camera::kFbxCameraLookAtPositionX), 0, 2, 24.0f);
    EXPECT_FLOAT_EQ(camera.getTransformValueAt(kRotationY, 1.0f), -45.0f);
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
}

TEST(CameraExtraction, LooksAtTheTargetWithoutItsOwnGeometricTransform) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, fbxsdk::FbxVector4(5.0, 0.0, 0.0));
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set({1.0, 2.0, 3.0});
    node->SetTarget(target);
    TnFbxReadInfo info = test::readNamed("shot", /*global*/ true);
    Camera camera;

    EXPECT_TRUE(scene.sdk.getCameras(info, &camera, 1));

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionX), 1.0f);
}

TEST(CameraExtraction, TakesItsOwnTranslationForTheTargetsWhenReadLocally) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->LclTranslation.Set({4.0, 5.0, 6.0});
    scene.key(node->LclTranslation, "X", {{0, 1.0f}, {2, 3.0f}});
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set({7.0, 8.0, 9.0});
    scene.key(target->LclTranslation, "X", {{0, 100.0f}, {2, 300.0f}});
    node->SetTarget(target);
    const auto lookAt = {Camera::kFbxCameraLookAtPositionX, Camera::kFbxCameraLookAtPositionY,
                         Camera::kFbxCameraLookAtPositionZ};
    Camera camera;
    for (const auto channel : lookAt) {
        camera.setValue(channel, 77.0f);
    }

    EXPECT_TRUE(readInto(scene, node, camera));

    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraLookAtPositionX), samplesOf(camera, kPositionX));
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraLookAtPositionX), Samples({1.0f, 2.0f, 3.0f}));
    EXPECT_FALSE(camera.getAnimated(Camera::kFbxCameraLookAtPositionY));
    for (const auto channel : lookAt) {
        EXPECT_EQ(camera.getValue(channel), 77.0f); // no static values
    }
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
}

TEST(CameraExtraction, PrefersTheTargetToTheInterestPosition) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->InterestPosition.Set({50.0, 0.0, 0.0});
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set({0.0, 0.0, -5.0});
    node->SetTarget(target);

    const Camera camera = readCamera(scene, node, {/*global*/ true, /*useInterestPosition*/ true});

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionX), 0.0f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionZ), -5.0f);
}

TEST(CameraExtraction, KeepsTheLookAtPointForAnInvertedRange) {
    TestScene scene(5, 4);
    fbxsdk::FbxNode* node = addCamera(scene);
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set({0.0, 0.0, -5.0});
    node->SetTarget(target);

    const Camera camera = readCamera(scene, node, {/*global*/ true});

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionZ), 0.0f);
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
}

TEST(CameraExtraction, ReadsRollSampledAndUpVectorStatically) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->Roll.Set(5.0);
    node->GetCamera()->UpVector.Set({0.0, 0.5, 0.25});
    scene.key(node->GetCamera()->Roll, nullptr, {{0, 10.0f}, {1, 20.0f}});
    scene.key(node->GetCamera()->UpVector, "X", {{0, 1.0f}, {1, 2.0f}});

    const Camera camera = readCamera(scene, node);

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraRoll), 5.0f);
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraRoll), Samples({10.0f, 20.0f}));
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraUpPositionY), 0.5f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraUpPositionZ), 0.25f);
    EXPECT_FALSE(camera.getAnimated(Camera::kFbxCameraUpPositionX));
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

TEST(CameraExtraction, KeepsTheProjectionForANumberThatIsNone) {
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

TEST(CameraExtraction, KeepsTheLensForAnApertureModeThatIsNone) {
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

    for (int i = 0; i <= Camera::kFbxCameraFilmOffsetY; ++i) {
        EXPECT_FALSE(camera.getAnimated(static_cast<Camera::EFbxCameraChannelType>(i))) << i;
    }
    for (int i = 0; i <= Transform::kFbxTransformPivotZ; ++i) {
        EXPECT_FALSE(camera.getTransformAnimated(static_cast<Transform::EFbxTransformChannelType>(i))) << i;
    }
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

TEST(CameraExtraction, SurvivesAnAimThatIsNoNumber) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    const double nan = std::numeric_limits<double>::quiet_NaN();
    node->LclTranslation.Set({nan, nan, nan});
    node->GetCamera()->InterestPosition.Set({1e300, nan, -1e300});

    readCamera(scene, node, {false, true});
}

/// A camera that brings samples at both ends of the range of frames: so many, and the same number at the other end.
Camera cameraOfAllFrames(const std::vector<float>& samples) {
    const int count = static_cast<int>(samples.size());
    Camera camera;
    TnFbxTime first, last;
    first.setTime(0.0f, -2000000000, -2000000000 + count - 1, 24.0f);
    last.setTime(0.0f, 2000000000 - count + 1, 2000000000, 24.0f);
    camera.setValueAt(Camera::kFbxCameraLookAtPositionX, first, samples);
    camera.setValueAt(Camera::kFbxCameraLookAtPositionY, last, samples);
    return camera;
}

TEST(CameraExtraction, FailsWhenTheIngredientsSpanMoreFramesThanThereIsMemoryFor) {
    const support::MemoryLimitScope limit(1 << 30);
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    Camera camera = cameraOfAllFrames({1.0f, 2.0f});

    EXPECT_FALSE(readInto(scene, node, camera, {false, true}));

    EXPECT_NE(lastError().find("frames -2000000000 to 2000000000 at 24"), std::string::npos) << lastError();
    EXPECT_FALSE(camera.getTransformAnimated(kRotationX));
    EXPECT_EQ(rotationOf(camera), rotationAt(camera, 0.0f));
}

TEST(CameraExtraction, TakesOneRotationForAllFramesOfIngredientsThatDoNotChange) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    Camera camera = cameraOfAllFrames({1.0f});

    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));

    const TnFbxChannel& x = *camera.getTransformChannel(kRotationX);
    test::expectRange(x.getTime(), -2000000000, 2000000000, 24.0f);
    EXPECT_TRUE(x.isConstant());
    EXPECT_EQ(x.getAnimatedValue(1e9f), rotationAt(camera, 1e9f)[0]);
}

// ---- The frame range ----

TEST(CameraFrameRange, WidensAndTakesTheRate) {
    FbxSdk sdk;
    TnFbxTime time;
    time.setTime(0.0f, 3, 9, 30.0f);
    bool found = false;
    float rate = 24.0f;
    int start = 5, end = 7;

    sdk.getCameraFrameRange(time, found, rate, start, end);
    EXPECT_TRUE(found);
    EXPECT_EQ(rate, 30.0f);
    EXPECT_EQ(start, 3);
    EXPECT_EQ(end, 9);

    time.setTime(0.0f, 4, 8, 25.0f);
    sdk.getCameraFrameRange(time, found, rate, start, end);
    EXPECT_EQ(rate, 25.0f);
    EXPECT_EQ(start, 3);
    EXPECT_EQ(end, 9);
}

// ---- Producer cameras ----

TEST(ProducerCamera, IsReadStaticallyUnderTheGivenName) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = addCamera(scene, fbxsdk::FbxCamera::eHorizAndVert);
    node->SetRotationOrder(fbxsdk::FbxNode::eSourcePivot, fbxsdk::FbxEuler::eOrderZYX);
    fbxsdk::FbxCamera* source = node->GetCamera();
    source->Position.Set({0.0, 0.0, 10.0});
    source->InterestPosition.Set({10.0, 0.0, 10.0});
    source->UpVector.Set({0.0, 1.0, 0.0});
    source->FocalLength.Set(35.0);
    source->SetApertureWidth(1.5);
    source->SetApertureHeight(0.5);
    source->SetNearPlane(2.0);
    source->SetFarPlane(200.0);
    source->FilmOffsetX.Set(0.75);
    source->ProjectionType.Set(fbxsdk::FbxCamera::eOrthogonal);
    scene.key(source->Roll, nullptr, {{0, 0.0f}, {10, 10.0f}});
    Camera camera;

    EXPECT_TRUE(scene.sdk.getProducerCamera(node, source, camera, "Producer Front"));

    EXPECT_EQ(camera.getName(), "Producer Front");
    EXPECT_EQ(camera.getTransformValue(Transform::kFbxTransformPositionZ), 10.0f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionX), 10.0f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraUpPositionY), 1.0f);
    EXPECT_EQ(rotationOf(camera), rotationAt(camera, 0.0f));
    EXPECT_FLOAT_EQ(camera.getTransformValue(kRotationY), -90.0f);
    EXPECT_EQ(camera.getTransformValue(Transform::kFbxTransformScaleX), 1.0f);
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZYX);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraApertureWidth), 1.5f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraApertureHeight), 0.5f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFocalLength), 35.0f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraNearPlane), 2.0f);
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFarPlane), 200.0f);
    EXPECT_EQ(camera.getProjectionType(), Camera::kFbxCameraOrthographic);
    EXPECT_EQ(camera.getApertureMode(), Camera::kFbxApertureFocalLength); // not read
    EXPECT_EQ(camera.getValue(Camera::kFbxCameraFilmOffsetX), 0.0f);      // not read
    EXPECT_FALSE(camera.getAnimated(Camera::kFbxCameraRoll));
}

TEST(ProducerCamera, LooksWhereTheObjectsOwnSamplesLeadAtFrameZero) {
    TestScene scene;
    fbxsdk::FbxCamera* source = fbxsdk::FbxCamera::Create(scene.scene, "source");
    source->InterestPosition.Set({0.0, 0.0, -10.0});
    Camera camera;
    ASSERT_TRUE(camera.setValueAt(Camera::kFbxCameraRoll, timeRecord(0, 1, 24.0f), Samples({10.0f, 40.0f})));

    EXPECT_TRUE(scene.sdk.getProducerCamera(nullptr, source, camera, "name"));

    EXPECT_EQ(rotationOf(camera), rotationAt(camera, 0.0f));
    EXPECT_NEAR(camera.getTransformValue(kRotationZ), -10.0f, 1e-3f);
}

TEST(ProducerCamera, SetsTheTransformOrder) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    Camera producer, camera;
    const auto other = static_cast<Transform::EFbxTransformTransformOrder>(3);
    producer.setTransformTransformOrder(other);
    camera.setTransformTransformOrder(other);

    EXPECT_TRUE(scene.sdk.getProducerCamera(node, node->GetCamera(), producer, "name"));
    EXPECT_TRUE(readInto(scene, node, camera));

    EXPECT_EQ(producer.getTransformTransformOrder(), Transform::kFbxTransformOrderDefault);
    EXPECT_EQ(camera.getTransformTransformOrder(), Transform::kFbxTransformOrderDefault) << "other cameras as well";
}

TEST(ProducerCamera, WithoutANodeTurnsInTheOrderZXY) {
    TestScene scene;
    fbxsdk::FbxCamera* source = fbxsdk::FbxCamera::Create(scene.scene, "source");
    Camera camera;
    camera.setTransformRotationOrder(Transform::kFbxRotationOrderXYZ);
    camera.setTransformValue(Transform::kFbxTransformScaleY, 5.0f);

    EXPECT_TRUE(scene.sdk.getProducerCamera(nullptr, source, camera, "name"));

    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
    EXPECT_EQ(camera.getTransformValue(Transform::kFbxTransformScaleY), 1.0f);
}

TEST(ProducerCamera, FailsForANullCamera) {
    TestScene scene;
    Camera camera;

    EXPECT_FALSE(scene.sdk.getProducerCamera(scene.addNode("node"), nullptr, camera, "name"));
    EXPECT_EQ(camera.getName(), "");
}

} // namespace
} // namespace Tarnell::Fbx
