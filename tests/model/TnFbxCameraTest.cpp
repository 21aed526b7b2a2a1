// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The camera's modes, and what its lifecycle leaves unchanged. Its channels are tested with those of all owners, its
// look-at conversion on its own.
#include "TnFbxCamera.h"

#include "TransformOwner.h"

#include <type_traits>

namespace Tarnell::Fbx {
namespace {

using test::expectMarkedTransform;
using test::markTransform;

static_assert(std::is_base_of_v<TnFbxTransform, TnFbxCamera>);

static_assert(TnFbxCamera::kFbxCameraPerspective == 0);
static_assert(TnFbxCamera::kFbxCameraOrthographic == 1);
static_assert(TnFbxCamera::kFbxApertureHorizontalAndVertical == 0);
static_assert(TnFbxCamera::kFbxApertureHorizontal == 1);
static_assert(TnFbxCamera::kFbxApertureVertical == 2);
static_assert(TnFbxCamera::kFbxApertureFocalLength == 3);
static_assert(sizeof(TnFbxCamera::EFbxCameraChannelType) == 4);
static_assert(sizeof(TnFbxCamera::EFbxCameraProjectionType) == 4);
static_assert(sizeof(TnFbxCamera::EFbxCameraApertureMode) == 4);

TnFbxCamera changedCamera() {
    TnFbxCamera camera;
    camera.setProjectionType(TnFbxCamera::kFbxCameraOrthographic);
    camera.setApertureMode(TnFbxCamera::kFbxApertureVertical);
    camera.setValue(TnFbxCamera::kFbxCameraRoll, 30.0f);
    markTransform(camera, "camera", 5.0f);
    return camera;
}

TEST(TnFbxCamera, StartsPerspectiveWithItsFocalLengthDrivingTheLens) {
    const TnFbxCamera camera;

    EXPECT_EQ(camera.getProjectionType(), TnFbxCamera::kFbxCameraPerspective);
    EXPECT_EQ(camera.getApertureMode(), 3);
    EXPECT_EQ(camera.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 1.0f);
}

TEST(TnFbxCamera, StoresItsModesWithoutACheck) {
    TnFbxCamera camera;

    for (const int mode : {0, 1, 3, 4, -1, test::kLowest, test::kHighest}) {
        EXPECT_TRUE(camera.setProjectionType(static_cast<TnFbxCamera::EFbxCameraProjectionType>(mode)));
        EXPECT_TRUE(camera.setApertureMode(static_cast<TnFbxCamera::EFbxCameraApertureMode>(mode)));
        EXPECT_EQ(camera.getProjectionType(), mode);
        EXPECT_EQ(camera.getApertureMode(), mode);
    }
}

TEST(TnFbxCamera, SpellsTheFieldsOfViewItsOwnWay) {
    EXPECT_STREQ(TnFbxCamera::getChannelName(TnFbxCamera::kFbxCameraFieldOfView), "filedOfView");
    EXPECT_STREQ(TnFbxCamera::getChannelName(TnFbxCamera::kFbxCameraFieldOfViewX), "filedOfViewX");
    EXPECT_STREQ(TnFbxCamera::getChannelName(TnFbxCamera::kFbxCameraFieldOfViewY), "filedOfViewY");
    EXPECT_EQ(TnFbxCamera::getChannelName(static_cast<TnFbxCamera::EFbxCameraChannelType>(17)), nullptr);
}

TEST(TnFbxCamera, InitResetsTheCameraPartAlone) {
    TnFbxCamera camera = changedCamera();

    EXPECT_TRUE(camera.initCamera());

    EXPECT_EQ(camera.getProjectionType(), TnFbxCamera::kFbxCameraPerspective);
    EXPECT_EQ(camera.getApertureMode(), TnFbxCamera::kFbxApertureFocalLength);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraRoll), 0.0f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraUpPositionY), 1.0f);
    expectMarkedTransform(camera, "camera", 5.0f);
}

TEST(TnFbxCamera, DeleteLeavesUpAndFocalLengthAtZeroAndTheTransformAlone) {
    TnFbxCamera camera = changedCamera();

    EXPECT_TRUE(camera.deleteCamera());

    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraUpPositionY), 0.0f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraFocalLength), 0.0f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraFarPlane), 0.0f);
    EXPECT_EQ(camera.getProjectionType(), TnFbxCamera::kFbxCameraPerspective);
    EXPECT_EQ(camera.getApertureMode(), TnFbxCamera::kFbxApertureFocalLength);
    expectMarkedTransform(camera, "camera", 5.0f);
}

TEST(TnFbxCamera, AssignmentKeepsTheTargetsTransformAndName) {
    TnFbxCamera target;
    markTransform(target, "target", -1.0f);

    target = changedCamera();

    EXPECT_EQ(target.getProjectionType(), TnFbxCamera::kFbxCameraOrthographic);
    EXPECT_EQ(target.getApertureMode(), TnFbxCamera::kFbxApertureVertical);
    EXPECT_EQ(target.getValue(TnFbxCamera::kFbxCameraRoll), 30.0f);
    expectMarkedTransform(target, "target", -1.0f);
}

TEST(TnFbxCamera, AssigningThePartsOneByOneCopiesAllButTheName) {
    const TnFbxCamera source = changedCamera();
    TnFbxCamera target;
    target.setName("target");

    target = source;
    static_cast<TnFbxTransform&>(target) = source;

    expectMarkedTransform(target, "target", 5.0f);
}

} // namespace
} // namespace Tarnell::Fbx
