// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writing cameras: film, planes, the lens by aperture mode, film offset and the rotation of the node.
#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace Tarnell::Fbx {
namespace {

using test::timeOf;
using test::valuesOf;
using test::WrittenScene;
using testing::ElementsAre;
using Camera = TnFbxCamera;
using SceneCamera = fbxsdk::FbxCamera;

/// A camera node to write to, and a camera whose channels hold 1, 2, 3, … and are animated with that and ten times
/// that.
struct CameraScene : WrittenScene {
    CameraScene() {
        prepareStack();
        node = sdk.createCamera(scene, "camera");
        target = node->GetCamera();
        for (int i = Camera::kFbxCameraLookAtPositionX; i <= Camera::kFbxCameraFilmOffsetY; ++i) {
            const auto channel = static_cast<Camera::EFbxCameraChannelType>(i);
            const auto value = static_cast<float>(i + 1);
            camera.setValue(channel, value);
            camera.setValueAt(channel, timeOf(1, 2), {value, value * 10.0f});
        }
    }
    bool write() { return sdk.setCameraCurveValues(node, &camera); }

    fbxsdk::FbxNode* node;
    SceneCamera* target;
    Camera camera;
};

TEST(CameraWriting, SetsFilmAndPlanes) {
    CameraScene scene;

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->GetApertureWidth(), 9.0);
    EXPECT_EQ(scene.target->GetApertureHeight(), 10.0);
    EXPECT_EQ(scene.target->NearPlane.Get(), 11.0);
    EXPECT_EQ(scene.target->FarPlane.Get(), 12.0);
}

TEST(CameraWriting, KeysFilmAndPlanes) {
    CameraScene scene;

    EXPECT_TRUE(scene.write());

    EXPECT_THAT(valuesOf(scene.curve(scene.target->FilmWidth)), ElementsAre(9.0f, 90.0f));
    EXPECT_THAT(valuesOf(scene.curve(scene.target->FilmHeight)), ElementsAre(10.0f, 100.0f));
    EXPECT_THAT(valuesOf(scene.curve(scene.target->NearPlane)), ElementsAre(11.0f, 110.0f));
    EXPECT_THAT(valuesOf(scene.curve(scene.target->FarPlane)), ElementsAre(12.0f, 120.0f));
}

TEST(CameraWriting, SetsPlanesWithoutHoldingThemInsideTheRangeOfTheSetters) {
    CameraScene scene;
    scene.camera.setValue(Camera::kFbxCameraNearPlane, 0.0f);
    scene.camera.setValue(Camera::kFbxCameraFarPlane, 1e9f);

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->NearPlane.Get(), 0.0);
    EXPECT_EQ(scene.target->FarPlane.Get(), 1e9);
}

TEST(CameraWriting, InFocalLengthModeNeverWritesAFieldOfView) {
    CameraScene scene;
    const double angle = scene.target->FieldOfView.Get();
    scene.camera.setApertureMode(Camera::kFbxApertureFocalLength);

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->GetApertureMode(), SceneCamera::eFocalLength);
    EXPECT_EQ(scene.target->FocalLength.Get(), 8.0);
    EXPECT_THAT(valuesOf(scene.curve(scene.target->FocalLength)), ElementsAre(8.0f, 80.0f));
    EXPECT_EQ(scene.target->FieldOfView.Get(), angle);
    EXPECT_EQ(scene.curve(scene.target->FieldOfView), nullptr);
    EXPECT_EQ(scene.curve(scene.target->FieldOfViewX), nullptr);
}

TEST(CameraWriting, InModesOfOneAngleWritesTheFieldOfView) {
    const std::pair<Camera::EFbxCameraApertureMode, SceneCamera::EApertureMode> modes[] = {
        {Camera::kFbxApertureHorizontal, SceneCamera::eHorizontal},
        {Camera::kFbxApertureVertical, SceneCamera::eVertical}};
    for (const auto& [mode, written] : modes) {
        CameraScene scene;
        scene.camera.setApertureMode(mode);

        EXPECT_TRUE(scene.write());

        EXPECT_EQ(scene.target->GetApertureMode(), written);
        EXPECT_EQ(scene.target->FieldOfView.Get(), 13.0);
        EXPECT_THAT(valuesOf(scene.curve(scene.target->FieldOfView)), ElementsAre(13.0f, 130.0f));
        EXPECT_EQ(scene.curve(scene.target->FocalLength), nullptr);
        EXPECT_EQ(scene.curve(scene.target->FieldOfViewX), nullptr);
    }
}

TEST(CameraWriting, InTheModeOfTwoAnglesWritesBoth) {
    CameraScene scene;
    scene.camera.setApertureMode(Camera::kFbxApertureHorizontalAndVertical);

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->GetApertureMode(), SceneCamera::eHorizAndVert);
    EXPECT_EQ(scene.target->FieldOfViewX.Get(), 14.0);
    EXPECT_EQ(scene.target->FieldOfViewY.Get(), 15.0);
    EXPECT_THAT(valuesOf(scene.curve(scene.target->FieldOfViewX)), ElementsAre(14.0f, 140.0f));
    EXPECT_THAT(valuesOf(scene.curve(scene.target->FieldOfViewY)), ElementsAre(15.0f, 150.0f));
    EXPECT_EQ(scene.curve(scene.target->FieldOfView), nullptr);
}

