// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files that Blender exported, read through the facade. The expected numbers are those of the script that made them,
// with Blender's metres and Z up converted to centimetres and Y up.
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

namespace Tarnell::Fbx {
namespace {

using test::FacadeRead;
using test::localRead;
using test::samplesOf;
using testing::ElementsAre;
using testing::FloatNear;
using Samples = std::vector<float>;

constexpr int kFirstFrame = 1001, kLastFrame = 1005;

std::string blenderFile(const char* name) { return std::string(TARNELL_TEST_DATA "/blender/") + name; }

TnFbxReadInfo worldRead(const char* name) {
    TnFbxReadInfo info = localRead(blenderFile(name));
    info.setGlobalTransform(true);
    return info;
}

Samples pointAt(const TnFbxMesh& mesh, int index) {
    Samples point(3);
    EXPECT_TRUE(mesh.getControlPoint(index, point[0], point[1], point[2]));
    return point;
}

TEST(BlenderFile, GivesTheDollyZoomOfACamera) {
    FacadeRead<TnFbxCamera> cameras(worldRead("cameras_and_lights_7400_binary.fbx"));
    const TnFbxCamera& camera = cameras["camera"];

    EXPECT_EQ(samplesOf(camera, TnFbxTransform::kFbxTransformPositionX), Samples(5, 50.0f));
    EXPECT_EQ(samplesOf(camera, TnFbxTransform::kFbxTransformPositionY), Samples(5, 100.0f));
    EXPECT_EQ(samplesOf(camera, TnFbxTransform::kFbxTransformPositionZ), (Samples{200, 300, 400, 500, 600}));
    EXPECT_EQ(samplesOf(camera, TnFbxCamera::kFbxCameraFocalLength), (Samples{35, 37, 39, 41, 43}));
    const TnFbxTime time = camera.getTransformTime(TnFbxTransform::kFbxTransformPositionZ);
    EXPECT_EQ(time.getStartFrame(), kFirstFrame);
    EXPECT_EQ(time.getEndFrame(), kLastFrame);
    EXPECT_EQ(time.getFrameRate(), 24.0f);
}

TEST(BlenderFile, GivesTheFilmOfACameraInInches) {
    FacadeRead<TnFbxCamera> cameras(worldRead("cameras_and_lights_7400_binary.fbx"));
    const TnFbxCamera& camera = cameras["camera"];

    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraApertureWidth), 1.0f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraApertureHeight), 0.5f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraFilmOffsetX), 0.125f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraFilmOffsetY), 0.0f);
}

TEST(BlenderFile, GivesLightsAndEmpties) {
    FacadeRead<TnFbxLight> lights(worldRead("cameras_and_lights_7400_binary.fbx"));

    ASSERT_THAT(lights.names(), ElementsAre("bulb", "sun", "spot"));
    EXPECT_EQ(lights["bulb"].getLightType(), TnFbxLight::kFbxLightPoint);
    EXPECT_EQ(lights["sun"].getLightType(), TnFbxLight::kFbxLightDirectional);
    EXPECT_EQ(lights["spot"].getLightType(), TnFbxLight::kFbxLightSpot);
    EXPECT_EQ(lights["spot"].getValue(TnFbxLight::kFbxLightRed), 1.0f);
    EXPECT_EQ(lights["spot"].getValue(TnFbxLight::kFbxLightGreen), 0.5f);
    EXPECT_EQ(lights["spot"].getValue(TnFbxLight::kFbxLightBlue), 0.25f);
    EXPECT_THAT(lights["spot"].getValue(TnFbxLight::kFbxLightConeAngle), FloatNear(40.0f, 1e-5f));
    EXPECT_EQ(lights["spot"].getTransformValue(TnFbxTransform::kFbxTransformPositionX), 100.0f);
    EXPECT_EQ(lights["spot"].getTransformValue(TnFbxTransform::kFbxTransformPositionY), 300.0f);
    EXPECT_EQ(lights["spot"].getTransformValue(TnFbxTransform::kFbxTransformPositionZ), -200.0f);
    EXPECT_THAT(FacadeRead<TnFbxNull>(worldRead("cameras_and_lights_7400_binary.fbx")).names(), ElementsAre("locator"));
}

