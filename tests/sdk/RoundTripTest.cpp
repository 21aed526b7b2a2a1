// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Written objects are read back: every kind of object through a file of every version, as ASCII and as binary.
#include "RoundTripFixture.h"
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <filesystem>
#include <limits>
#include <set>
#include <tuple>

namespace Tarnell::Fbx {
namespace {

using namespace test;
using testing::ElementsAre;
using testing::IsEmpty;

using RoundTrip = test::RoundTripFixture;
INSTANTIATE_TEST_SUITE_P(EveryFile, RoundTrip, test::everyVariant(), test::variantName);

/// Nine static values that floats hold exactly, and samples over frames 0 to 3 in three of the channels.
template <class Object>
Object placed(const char* name) {
    Object object;
    object.setName(name);
    for (int i = Transform::kFbxTransformPositionX; i <= Transform::kFbxTransformScaleZ; ++i)
        object.setTransformValue(static_cast<Transform::EFbxTransformChannelType>(i), 0.5f + static_cast<float>(i));
    object.setTransformValueAt(Transform::kFbxTransformPositionY, timeOf(0, 4), {1.0f, 3.0f, 2.0f, -0.1f});
    object.setTransformValueAt(Transform::kFbxTransformRotationZ, timeOf(0, 4), {0.0f, 370.0f, -45.5f, 1e-3f});
    object.setTransformValueAt(Transform::kFbxTransformScaleX, timeOf(0, 4), {1.0f, 1.5f, 0.0f, 2.0f});
    object.setTransformRotationOrder(Transform::kFbxRotationOrderYZX);
    return object;
}

void expectPlaced(const Transform& read) {
    for (int i = Transform::kFbxTransformPositionX; i <= Transform::kFbxTransformScaleZ; ++i) {
        const auto channel = static_cast<Transform::EFbxTransformChannelType>(i);
        EXPECT_EQ(read.getTransformValue(channel), 0.5f + static_cast<float>(i))
            << Transform::getTransformChannelName(channel);
    }
    EXPECT_THAT(samplesOf(read, Transform::kFbxTransformPositionY), ElementsAre(1.0f, 3.0f, 2.0f, -0.1f));
    EXPECT_THAT(samplesOf(read, Transform::kFbxTransformRotationZ), ElementsAre(0.0f, 370.0f, -45.5f, 1e-3f));
    EXPECT_THAT(samplesOf(read, Transform::kFbxTransformScaleX), ElementsAre(1.0f, 1.5f, 0.0f, 2.0f));
    test::expectRange(read.getTransformTime(Transform::kFbxTransformPositionY), 0, 3, 24.0f);
    EXPECT_FALSE(read.getTransformAnimated(Transform::kFbxTransformPositionX));
    EXPECT_FALSE(read.getTransformAnimated(Transform::kFbxTransformRotationX));
    EXPECT_EQ(read.getTransformRotationOrder(), Transform::kFbxRotationOrderYZX);
}

TEST_P(RoundTrip, OfNothingGivesAnEmptySceneWithItsStack) {
    write({});

    std::vector<std::string> stacks, nodes;
    EXPECT_TRUE(Fbx().getAnimationStackNodeNames(file().c_str(), 0x4005 | 64, stacks, nodes)) << lastError();
    EXPECT_THAT(stacks, ElementsAre("Take 001"));
    EXPECT_THAT(nodes, IsEmpty());
    EXPECT_EQ(FacadeRead<TnFbxCamera>(file()).count, 7) << "the producer cameras";
}

TEST_P(RoundTrip, OfGlobalSettings) {
    TnFbxWriteInfo options = info();
    options.setFPS(25.0f);
    write({}, options);

    FbxSdk sdk;
    ASSERT_TRUE(Fbx().loadScene(file(), sdk)) << lastError();
    fbxsdk::FbxScene& scene = *sdk.getScene();
    EXPECT_EQ(scene.GetGlobalSettings().GetTimeMode(), fbxsdk::FbxTime::ePAL);
    EXPECT_EQ(scene.GetGlobalSettings().GetSystemUnit().GetScaleFactor(), 1.0);
    EXPECT_STREQ(scene.GlobalCameraSettings().GetDefaultCamera(), "Camera Switcher");
    const fbxsdk::FbxColor ambient = scene.GlobalLightSettings().GetAmbientColor();
    EXPECT_EQ(ambient.mRed, 1.0);
    EXPECT_EQ(ambient.mGreen, 0.5);
    EXPECT_EQ(ambient.mBlue, 0.2);
}

TEST_P(RoundTrip, OfATransformGivesANullOfItsPlacement) {
    auto transform = placed<Transform>("transform");
    WrittenObjects objects;
    objects.transforms = {&transform};
    write(objects);

    FacadeRead<Transform> transforms(file());
    EXPECT_THAT(transforms.names(), ElementsAre("transform"));
    expectPlaced(transforms["transform"]);
    FacadeRead<TnFbxNull> nulls(file());
    expectPlaced(nulls["transform"]);
    EXPECT_EQ(nulls["transform"].getNullSize(), 100.0f);
    EXPECT_EQ(nulls["transform"].getNullLookType(), TnFbxNull::kFbxNullLookCross);
}

TEST_P(RoundTrip, OfANull) {
    auto cross = placed<TnFbxNull>("cross"), none = placed<TnFbxNull>("none");
    cross.setNullSize(2.5f);
    none.setNullSize(0.1f);
    none.setNullLookType(TnFbxNull::kFbxNullLookNone);
    WrittenObjects objects;
    objects.nulls = {&cross, &none};
    write(objects);

    FacadeRead<TnFbxNull> nulls(file());
    EXPECT_THAT(nulls.names(), ElementsAre("cross", "none"));
    expectPlaced(nulls["cross"]);
    EXPECT_EQ(nulls["cross"].getNullSize(), 2.5f);
    EXPECT_EQ(nulls["cross"].getNullLookType(), TnFbxNull::kFbxNullLookCross);
    EXPECT_EQ(nulls["none"].getNullSize(), 0.1f);
    EXPECT_EQ(nulls["none"].getNullLookType(), TnFbxNull::kFbxNullLookNone);
}

TEST_P(RoundTrip, OfEveryRotationOrder) {
    std::array<TnFbxNull, 6> nulls;
    WrittenObjects objects;
    for (std::size_t i = 0; i < nulls.size(); ++i) {
        nulls[i].setName("order" + std::to_string(i));
        nulls[i].setTransformRotationOrder(static_cast<Transform::EFbxTransformRotationOrder>(i));
        objects.nulls.push_back(&nulls[i]);
    }
    write(objects);

    FacadeRead<TnFbxNull> read(file());
    for (std::size_t i = 0; i < nulls.size(); ++i)
        EXPECT_EQ(read["order" + std::to_string(i)].getTransformRotationOrder(), static_cast<int>(i));
}

TEST_P(RoundTrip, OfALightOfEveryType) {
    using Light = TnFbxLight;
    auto point = placed<Light>("point"), directional = placed<Light>("directional"), spot = placed<Light>("spot");
    point.setLightType(Light::kFbxLightPoint);
    point.setDecayType(Light::kFbxLightDecayLinear);
    directional.setLightType(Light::kFbxLightDirectional);
    directional.setDecayType(Light::kFbxLightDecayCubic);
    spot.setLightType(Light::kFbxLightSpot);
    spot.setDecayType(Light::kFbxLightDecayCubic);
    for (Light* light : {&point, &directional, &spot}) {
        light->setValue(Light::kFbxLightRed, 0.25f);
        light->setValue(Light::kFbxLightGreen, 0.5f);
        light->setValue(Light::kFbxLightBlue, 0.75f);
        light->setValue(Light::kFbxLightIntensity, 1.5f);
        light->setValue(Light::kFbxLightConeAngle, 30.5f);
        light->setValueAt(Light::kFbxLightGreen, timeOf(0, 4), {0.125f, 0.375f, 0.25f, 1.0f});
        light->setValueAt(Light::kFbxLightIntensity, timeOf(0, 4), {0.5f, 2.0f, 0.0f, 1.0f});
        light->setValueAt(Light::kFbxLightConeAngle, timeOf(0, 4), {10.0f, 20.0f, 30.0f, 40.0f});
    }
    WrittenObjects objects;
    objects.lights = {&point, &directional, &spot};
    write(objects);

    FacadeRead<Light> lights(file());
    EXPECT_THAT(lights.names(), ElementsAre("point", "directional", "spot"));
    for (const char* name : {"point", "directional", "spot"}) {
        const Light& light = lights[name];
        expectPlaced(light);
        EXPECT_EQ(light.getValue(Light::kFbxLightRed), 0.25f);
        EXPECT_EQ(light.getValue(Light::kFbxLightGreen), 0.5f);
        EXPECT_EQ(light.getValue(Light::kFbxLightBlue), 0.75f);
        EXPECT_EQ(light.getValue(Light::kFbxLightIntensity), 150.0f * 0.01f);
        EXPECT_THAT(samplesOf(light, Light::kFbxLightGreen), ElementsAre(0.125f, 0.375f, 0.25f, 1.0f));
        EXPECT_THAT(samplesOf(light, Light::kFbxLightIntensity),
                    ElementsAre(50.0f * 0.01f, 200.0f * 0.01f, 0.0f, 100.0f * 0.01f));
    }
    EXPECT_EQ(lights["point"].getLightType(), Light::kFbxLightPoint);
    EXPECT_EQ(lights["directional"].getLightType(), Light::kFbxLightDirectional);
    EXPECT_EQ(lights["spot"].getLightType(), Light::kFbxLightSpot);
    EXPECT_EQ(lights["point"].getDecayType(), Light::kFbxLightDecayLinear);
    EXPECT_EQ(lights["directional"].getDecayType(), Light::kFbxLightDecayNone) << "not written";
    EXPECT_EQ(lights["spot"].getDecayType(), Light::kFbxLightDecayCubic);
    EXPECT_EQ(lights["spot"].getValue(Light::kFbxLightConeAngle), 30.5f);
    EXPECT_THAT(samplesOf(lights["spot"], Light::kFbxLightConeAngle), ElementsAre(10.0f, 20.0f, 30.0f, 40.0f));
    EXPECT_EQ(lights["point"].getValue(Light::kFbxLightConeAngle), 45.0f) << "not written";
}

using Camera = TnFbxCamera;

Camera filledCamera(const char* name) {
    auto camera = placed<Camera>(name);
    camera.setValue(Camera::kFbxCameraFocalLength, 35.5f);
    camera.setValueAt(Camera::kFbxCameraFocalLength, timeOf(0, 4), {20.0f, 35.0f, 50.0f, 40.0f});
    camera.setValue(Camera::kFbxCameraApertureWidth, 1.25f);
    camera.setValue(Camera::kFbxCameraApertureHeight, 0.75f);
    camera.setValue(Camera::kFbxCameraNearPlane, 0.25f);
    camera.setValue(Camera::kFbxCameraFarPlane, 5000.0f);
    camera.setValue(Camera::kFbxCameraFieldOfView, 30.0f);
    camera.setValue(Camera::kFbxCameraFieldOfViewX, 31.0f);
    camera.setValue(Camera::kFbxCameraFieldOfViewY, 32.0f);
    camera.setValueAt(Camera::kFbxCameraFieldOfView, timeOf(0, 4), {40.0f, 50.0f, 60.0f, 70.0f});
    camera.setValueAt(Camera::kFbxCameraFieldOfViewX, timeOf(0, 4), {41.0f, 51.0f, 61.0f, 71.0f});
    camera.setValueAt(Camera::kFbxCameraFieldOfViewY, timeOf(0, 4), {42.0f, 52.0f, 62.0f, 72.0f});
    camera.setValue(Camera::kFbxCameraFilmOffsetX, 0.125f);
    camera.setValue(Camera::kFbxCameraFilmOffsetY, 0.5f);
    camera.setValueAt(Camera::kFbxCameraFilmOffsetY, timeOf(0, 4), {0.5f, 0.625f, 0.75f, 0.875f});
    return camera;
}

TEST_P(RoundTrip, OfACamera) {
    Camera camera = filledCamera("camera");
    camera.setProjectionType(Camera::kFbxCameraOrthographic);
    WrittenObjects objects;
    objects.cameras = {&camera};
    write(objects);

    FacadeRead<Camera> cameras(file());
    EXPECT_EQ(cameras.count, 8) << "seven of them producer cameras";
    const Camera& read = cameras["camera"];
    expectPlaced(read);
    EXPECT_EQ(read.getApertureMode(), Camera::kFbxApertureFocalLength);
    EXPECT_EQ(read.getProjectionType(), Camera::kFbxCameraOrthographic);
    EXPECT_EQ(read.getValue(Camera::kFbxCameraFocalLength), 35.5f);
    EXPECT_THAT(samplesOf(read, Camera::kFbxCameraFocalLength), ElementsAre(20.0f, 35.0f, 50.0f, 40.0f));
    EXPECT_EQ(read.getValue(Camera::kFbxCameraApertureWidth), 1.25f);
    EXPECT_EQ(read.getValue(Camera::kFbxCameraApertureHeight), 0.75f);
    EXPECT_EQ(read.getValue(Camera::kFbxCameraNearPlane), 0.25f);
    EXPECT_EQ(read.getValue(Camera::kFbxCameraFarPlane), 5000.0f);
    EXPECT_EQ(read.getValue(Camera::kFbxCameraFieldOfViewX), Camera::kDefaultCameraFieldOfViewX);
}

TEST_P(RoundTrip, OfACamerasFilmOffsetLosesTheStaticYToX) {
    Camera camera = filledCamera("camera");
    WrittenObjects objects;
    objects.cameras = {&camera};
    write(objects);

    FacadeRead<Camera> cameras(file());
    const Camera& read = cameras["camera"];
    EXPECT_EQ(read.getValue(Camera::kFbxCameraFilmOffsetX), 0.125f);
    EXPECT_EQ(read.getValue(Camera::kFbxCameraFilmOffsetY), 0.125f);
    EXPECT_THAT(samplesOf(read, Camera::kFbxCameraFilmOffsetY), ElementsAre(0.5f, 0.625f, 0.75f, 0.875f));
}

TEST_P(RoundTrip, OfACameraOfTwoAngles) {
    Camera camera = filledCamera("camera");
    camera.setApertureMode(Camera::kFbxApertureHorizontalAndVertical);
    WrittenObjects objects;
    objects.cameras = {&camera};
    write(objects);

    FacadeRead<Camera> cameras(file());
    const Camera& read = cameras["camera"];
    EXPECT_EQ(read.getApertureMode(), Camera::kFbxApertureHorizontalAndVertical);
    EXPECT_THAT(samplesOf(read, Camera::kFbxCameraFieldOfViewX), ElementsAre(41.0f, 51.0f, 61.0f, 71.0f));
    EXPECT_THAT(samplesOf(read, Camera::kFbxCameraFieldOfViewY), ElementsAre(42.0f, 52.0f, 62.0f, 72.0f));
    EXPECT_THAT(samplesOf(read, Camera::kFbxCameraFocalLength), IsEmpty());
}

TEST_P(RoundTrip, OfACameraOfOneAngleGivesFocalLengths) {
    for (const auto mode : {Camera::kFbxApertureHorizontal, Camera::kFbxApertureVertical}) {
        Camera camera = filledCamera("camera");
        camera.setApertureMode(mode);
        WrittenObjects objects;
        objects.cameras = {&camera};
        write(objects);

        FacadeRead<Camera> cameras(file());
        const Camera& read = cameras["camera"];
        EXPECT_EQ(read.getApertureMode(), Camera::kFbxApertureFocalLength);
        const double inches = mode == Camera::kFbxApertureVertical ? 0.75 : 1.25;
        const Samples samples = samplesOf(read, Camera::kFbxCameraFocalLength);
        ASSERT_EQ(samples.size(), 4u);
        for (std::size_t i = 0; i < samples.size(); ++i) {
            const double degrees = 40.0 + 10.0 * static_cast<double>(i);
            const double expected = inches * 25.4 / 2.0 / std::tan(degrees / 360.0 * 3.14159265358979323846);
            EXPECT_FLOAT_EQ(samples[i], static_cast<float>(expected));
        }
    }
}

std::unique_ptr<TnFbxMesh> filledMesh() {
    auto mesh = std::make_unique<TnFbxMesh>();
    mesh->setName("mesh");
    EXPECT_TRUE(mesh->allocateGeometryData(3, 5, 7));
    mesh->setPolygonVertexSize(0, 4);
    mesh->setPolygonVertexSize(1, 0);
    mesh->setPolygonVertexSize(2, 3);
    const int points[] = {0, 1, 2, 3, 3, 2, 4};
    for (int i = 0; i < 7; ++i) {
        const auto f = static_cast<float>(i);
        mesh->setPointIndex(i, points[i]);
        mesh->setNormal(i, f * 0.1f, 1.0f - f, 0.3f);
        mesh->setUV(i, f / 7.0f, 1.0f - f / 7.0f);
        mesh->setColour(i, f / 7.0f, 0.2f, 0.3f, 0.4f);
    }
    for (int i = 0; i < 5; ++i)
        mesh->setControlPoint(i, static_cast<float>(i) * 0.1f, 1e6f, static_cast<float>(-i) / 3.0f);
    mesh->setValidNormals(true);
    mesh->setValidUVs(true);
    mesh->setValidColours(true);
    return mesh;
}

using Numbers = std::vector<std::array<float, 4>>;

/// All corners of a mesh: the results of one of its getters for each.
template <class Get>
Numbers cornersOf(const TnFbxMesh& mesh, Get get) {
    Numbers numbers(static_cast<std::size_t>(mesh.getNumberOfPolygonVertices()));
    for (std::size_t i = 0; i < numbers.size(); ++i)
        get(static_cast<int>(i), numbers[i]);
    return numbers;
}

TEST_P(RoundTrip, OfAMeshWithoutItsEmptyPolygon) {
    const auto source = filledMesh();
    WrittenObjects objects;
    objects.meshes = {source.get()};
    write(objects);

    FacadeRead<TnFbxMesh> meshes(file());
    EXPECT_THAT(meshes.names(), ElementsAre("mesh"));
    const TnFbxMesh& read = meshes["mesh"];
    ASSERT_EQ(read.getNumberOfPolygons(), 2);
    EXPECT_EQ(read.getPolygonVertexSize(0), 4);
    EXPECT_EQ(read.getPolygonVertexSize(1), 3);
    ASSERT_EQ(read.getNumberOfPolygonVertices(), 7);
    for (int i = 0; i < 7; ++i)
        EXPECT_EQ(read.getPointIndex(i), source->getPointIndex(i));
    ASSERT_EQ(read.getNumberOfControlPoints(), 5);
    for (int i = 0; i < 5; ++i) {
        float a[3] = {}, b[3] = {};
        EXPECT_TRUE(source->getControlPoint(i, a[0], a[1], a[2]));
        EXPECT_TRUE(read.getControlPoint(i, b[0], b[1], b[2]));
        EXPECT_THAT(b, testing::ElementsAreArray(a));
    }
    const auto normals = [](const TnFbxMesh& mesh) {
        return cornersOf(
            mesh, [&mesh](int i, auto& n) { EXPECT_TRUE(mesh.getNormal(i, n[0], n[1], n[2])); });
    };
    const auto uvs = [](const TnFbxMesh& mesh) {
        return cornersOf(
            mesh, [&mesh](int i, auto& n) { EXPECT_TRUE(mesh.getUV(i, n[0], n[1])); });
    };
    const auto colours = [](const TnFbxMesh& mesh) {
        return cornersOf(mesh, [&mesh](int i, auto& n) { EXPECT_TRUE(mesh.getColour(i, n[0], n[1], n[2], n[3])); });
    };
    EXPECT_TRUE(read.getValidNormals());
    EXPECT_TRUE(read.getValidUVs());
    EXPECT_TRUE(read.getValidColours());
    EXPECT_EQ(normals(read), normals(*source));
    EXPECT_EQ(uvs(read), uvs(*source));
    EXPECT_EQ(colours(read), colours(*source));
}

TEST_P(RoundTrip, OfABareMesh) {
    const auto source = test::polygonMesh("mesh", 5);
    WrittenObjects objects;
    objects.meshes = {source.get()};
    write(objects);

    FacadeRead<TnFbxMesh> meshes(file());
    const TnFbxMesh& read = meshes["mesh"];
    EXPECT_EQ(read.getPolygonVertexSize(0), 5);
    EXPECT_FALSE(read.getValidNormals());
    EXPECT_FALSE(read.getValidUVs());
    EXPECT_FALSE(read.getValidColours());
}

TEST_P(RoundTrip, OfAnimatedPointsThroughACacheOfEitherFormat) {
    for (const bool maya : {true, false}) {
        const auto source = test::movingMesh("mesh", 3);
        WrittenObjects objects;
        objects.meshes = {source.get()};
        TnFbxWriteInfo options = info();
        options.setAnimateMeshVertices(true);
        options.setMayaVertexCacheFormat(maya);
        options.setStartFrame(10.0f);
        options.setEndFrame(12.0f);
        write(objects, options);

        for (int frame = 10; frame <= 12; ++frame) {
            TnFbxReadInfo readInfo = test::localRead(file());
            readInfo.setFrame(static_cast<float>(frame));
            FacadeRead<TnFbxMesh> meshes(readInfo);
            float x = 0.0f, y = 0.0f, z = -1.0f;
            EXPECT_TRUE(meshes["mesh"].getControlPoint(1, x, y, z));
            EXPECT_EQ(z, static_cast<float>(frame - 10)) << (maya ? "Maya" : "Max");
        }
    }
}

TEST_P(RoundTrip, OfAnimatedPointsStaysWholeWhenTheFolderMoves) {
    const auto source = test::movingMesh("mesh", 3);
    WrittenObjects objects;
    objects.meshes = {source.get()};
    TnFbxWriteInfo options = info();
    options.setFileName(mFolder.file("first/shot.fbx"));
    options.setAnimateMeshVertices(true);
    options.setStartFrame(0.0f);
    options.setEndFrame(2.0f);
    write(objects, options);
    std::filesystem::rename(mFolder.file("first"), mFolder.file("second"));

    TnFbxReadInfo readInfo = test::localRead(mFolder.file("second/shot.fbx"));
    readInfo.setFrame(2.0f);
    FacadeRead<TnFbxMesh> meshes(readInfo);
    float x = 0.0f, y = 0.0f, z = -1.0f;
    EXPECT_TRUE(meshes["mesh"].getControlPoint(1, x, y, z));
    EXPECT_EQ(z, 2.0f);
}

TEST_P(RoundTrip, OfNamesOfAnyCharacters) {
    const std::vector<std::string> names = {"plain",
                                            "two words",
                                            "W\u00fcrfel \u2603",
                                            "with \"quotes\" & <tags>",
                                            "colon:ed",
                                            "semi;colon",
                                            "tab\tbed",
                                            "back\\slash",
                                            "{brace",
                                            ""};
    std::vector<TnFbxNull> nulls(names.size());
    WrittenObjects objects;
    for (std::size_t i = 0; i < names.size(); ++i) {
        nulls[i].setName(names[i]);
        objects.nulls.push_back(&nulls[i]);
    }
    write(objects);

    EXPECT_EQ(FacadeRead<TnFbxNull>(file()).names(), names);
}

TEST_P(RoundTrip, OfObjectsOfOneName) {
    auto first = placed<TnFbxNull>("same"), second = placed<TnFbxNull>("same");
    auto light = placed<TnFbxLight>("same");
    auto camera = placed<Camera>("same");
    second.setTransformValue(Transform::kFbxTransformPositionX, 77.0f);
    second.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(0, 4), {7.0f, 8.0f, 9.0f, 10.0f});
    const auto mesh = test::polygonMesh("same");
    WrittenObjects objects;
    objects.nulls = {&first, &second};
    objects.lights = {&light};
    objects.cameras = {&camera};
    objects.meshes = {mesh.get()};
    write(objects);

