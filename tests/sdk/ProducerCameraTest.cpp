// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Producer cameras, which are read statically.
#include "CameraScenes.h"

#include <gtest/gtest.h>

#include <vector>

namespace Tarnell::Fbx {
namespace {

using namespace test;

constexpr auto kRotationY = Transform::kFbxTransformRotationY;
constexpr auto kRotationZ = Transform::kFbxTransformRotationZ;

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