TEST(CameraWriting, LeavesTheLensAloneForWhatIsNoMode) {
    CameraScene scene;
    const double focalLength = scene.target->FocalLength.Get();
    scene.camera.setApertureMode(static_cast<Camera::EFbxCameraApertureMode>(4));

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->GetApertureMode(), SceneCamera::eVertical);
    EXPECT_EQ(scene.target->FocalLength.Get(), focalLength);
    EXPECT_EQ(scene.curve(scene.target->FocalLength), nullptr);
    EXPECT_EQ(scene.curve(scene.target->FieldOfView), nullptr);
}

TEST(CameraWriting, SetsTheProjection) {
    CameraScene scene;
    scene.camera.setProjectionType(Camera::kFbxCameraOrthographic);
    EXPECT_TRUE(scene.write());
    EXPECT_EQ(scene.target->ProjectionType.Get(), SceneCamera::eOrthogonal);

    scene.camera.setProjectionType(static_cast<Camera::EFbxCameraProjectionType>(2));
    EXPECT_TRUE(scene.write());
    EXPECT_EQ(scene.target->ProjectionType.Get(), SceneCamera::eOrthogonal);

    scene.camera.setProjectionType(Camera::kFbxCameraPerspective);
    EXPECT_TRUE(scene.write());
    EXPECT_EQ(scene.target->ProjectionType.Get(), SceneCamera::ePerspective);
}

TEST(CameraWriting, SetsAndKeysTheFilmOffset) {
    CameraScene scene;

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->FilmOffsetX.Get(), 16.0);
    EXPECT_EQ(scene.target->FilmOffsetY.Get(), 17.0);
    EXPECT_THAT(valuesOf(scene.curve(scene.target->FilmOffsetX)), ElementsAre(16.0f, 160.0f));
    EXPECT_THAT(valuesOf(scene.curve(scene.target->FilmOffsetY)), ElementsAre(17.0f, 170.0f));
}

TEST(CameraWriting, MakesAPropertyFilmOffsetThatStaysZero) {
    CameraScene scene;
    ASSERT_FALSE(scene.target->FindProperty("FilmOffset", true).IsValid());

    EXPECT_TRUE(scene.write());
    EXPECT_TRUE(scene.write());

    const fbxsdk::FbxProperty offset = scene.target->FindProperty("FilmOffset", true);
    ASSERT_TRUE(offset.IsValid());
    EXPECT_EQ(offset.Get<fbxsdk::FbxDouble2>()[0], 0.0);
    EXPECT_EQ(offset.Get<fbxsdk::FbxDouble2>()[1], 0.0);
}

TEST(CameraWriting, TurnsTheNodeAboutY) {
    CameraScene scene;

    EXPECT_TRUE(scene.write());

    const fbxsdk::FbxVector4 turn = scene.node->GetPostRotation(fbxsdk::FbxNode::eSourcePivot);
    EXPECT_EQ(turn[0], 0.0);
    EXPECT_EQ(turn[1], -90.0);
    EXPECT_EQ(turn[2], 0.0);
    EXPECT_TRUE(scene.node->GetRotationActive());
}

TEST(CameraWriting, WritesTheTransformToo) {
    CameraScene scene;
    scene.camera.setTransformValue(TnFbxTransform::kFbxTransformPositionZ, 7.0f);
    scene.camera.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderYXZ);

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.node->LclTranslation.Get()[2], 7.0);
    fbxsdk::FbxEuler::EOrder order = fbxsdk::FbxEuler::eOrderXYZ;
    scene.node->GetRotationOrder(fbxsdk::FbxNode::eSourcePivot, order);
    EXPECT_EQ(order, fbxsdk::FbxEuler::eOrderYXZ);
}

TEST(CameraWriting, WritesNeitherLookAtNorUpNorRoll) {
    CameraScene scene;

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->InterestPosition.Get()[0], 0.0);
    EXPECT_EQ(scene.target->UpVector.Get()[1], 1.0);
    EXPECT_EQ(scene.target->Roll.Get(), 0.0);
    EXPECT_EQ(scene.curve(scene.target->InterestPosition, "X"), nullptr);
    EXPECT_EQ(scene.curve(scene.target->UpVector, "X"), nullptr);
    EXPECT_EQ(scene.curve(scene.target->Roll), nullptr);
    EXPECT_EQ(scene.node->GetTarget(), nullptr);
}

TEST(CameraWriting, NeedsANodeWithACamera) {
    CameraScene scene;
    fbxsdk::FbxNode* bare = fbxsdk::FbxNode::Create(scene.scene, "bare");

    EXPECT_FALSE(scene.sdk.setCameraCurveValues(nullptr, &scene.camera));
    EXPECT_FALSE(scene.sdk.setCameraCurveValues(scene.node, nullptr));
    EXPECT_FALSE(scene.sdk.setCameraCurveValues(bare, &scene.camera));
    EXPECT_FALSE(lastError().empty());
}

} // namespace
} // namespace Tarnell::Fbx
