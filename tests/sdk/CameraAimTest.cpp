// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The direction of cameras: at targets and points of interest, with roll, and on which frames it is computed.
#include "CameraScenes.h"
#include "support/MemoryLimitScope.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using namespace test;

constexpr auto kPositionX = Transform::kFbxTransformPositionX;
constexpr auto kRotationX = Transform::kFbxTransformRotationX;
constexpr auto kRotationY = Transform::kFbxTransformRotationY;
constexpr auto kRotationZ = Transform::kFbxTransformRotationZ;

TEST(CameraAim, ReadsNoLookAtPointWithoutATarget) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->InterestPosition.Set({1.0, 2.0, 3.0});

    EXPECT_EQ(readCamera(scene, node).getValue(Camera::kFbxCameraLookAtPositionX), 0.0f);
}

TEST(CameraAim, ComputesTheRotationTowardItsInterestPositionWhenAsked) {
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

TEST(CameraAim, ComputesTheRotationOnceAtFrameZeroWhenNothingIsAnimated) {
    TestScene scene(5, 9);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->InterestPosition.Set({0.0, 5.0, 0.0});

    const Camera camera = readCamera(scene, node, {false, true});

    EXPECT_EQ(rotationOf(camera), rotationAt(camera, 0.0f));
    EXPECT_EQ(camera.getTransformValue(kRotationX), 90.0f);
    for (const auto channel : {kRotationX, kRotationY, kRotationZ})
        EXPECT_FALSE(camera.getTransformAnimated(channel));
}

TEST(CameraAim, ComputesTheRotationForEveryFrameOfAnimatedIngredients) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = addCamera(scene);
    node->GetCamera()->InterestPosition.Set({0.0, 0.0, -100.0});
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {3, 30.0f}});
    scene.key(node->GetCamera()->Roll, nullptr, {{-1, 0.0f}, {2, 90.0f}});
    Camera camera;
    for (const auto channel : {kRotationX, kRotationY, kRotationZ})
        camera.setTransformValue(channel, 77.0f);

    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));

    for (const auto channel : {kRotationX, kRotationY, kRotationZ})
        test::expectRange(camera.getTransformTime(channel), -1, 3, 24.0f);
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

TEST(CameraAim, ComputesTheRotationOnceForIngredientsThatStartAtFrameTenMillion) {
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

TEST(CameraAim, GivesAComputedRotationTheRateOfItsLastAnimatedIngredient) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = addCamera(scene);
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {2, 20.0f}});
    Camera camera; // the up vector is never sampled: these are the samples that the object had before
    camera.setValueAt(Camera::kFbxCameraUpPositionX, timeRecord(1, 2, 60.0f), {0.0f, 0.0f});
    camera.setValueAt(Camera::kFbxCameraUpPositionY, timeRecord(1, 5, 30.0f), Samples(5, 1.0f));
    camera.setValueAt(Camera::kFbxCameraFarPlane, timeRecord(-9, 9, 120.0f), Samples(19, 1.0f)); // no input

    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));
    test::expectRange(camera.getTransformTime(kRotationX), 0, 5, 30.0f);

    scene.key(node->GetCamera()->Roll, nullptr, {{0, 0.0f}, {1, 9.0f}});
    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));
    test::expectRange(camera.getTransformTime(kRotationX), 0, 5, 24.0f);
}

TEST(CameraAim, TurnsInTheOrderZXYOnlyWhenItLooksAtSomething) {
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

TEST(CameraAim, LooksAtTheTargetInTheWorld) {
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

TEST(CameraAim, LooksAtTheTargetWithoutItsOwnGeometricTransform) {
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

TEST(CameraAim, TakesItsOwnTranslationForTheTargetsWhenReadLocally) {
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
    for (const auto channel : lookAt)
        camera.setValue(channel, 77.0f);

    EXPECT_TRUE(readInto(scene, node, camera));

    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraLookAtPositionX), samplesOf(camera, kPositionX));
    EXPECT_EQ(samplesOf(camera, Camera::kFbxCameraLookAtPositionX), Samples({1.0f, 2.0f, 3.0f}));
    EXPECT_FALSE(camera.getAnimated(Camera::kFbxCameraLookAtPositionY));
    for (const auto channel : lookAt)
        EXPECT_EQ(camera.getValue(channel), 77.0f); // no static values
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
}

TEST(CameraAim, PrefersTheTargetToTheInterestPosition) {
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

TEST(CameraAim, KeepsTheLookAtPointForAnInvertedRange) {
    TestScene scene(5, 4);
    fbxsdk::FbxNode* node = addCamera(scene);
    fbxsdk::FbxNode* target = scene.addNode("target");
    target->LclTranslation.Set({0.0, 0.0, -5.0});
    node->SetTarget(target);

    const Camera camera = readCamera(scene, node, {/*global*/ true});

    EXPECT_EQ(camera.getValue(Camera::kFbxCameraLookAtPositionZ), 0.0f);
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
}

TEST(CameraAim, ReadsRollSampledAndUpVectorStatically) {
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

TEST(CameraAim, SurvivesAnAimThatIsNoNumber) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    const double nan = std::numeric_limits<double>::quiet_NaN();
    node->LclTranslation.Set({nan, nan, nan});
    node->GetCamera()->InterestPosition.Set({1e300, nan, -1e300});

    readCamera(scene, node, {false, true});
}

/// A camera with samples at both ends of the range of frames: that many, and the same number at the other end.
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

TEST(CameraAim, FailsWhenTheIngredientsSpanMoreFramesThanThereIsMemoryFor) {
    const support::MemoryLimitScope limit(1 << 30);
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    Camera camera = cameraOfAllFrames({1.0f, 2.0f});

    EXPECT_FALSE(readInto(scene, node, camera, {false, true}));

    EXPECT_NE(lastError().find("frames -2000000000 to 2000000000 at 24"), std::string::npos) << lastError();
    EXPECT_FALSE(camera.getTransformAnimated(kRotationX));
    EXPECT_EQ(rotationOf(camera), rotationAt(camera, 0.0f));
}

TEST(CameraAim, TakesOneRotationForAllFramesOfIngredientsThatDoNotChange) {
    TestScene scene;
    fbxsdk::FbxNode* node = addCamera(scene);
    Camera camera = cameraOfAllFrames({1.0f});

    EXPECT_TRUE(readInto(scene, node, camera, {false, true}));

    const TnFbxChannel& x = *camera.getTransformChannel(kRotationX);
    test::expectRange(x.getTime(), -2000000000, 2000000000, 24.0f);
    EXPECT_TRUE(x.isConstant());
    EXPECT_EQ(x.getAnimatedValue(1e9f), rotationAt(camera, 1e9f)[0]);
}

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

} // namespace
} // namespace Tarnell::Fbx