    FacadeRead<TnFbxNull> nulls(file());
    FacadeRead<TnFbxLight> lights(file());
    FacadeRead<Camera> cameras(file());
    FacadeRead<TnFbxMesh> meshes(file());
    ASSERT_EQ(nulls.count, 2);
    ASSERT_EQ(lights.count, 1);
    ASSERT_EQ(cameras.count, 8);
    ASSERT_EQ(meshes.count, 1);
    expectPlaced(nulls.objects[0]);
    EXPECT_EQ(nulls.objects[1].getTransformValue(Transform::kFbxTransformPositionX), 77.0f);
    EXPECT_THAT(samplesOf(nulls.objects[1], Transform::kFbxTransformPositionX), ElementsAre(7.0f, 8.0f, 9.0f, 10.0f));
    expectPlaced(lights.objects[0]);
    expectPlaced(cameras.objects[7]);

    const std::vector<std::string> names = {nulls.objects[0].getName(), nulls.objects[1].getName(),
                                            lights.objects[0].getName(), cameras.objects[7].getName(),
                                            meshes.objects[0].getName()};
    if (std::get<0>(GetParam()) == TnFbxWriteInfo::kFbxVersion2010) { // its objects are identified by their names
        EXPECT_THAT(names, testing::Each(testing::StartsWith("same")));
        EXPECT_EQ(std::set<std::string>(names.begin(), names.end()).size(), names.size());
    } else {
        EXPECT_THAT(names, testing::Each(std::string("same")));
    }
}

TEST_P(RoundTrip, OfSamplesThatAreNotFiniteIsReadable) {
    const float kNaN = std::numeric_limits<float>::quiet_NaN();
    const float kInfinity = std::numeric_limits<float>::infinity();
    TnFbxNull null;
    null.setName("null");
    null.setNullSize(kNaN);
    null.setTransformValue(Transform::kFbxTransformPositionX, kInfinity);
    null.setTransformValueAt(Transform::kFbxTransformPositionY, timeOf(0, 3), {kNaN, kInfinity, -kInfinity});
    const auto mesh = test::polygonMesh("mesh");
    mesh->setControlPoint(1, kNaN, kInfinity, -kInfinity);
    WrittenObjects objects;
    objects.nulls = {&null};
    objects.meshes = {mesh.get()};
    write(objects);

    EXPECT_THAT(FacadeRead<TnFbxNull>(file()).names(), ElementsAre("null"));
    EXPECT_EQ(FacadeRead<TnFbxMesh>(file())["mesh"].getNumberOfControlPoints(), 3);
}

TEST_P(RoundTrip, OfPointIndicesOutOfRangeIsReadable) {
    const auto mesh = test::polygonMesh("mesh", 4);
    mesh->setPointIndex(0, -1);
    mesh->setPointIndex(1, std::numeric_limits<int>::min());
    mesh->setPointIndex(3, std::numeric_limits<int>::max());
    const auto sound = test::polygonMesh("sound");
    WrittenObjects objects;
    objects.meshes = {mesh.get(), sound.get()};
    write(objects);

    FacadeRead<TnFbxMesh> meshes(file());
    EXPECT_EQ(meshes["sound"].getPolygonVertexSize(0), 3);
    const TnFbxMesh& read = meshes["mesh"];
    EXPECT_GE(read.getNumberOfPolygons(), 0);
}

// ---- Orientation ----

TEST_P(RoundTrip, TurnsNullsTransformsAndPointLightsInTheirOwnOrder) {
    constexpr std::array<std::array<int, 3>, 6> kAxes = {
        {{0, 1, 2}, {0, 2, 1}, {1, 0, 2}, {1, 2, 0}, {2, 0, 1}, {2, 1, 0}}}; // the axes by order of rotation
    constexpr std::array<double, 3> kDegrees = {20.0, -35.0, 50.0};
    for (std::size_t order = 0; order < kAxes.size(); ++order) {
        TnFbxNull null;
        TnFbxTransform transform;
        TnFbxLight light;
        light.setLightType(TnFbxLight::kFbxLightPoint);
        for (TnFbxTransform* object :
             {static_cast<TnFbxTransform*>(&null), &transform, static_cast<Transform*>(&light)}) {
            object->setTransformRotationOrder(static_cast<Transform::EFbxTransformRotationOrder>(order));
            for (int axis = 0; axis < 3; ++axis) {
                object->setTransformValue(
                    static_cast<Transform::EFbxTransformChannelType>(Transform::kFbxTransformRotationX + axis),
                    static_cast<float>(kDegrees[static_cast<std::size_t>(axis)]));
            }
        }
        WrittenObjects objects;
        objects.nulls = {&null};
        objects.transforms = {&transform};
        objects.lights = {&light};
        write(objects);

        FbxSdk sdk;
        ASSERT_TRUE(Fbx().loadScene(file(), sdk)) << lastError();
        fbxsdk::FbxAMatrix expected;
        for (const int axis : kAxes[order]) {
            fbxsdk::FbxAMatrix turn;
            fbxsdk::FbxVector4 angles;
            angles[axis] = kDegrees[static_cast<std::size_t>(axis)];
            turn.SetR(angles);
            expected = turn * expected;
        }
        fbxsdk::FbxNode* root = sdk.getScene()->GetRootNode();
        ASSERT_EQ(root->GetChildCount(), 3);
        for (int i = 0; i < 3; ++i) {
            const fbxsdk::FbxAMatrix& found = root->GetChild(i)->EvaluateGlobalTransform();
            for (int axis = 0; axis < 3; ++axis) {
                fbxsdk::FbxVector4 unit(0, 0, 0);
                unit[axis] = 1.0;
                const fbxsdk::FbxVector4 difference = found.MultT(unit) - expected.MultT(unit);
                EXPECT_LT(difference.Length(), 1e-6) << "order " << order << ", child " << i;
            }
        }
    }
}

} // namespace
} // namespace Tarnell::Fbx