/// The strip's pairs of points at the heights 0 to 4 m; those above 2 m rotate with the upper bone.
void expectStrip(const TnFbxMesh& mesh, double degrees, float scale) {
    const double radians = degrees * M_PI / 180.0;
    // Meshes are read at a time in single precision, which makes 4e-3 cm of a bone of this speed.
    constexpr float kTolerance = 5e-3f;
    for (int height = 0; height < 5; ++height) {
        const double bent = std::max(height - 2, 0) * 100.0;
        const double y = std::min(height, 2) * 100.0 + bent * std::cos(radians), z = bent * std::sin(radians);
        for (int side = 0; side < 2; ++side) {
            EXPECT_THAT(pointAt(mesh, 2 * height + side),
                        ElementsAre(FloatNear(100.0f * scale * static_cast<float>(side), kTolerance),
                                    FloatNear(scale * static_cast<float>(y), kTolerance),
                                    FloatNear(scale * static_cast<float>(z), kTolerance)))
                << "height " << height;
        }
    }
}

TEST(BlenderFile, GivesASkinnedMeshWhereItsBonesTakeIt) {
    for (int frame = kFirstFrame; frame <= kLastFrame; ++frame) {
        SCOPED_TRACE(frame);
        TnFbxReadInfo info = worldRead("skin_7400_binary.fbx");
        info.setFrame(static_cast<float>(frame));
        FacadeRead<TnFbxMesh> meshes(info);
        expectStrip(meshes["strip"], 22.5 * (frame - kFirstFrame), 1.0f);
    }
}

// kept: skinned points are in the world; the transform of the node, here a scale by 100 and a rotation from Z up, is
// applied to them all the same when points are to be transformed
TEST(BlenderFile, TransformsSkinnedPointsOnceMore) {
    TnFbxReadInfo info = worldRead("skin_7400_binary.fbx");
    info.setFrame(kFirstFrame);
    info.setTransformPoints(true);
    FacadeRead<TnFbxMesh> meshes(info);

    EXPECT_THAT(pointAt(meshes["strip"], 1), ElementsAre(10000.0f, FloatNear(0.0f, 1e-2f), FloatNear(0.0f, 1e-2f)));
    EXPECT_THAT(pointAt(meshes["strip"], 2), ElementsAre(0.0f, FloatNear(0.0f, 1e-2f), FloatNear(10000.0f, 1e-2f)));
}

TEST(BlenderFile, GivesTheLayersOfAMesh) {
    TnFbxReadInfo info = localRead(blenderFile("layers_7400_binary.fbx"));
    FacadeRead<TnFbxMesh> meshes(info);
    const TnFbxMesh& house = meshes["house"];

    ASSERT_EQ(house.getNumberOfPolygons(), 2);
    ASSERT_EQ(house.getNumberOfPolygonVertices(), 7);
    EXPECT_TRUE(house.getValidNormals());
    EXPECT_TRUE(house.getValidUVs());
    EXPECT_TRUE(house.getValidColours());
    Samples normal(3), uv(2), colour(4);
    EXPECT_TRUE(house.getNormal(6, normal[0], normal[1], normal[2]));
    EXPECT_TRUE(house.getUV(6, uv[0], uv[1]));
    EXPECT_TRUE(house.getColour(6, colour[0], colour[1], colour[2], colour[3]));
    EXPECT_THAT(normal, ElementsAre(0.0f, -1.0f, 0.0f));
    EXPECT_THAT(uv, ElementsAre(0.5f, 1.0f));
    EXPECT_THAT(colour, ElementsAre(0.5f, 0.0f, 1.0f, 1.0f));
}

TEST(BlenderFile, CountsFramesAtARateBetweenWholeNumbers) {
    FacadeRead<TnFbxMesh> meshes(worldRead("layers_7400_binary.fbx"));

    const TnFbxTime time = meshes["house"].getTransformTime(TnFbxTransform::kFbxTransformPositionX);
    EXPECT_EQ(time.getStartFrame(), kFirstFrame);
    EXPECT_EQ(time.getEndFrame(), kLastFrame);
    EXPECT_EQ(time.getFrameRate(), 23.976f);
}

} // namespace
} // namespace Tarnell::Fbx
