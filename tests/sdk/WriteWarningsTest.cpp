// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Data that is written as passed, and the warnings about it.
#include "support/FacadeReads.h"
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

namespace Tarnell::Fbx {
namespace {

using support::TemporaryFolder;
using test::WrittenObjects;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();

class WriteWarnings : public testing::Test {
protected:
    WriteWarnings() {
        info = test::writeInfo();
        info.setFileName(folder.file("shot.fbx"));
    }
    /// Writes, which succeeds, and returns the warnings.
    std::vector<std::string> warnings() const {
        EXPECT_TRUE(
            Fbx().writeFile(info, objects.cameras, objects.lights, objects.transforms, objects.nulls, objects.meshes))
            << lastError();
        return lastWarnings();
    }

    TemporaryFolder folder;
    TnFbxWriteInfo info;
    WrittenObjects objects;
};

TEST_F(WriteWarnings, AreNoneForWhatIsSound) {
    TnFbxCamera camera;
    TnFbxLight light;
    TnFbxNull null;
    TnFbxTransform transform;
    const auto mesh = test::movingMesh("mesh", 3);
    transform.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, test::timeOf(1, 3), {1.0f, 2.0f, 3.0f});
    objects = {{&camera, nullptr}, {&light}, {&transform}, {&null}, {mesh.get(), nullptr}};
    info.setAnimateMeshVertices(true);
    info.setEndFrame(3.0f);

    EXPECT_THAT(warnings(), IsEmpty());
}

TEST_F(WriteWarnings, NameAnInvalidRate) {
    const std::pair<float, const char*> rates[] = {{0.0f, "0 "}, {-24.0f, "-24 "}, {kNaN, "nan "}, {kInfinity, "inf "}};
    for (const auto& [rate, text] : rates) {
        info.setFPS(rate);
        EXPECT_THAT(warnings(), ElementsAre(AllOf(StartsWith(text), HasSubstr("not a valid frame rate"))));
    }
}

TEST_F(WriteWarnings, NameARateThatTheFileDoesNotTell) {
    info.setFPS(29.97f);
    EXPECT_THAT(warnings(), ElementsAre(StartsWith("29.9699993 frames per second is written as a custom frame rate")));

    info.setFPS(29.9700262f);
    EXPECT_THAT(warnings(), IsEmpty());
}

TEST_F(WriteWarnings, NameTheFirstOfTheObjectsWhoseValuesAreNoNumbers) {
    TnFbxNull first, second, third;
    first.setName("first");
    first.setTransformValue(TnFbxTransform::kFbxTransformScaleZ, kNaN);
    second.setName("second");
    second.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, test::timeOf(1, 3), {1.0f, kInfinity, 2.0f});
    third.setTransformValue(TnFbxTransform::kFbxTransformSkewX, kNaN); // which is not written
    objects.nulls = {&third, &first, &second};

    EXPECT_THAT(warnings(), ElementsAre(AllOf(StartsWith("first and 1 more: "), HasSubstr("not finite"))));
}

TEST_F(WriteWarnings, LookAtWhatIsWrittenOfCamerasAndLights) {
    TnFbxCamera camera;
    TnFbxLight light;
    camera.setName("camera");
    light.setName("light");
    objects.cameras = {&camera};
    objects.lights = {&light};
    camera.setApertureMode(TnFbxCamera::kFbxApertureHorizontal);
    camera.setValue(TnFbxCamera::kFbxCameraFocalLength, kNaN);
    camera.setValue(TnFbxCamera::kFbxCameraRoll, kNaN);
    light.setLightType(TnFbxLight::kFbxLightPoint);
    light.setValue(TnFbxLight::kFbxLightConeAngle, kNaN);
    light.setValue(TnFbxLight::kFbxLightAlpha, kNaN);
    EXPECT_THAT(warnings(), IsEmpty());

    camera.setApertureMode(TnFbxCamera::kFbxApertureFocalLength);
    light.setLightType(TnFbxLight::kFbxLightSpot);
    EXPECT_THAT(warnings(), ElementsAre(StartsWith("camera and 1 more: ")));
}

TEST_F(WriteWarnings, NameSamplesAtAnInvalidRate) {
    TnFbxNull null;
    null.setName("null");
    null.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, test::timeOf(1, 2, kNaN), {1.0f, 2.0f});
    objects.nulls = {&null};

    EXPECT_THAT(warnings(), ElementsAre(AllOf(StartsWith("null: "), HasSubstr("invalid frame rate"))));
}

TEST_F(WriteWarnings, NameMeshesThatContradictThemselves) {
    const auto outside = test::polygonMesh("outside"), below = test::polygonMesh("below");
    const auto empty = test::polygonMesh("empty"), greedy = test::polygonMesh("greedy");
    const auto nowhere = test::polygonMesh("nowhere");
    outside->setPointIndex(1, 3);
    below->setPointIndex(2, -1);
    EXPECT_TRUE(empty->allocateGeometryData(2, 3, 3));
    empty->setPolygonVertexSize(0, 3);
    empty->setPolygonVertexSize(1, 0);
    greedy->setPolygonVertexSize(0, 4);
    nowhere->setControlPoint(1, 0.0f, kNaN, 0.0f);
    objects.meshes = {outside.get(), below.get(), empty.get(), greedy.get(), nowhere.get()};

    EXPECT_THAT(warnings(), ElementsAre("outside and 1 more: polygons refer to control points that do not exist",
                                        "empty: polygons without polygon vertices are left out",
                                        StartsWith("greedy: the polygons have more polygon vertices than the mesh"),
                                        AllOf(StartsWith("nowhere: "), HasSubstr("not finite"))));
}

TEST_F(WriteWarnings, NameMeshesThatAreLeftOut) {
    TnFbxMesh none;
    none.setName("none");
    objects.meshes = {&none};

    EXPECT_THAT(warnings(), ElementsAre("none: left out: the mesh has no geometry"));
}

TEST_F(WriteWarnings, NameMeshesWhosePointCacheIsNotThere) {
    const auto still = test::polygonMesh("still"), moving = test::movingMesh("moving", 3);
    const auto other = test::movingMesh("other", 2);
    objects.meshes = {still.get(), moving.get(), other.get()};
    info.setAnimateMeshVertices(true);
    info.setEndFrame(3.0f);

    EXPECT_THAT(warnings(),
                ElementsAre(StartsWith("still and 1 more: it does not have one set of control points per frame")));
    EXPECT_EQ(folder.files("shot_fpc"), (std::vector<std::string>{"moving.mcx", "moving.xml"}));

    folder.write("shot_fpc/other.xml", "of an earlier write");
    EXPECT_THAT(warnings(),
                ElementsAre(StartsWith("still: it does not have one set of control points per frame"),
                            AllOf(StartsWith("other: "), HasSubstr("an older one with the same name exists"))));
}

} // namespace
} // namespace Tarnell::Fbx
