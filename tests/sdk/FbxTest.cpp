// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The facade: the effect of each read's options, its outputs and its file, in complete calls.
#include "Fbx.h"

#include "FbxSdk.h"
#include "TnFbxError.h"
#include "support/SceneBuilders.h"
#include "support/TemporaryFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <memory>
#include <string>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using test::samplesOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using Names = std::vector<std::string>;
using Samples = std::vector<float>;
using Transform = TnFbxTransform;

std::string dataFile(const char* name) { return std::string(TARNELL_TEST_DATA "/sdk/") + name; }

TnFbxReadInfo optionsFor(const char* name) {
    TnFbxReadInfo info;
    info.setFileName(dataFile(name));
    info.setAnimationStackName("any name will do");
    return info;
}

TnFbxReadInfo optionsFor(const char* name, const char* objectName) {
    TnFbxReadInfo info = optionsFor(name);
    info.setAllObjects(false);
    info.setObjectName(objectName);
    return info;
}

std::string textOf(const char* name) {
    std::ifstream in(dataFile(name), std::ios::binary);
    return {std::istreambuf_iterator<char>(in), {}};
}

/// Where a part of a file starts, which occurs once.
std::size_t startOf(const std::string& text, const std::string& part) {
    const std::size_t start = text.find(part);
    EXPECT_NE(start, std::string::npos) << part;
    EXPECT_EQ(text.find(part, start + 1), std::string::npos) << part;
    return std::min(start, text.size());
}

/// The text with one part of it replaced.
std::string edited(std::string text, const std::string& part, const std::string& replacement) {
    return text.replace(startOf(text, part), part.size(), replacement);
}

template <class Object>
using Reader = bool (Fbx::*)(TnFbxReadInfo&, Object**, int&) const;

/// The result of one read; owns the array as a host does.
template <class Object>
struct Read {
    Read(Reader<Object> reader, TnFbxReadInfo info) {
        Object* made = reinterpret_cast<Object*>(this); // to be replaced, also by null
        result = (Fbx().*reader)(info, &made, count);
        objects.reset(made);
    }

    Names names() const {
        Names all;
        for (int i = 0; i < count; ++i)
            all.push_back(objects[static_cast<std::size_t>(i)].getName());
        return all;
    }

    bool result = false;
    int count = -1;
    std::unique_ptr<Object[]> objects;
};

/// Calls a test body for each of the six readers.
template <class Body>
void forEachReader(Body body) {
    body(&Fbx::getMeshes, "meshes");
    body(&Fbx::getCameras, "cameras");
    body(&Fbx::getLights, "lights");
    body(&Fbx::getMarkers, "markers");
    body(&Fbx::getNulls, "nulls");
    body(&Fbx::getTransforms, "transforms");
}

template <class Object>
Object* noArray(Reader<Object>) {
    return nullptr;
}

// ---- Options ----

TEST(FbxOptions, NeedAPlaceForTheArrayAndLeaveTheCountAloneWithoutOne) {
    forEachReader([](auto reader, const char* kind) {
        TnFbxReadInfo info = optionsFor("mesh_7400_ascii.fbx");
        int count = 17;
        decltype(noArray(reader))* nowhere = nullptr;

        EXPECT_FALSE((Fbx().*reader)(info, nowhere, count)) << kind;

        EXPECT_EQ(count, 17) << kind;
        EXPECT_FALSE(lastError().empty()) << kind;
    });
}

TEST(FbxOptions, NeedAnAnimationStackEvenForAFileWithoutAnimation) {
    forEachReader([](auto reader, const char* kind) {
        TnFbxReadInfo info = optionsFor("nulls_7400_ascii.fbx");
        info.setAnimationStackName("");
        const Read read(reader, info);

        EXPECT_FALSE(read.result) << kind;
        EXPECT_EQ(read.count, 0) << kind;
        EXPECT_EQ(read.objects, nullptr) << kind;
        EXPECT_THAT(lastError(), HasSubstr("animation stack")) << kind;
    });
}

TEST(FbxOptions, NeedAFileName) {
    forEachReader([](auto reader, const char* kind) {
        TnFbxReadInfo info = optionsFor("nulls_7400_ascii.fbx");
        info.setFileName("");
        const Read read(reader, info);

        EXPECT_FALSE(read.result) << kind;
        EXPECT_EQ(read.count, 0) << kind;
        EXPECT_EQ(read.objects, nullptr) << kind;
        EXPECT_THAT(lastError(), HasSubstr("file")) << kind;
    });
}

TEST(FbxOptions, AreCheckedForTheStackBeforeTheFile) {
    TnFbxReadInfo info;
    const Read read(&Fbx::getLights, info);

    EXPECT_THAT(lastError(), HasSubstr("animation stack"));
}

TEST(FbxReading, FailsForAFileThatIsNotThere) {
    forEachReader([](auto reader, const char* kind) {
        const Read read(reader, optionsFor("there is no such file.fbx"));

        EXPECT_FALSE(read.result) << kind;
        EXPECT_EQ(read.count, 0) << kind;
        EXPECT_EQ(read.objects, nullptr) << kind;
        EXPECT_THAT(lastError(), HasSubstr("there is no such file.fbx")) << kind;
    });
}

TEST(FbxReading, FailsForAFileThatStopsWithinABlock) {
    const support::TemporaryFolder folder;
    const std::string whole = textOf("mesh_7400_ascii.fbx");
    const std::size_t ends[] = {startOf(whole, "FBXVersion"),    startOf(whole, "Vertices: *15"),
                                startOf(whole, "0,1,2,-4"),      startOf(whole, "LayerElementUV: 0"),
                                startOf(whole, "10,0,0"),        startOf(whole, "Material: 3"),
                                startOf(whole, "C: \"OO\",1,2"), whole.size() - 2};
    for (const std::size_t end : ends) {
        TnFbxReadInfo info = optionsFor("");
        info.setFileName(folder.write("cut.fbx", whole.substr(0, end)));

        const Read read(&Fbx::getMeshes, info);

        EXPECT_FALSE(read.result) << end;
        EXPECT_EQ(read.count, 0) << end;
        EXPECT_EQ(read.objects, nullptr) << end;
        EXPECT_THAT(lastError(), HasSubstr("cut.fbx: line ")) << end;
    }
}

TEST(FbxReading, TakesAFileThatStopsBetweenBlocksForAWholeOne) {
    const support::TemporaryFolder folder;
    const std::string whole = textOf("mesh_7400_ascii.fbx");
    for (const char* next : {"Objects:", "Connections:"}) { // no mesh yet, and none below the root
        TnFbxReadInfo info = optionsFor("");
        info.setFileName(folder.write("cut.fbx", whole.substr(0, startOf(whole, next))));

        const Read read(&Fbx::getMeshes, info);

        EXPECT_TRUE(read.result) << next << lastError();
        EXPECT_EQ(read.count, 0) << next;
        EXPECT_EQ(read.objects, nullptr) << next;
    }
}

TEST(FbxReading, ForgetsTheLastErrorAfterASuccess) {
    const Read failed(&Fbx::getLights, TnFbxReadInfo());
    ASSERT_FALSE(lastError().empty());

    const Read read(&Fbx::getLights, optionsFor("lights_7400_ascii.fbx"));

    EXPECT_TRUE(read.result);
    EXPECT_EQ(lastError(), "");
}

// ---- Readers ----

TEST(FbxReading, ReturnsEveryObjectOfTheKind) {
    const Read read(&Fbx::getLights, optionsFor("lights_7400_ascii.fbx"));

    EXPECT_TRUE(read.result) << lastError();
    EXPECT_EQ(read.names(), Names({"point", "directional", "spot", "area"}));
}

TEST(FbxReading, ReturnsANullArrayForAKindThatTheFileLacks) {
    const Read meshes(&Fbx::getMeshes, optionsFor("lights_7400_ascii.fbx"));
    const Read markers(&Fbx::getMarkers, optionsFor("lights_7400_ascii.fbx"));

    EXPECT_TRUE(meshes.result);
    EXPECT_EQ(meshes.count, 0);
    EXPECT_EQ(meshes.objects, nullptr);
    EXPECT_TRUE(markers.result);
    EXPECT_EQ(markers.objects, nullptr);
    EXPECT_EQ(lastError(), "");
}

TEST(FbxReading, ReturnsASingleObjectByName) {
    const Read read(&Fbx::getLights, optionsFor("lights_7400_ascii.fbx", "area"));

    EXPECT_TRUE(read.result);
    EXPECT_EQ(read.names(), Names({"area"}));
}

TEST(FbxReading, ReturnsNothingForANameThatNoNodeOfTheKindHas) {
    for (const char* name : {"Area", "are", "", "camera"}) {
        const Read read(&Fbx::getLights, optionsFor("lights_7400_ascii.fbx", name));

        EXPECT_TRUE(read.result);
        EXPECT_EQ(read.count, 0);
        EXPECT_EQ(read.objects, nullptr);
    }
}

TEST(FbxReading, ByNameFindsTheNodesOfTheKindAndNoOthers) {
    struct Row {
        const char* file;
        const char* name;
        Names kinds; // which belongs to the node
    };
    const Row rows[] = {{"mesh_7400_ascii.fbx", "shape", {"meshes", "transforms"}},
                        {"camera_7400_ascii.fbx", "shot", {"cameras"}},
                        {"lights_7400_ascii.fbx", "spot", {"lights"}},
                        {"markers_7400_ascii.fbx", "capsule", {"markers", "transforms"}},
                        {"nulls_7400_ascii.fbx", "child", {"nulls", "transforms"}}};
    for (const Row& row : rows) {
        forEachReader([&row](auto reader, const std::string& kind) {
            const Read read(reader, optionsFor(row.file, row.name));
            const bool isOfKind = std::find(row.kinds.begin(), row.kinds.end(), kind) != row.kinds.end();

            EXPECT_TRUE(read.result) << kind << " of " << row.file << ": " << lastError();
            EXPECT_EQ(read.names(), isOfKind ? Names({row.name}) : Names()) << kind << " of " << row.file;
            EXPECT_EQ(read.objects == nullptr, !isOfKind) << kind << " of " << row.file;
        });
    }
}

TEST(FbxReading, ByNameReturnsTheValuesOfTheNode) {
    const Read mesh(&Fbx::getMeshes, optionsFor("mesh_7400_ascii.fbx", "shape"));
    ASSERT_EQ(mesh.count, 1);
    EXPECT_EQ(mesh.objects[0].getNumberOfPolygons(), 2);
    EXPECT_EQ(mesh.objects[0].getTransformValue(Transform::kFbxTransformPositionX), 10.0f);

    const Read marker(&Fbx::getMarkers, optionsFor("markers_7400_ascii.fbx", "sphere"));
    ASSERT_EQ(marker.count, 1);
    EXPECT_EQ(marker.objects[0].getMarkerSize(), 12.0f);
    EXPECT_EQ(marker.objects[0].getMarkerLookType(), TnFbxMarker::kFbxMarkerLookSphere);

    const Read null(&Fbx::getNulls, optionsFor("nulls_7400_ascii.fbx", "parent"));
    ASSERT_EQ(null.count, 1);
    EXPECT_EQ(null.objects[0].getNullSize(), 25.0f);

    const Read transform(&Fbx::getTransforms, optionsFor("markers_7400_ascii.fbx", "capsule"));
    ASSERT_EQ(transform.count, 1);
    EXPECT_EQ(transform.objects[0].getTransformValue(Transform::kFbxTransformPositionX), 2.0f);
}

TEST(FbxReading, ByNameTellsAMeshFromANullOfItsName) {
    const support::TemporaryFolder folder;
    const std::string withNull =
        edited(textOf("mesh_7400_ascii.fbx"), "Model: 2,",
               "Model: 9, \"Model::shape\", \"Null\" {\nProperties70:  {\n"
               "P: \"Lcl Translation\", \"Lcl Translation\", \"\", \"A\",5,0,0\n}\n}\nModel: 2,");
    TnFbxReadInfo info = optionsFor("", "shape");
    info.setFileName(folder.write("twins.fbx", edited(withNull, "C: \"OO\",2,0", "C: \"OO\",9,0\nC: \"OO\",2,0")));

    const Read meshes(&Fbx::getMeshes, info);
    const Read nulls(&Fbx::getNulls, info);
    const Read transforms(&Fbx::getTransforms, info);

    ASSERT_EQ(meshes.names(), Names({"shape"}));
    EXPECT_EQ(meshes.objects[0].getTransformValue(Transform::kFbxTransformPositionX), 10.0f);
    ASSERT_EQ(nulls.names(), Names({"shape"}));
    EXPECT_EQ(nulls.objects[0].getTransformValue(Transform::kFbxTransformPositionX), 5.0f);
    ASSERT_EQ(transforms.names(), Names({"shape"}));
    EXPECT_EQ(transforms.objects[0].getTransformValue(Transform::kFbxTransformPositionX),
              5.0f); // the first in the tree
}

TEST(FbxReading, ByNameReturnsTheFirstOfSeveralWithTheName) {
    const support::TemporaryFolder folder;
    TnFbxReadInfo info = optionsFor("", "parent");
    info.setFileName(
        folder.write("twice.fbx", edited(textOf("nulls_7400_ascii.fbx"), "Model::child", "Model::parent")));

    const Read read(&Fbx::getNulls, info);

    EXPECT_TRUE(read.result) << lastError();
    ASSERT_EQ(read.names(), Names({"parent"}));
    EXPECT_EQ(read.objects[0].getNullSize(), 25.0f); // the second has size 1 and is at X 11
    EXPECT_EQ(read.objects[0].getTransformValue(Transform::kFbxTransformPositionX), 1.0f);

    info.setAllObjects(true);
    EXPECT_EQ(Read(&Fbx::getNulls, info).names(), Names({"parent", "parent"}));
}

TEST(FbxReading, ReturnsProducerCamerasAlsoOfAFileWithoutCameras) {
    const Read all(&Fbx::getCameras, optionsFor("nulls_7400_ascii.fbx"));
    EXPECT_TRUE(all.result);
    EXPECT_EQ(all.names(), Names({"Producer Perspective", "Producer Top", "Producer Bottom", "Producer Front",
                                  "Producer Back", "Producer Right", "Producer Left"}));

    const Read one(&Fbx::getCameras, optionsFor("nulls_7400_ascii.fbx", "Producer Left"));
    EXPECT_EQ(one.names(), Names({"Producer Left"}));
}

TEST(FbxReading, ReadsTheFirstStackWhateverTheName) {
    TnFbxReadInfo info = optionsFor("camera_7400_ascii.fbx", "shot");
    info.setAnimationStackName("no stack of the file is called so");
    const Read read(&Fbx::getCameras, info);

    ASSERT_EQ(read.count, 1);
    test::expectRange(read.objects[0].getTransformTime(Transform::kFbxTransformPositionX), 1001, 1010, 24.0f);
}

class FbxReadingOfEachGeneration : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(Files, FbxReadingOfEachGeneration,
                         testing::Values("camera_5800_ascii.fbx", "camera_6100_ascii.fbx", "camera_7400_ascii.fbx"));

TEST_P(FbxReadingOfEachGeneration, GivesAnAnimatedCamera) {
    const Read read(&Fbx::getCameras, optionsFor(GetParam(), "shot"));

    ASSERT_EQ(read.count, 1) << lastError();
    const TnFbxCamera& camera = read.objects[0];
    EXPECT_EQ(samplesOf(camera, Transform::kFbxTransformPositionX),
              Samples({0.0f, 1.0f, 2.0f, 3.0f, 4.0f, 5.0f, 6.0f, 7.0f, 8.0f, 9.0f}));
    EXPECT_EQ(samplesOf(camera, TnFbxCamera::kFbxCameraFocalLength),
              Samples({35.0f, 40.0f, 45.0f, 50.0f, 55.0f, 60.0f, 65.0f, 70.0f, 75.0f, 80.0f}));
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraFocalLength), 35.0f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraApertureWidth), 1.5f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraApertureHeight), 0.75f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraNearPlane), 0.5f);
    EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraFarPlane), 5000.0f);
    EXPECT_EQ(camera.getTransformValue(Transform::kFbxTransformRotationY), 20.0f);
    EXPECT_EQ(camera.getApertureMode(), TnFbxCamera::kFbxApertureFocalLength);
}

TEST(FbxReading, OfMeshesOfOldGenerations) {
    for (const char* file : {"camera_5800_ascii.fbx", "camera_6100_ascii.fbx"}) {
        const Read read(&Fbx::getMeshes, optionsFor(file));

        ASSERT_EQ(read.names(), Names({"triangle"})) << file;
        float x = 0.0f, y = 0.0f, z = 0.0f;
        EXPECT_TRUE(read.objects[0].getControlPoint(1, x, y, z));
        EXPECT_EQ(Samples({x, y, z}), Samples({4.0f, 0.0f, 0.0f})) << file;
    }
}

TEST(FbxReading, OfACameraAtAnotherRate) {
    TnFbxReadInfo info = optionsFor("camera_7400_ascii.fbx", "shot");
    info.setUseSampleFPS(true);
    info.setSampleFPS(48.0f);
    const Read read(&Fbx::getCameras, info);

    ASSERT_EQ(read.count, 1);
    test::expectRange(read.objects[0].getTransformTime(Transform::kFbxTransformPositionX), 2002, 2020, 24.0f);
}

TEST(FbxReading, OfACameraThatFollowsATarget) {
    const Read read(&Fbx::getCameras, optionsFor("target_camera_7400_ascii.fbx", "follow"));

    ASSERT_EQ(read.count, 1);
    const TnFbxCamera& camera = read.objects[0];
    EXPECT_EQ(samplesOf(camera, TnFbxCamera::kFbxCameraLookAtPositionX), Samples({0.0f, 10.0f, 20.0f, 30.0f, 40.0f}));
    EXPECT_EQ(camera.getTransformRotationOrder(), Transform::kFbxRotationOrderZXY);
    EXPECT_FLOAT_EQ(camera.getTransformValueAt(Transform::kFbxTransformRotationY, 1.0f), -45.0f);
}

TEST(FbxReading, OfLights) {
    const Read read(&Fbx::getLights, optionsFor("lights_7400_ascii.fbx"));

    ASSERT_EQ(read.count, 4);
    const TnFbxLight& spot = read.objects[2];
    EXPECT_EQ(read.objects[0].getLightType(), TnFbxLight::kFbxLightPoint);
    EXPECT_EQ(read.objects[1].getLightType(), TnFbxLight::kFbxLightDirectional);
    EXPECT_EQ(spot.getLightType(), TnFbxLight::kFbxLightSpot);
    EXPECT_EQ(read.objects[3].getLightType(), TnFbxLight::kFbxLightPoint);
    EXPECT_EQ(spot.getDecayType(), TnFbxLight::kFbxLightDecayQuadratic);
    EXPECT_EQ(samplesOf(spot, TnFbxLight::kFbxLightIntensity), Samples({0.0f, 100.0f * 0.01f, 200.0f * 0.01f}));
    EXPECT_EQ(spot.getValue(TnFbxLight::kFbxLightConeAngle), 30.0f);
    EXPECT_EQ(spot.getValue(TnFbxLight::kFbxLightGreen), 0.5f);
    EXPECT_NEAR(spot.getTransformValue(Transform::kFbxTransformRotationX), -90.0f, 1e-4f);
    EXPECT_EQ(read.objects[3].getTransformValue(Transform::kFbxTransformPositionX), 7.0f); // below the spot
}

TEST(FbxReading, OfMarkersAndNullsAndTransforms) {
    const Read markers(&Fbx::getMarkers, optionsFor("markers_7400_ascii.fbx"));
    ASSERT_EQ(markers.names(), Names({"sphere", "capsule"}));
    EXPECT_EQ(markers.objects[0].getMarkerLookType(), TnFbxMarker::kFbxMarkerLookSphere);
    EXPECT_EQ(markers.objects[0].getMarkerSize(), 12.0f);
    EXPECT_EQ(markers.objects[0].getValue(TnFbxMarker::kFbxMarkerBlue), 0.75f);
    EXPECT_EQ(markers.objects[1].getMarkerLookType(), TnFbxMarker::kFbxMarkerLookCube);

    const Read nulls(&Fbx::getNulls, optionsFor("nulls_7400_ascii.fbx"));
    ASSERT_EQ(nulls.names(), Names({"parent", "child"}));
    EXPECT_EQ(nulls.objects[0].getNullSize(), 25.0f);
    EXPECT_EQ(nulls.objects[1].getNullSize(), 1.0f);
    EXPECT_EQ(nulls.objects[1].getTransformValue(Transform::kFbxTransformPositionX), 11.0f);

    const Read transforms(&Fbx::getTransforms, optionsFor("mesh_7400_ascii.fbx"));
    EXPECT_EQ(transforms.names(), Names({"shape"}));
}

TEST(FbxReading, OfAMesh) {
    const Read read(&Fbx::getMeshes, optionsFor("mesh_7400_ascii.fbx"));

    ASSERT_EQ(read.count, 1) << lastError();
    const TnFbxMesh& mesh = read.objects[0];
    EXPECT_EQ(mesh.getNumberOfPolygons(), 2);
    EXPECT_EQ(mesh.getNumberOfControlPoints(), 5);
    EXPECT_EQ(mesh.getPointIndex(6), 4);
    float x = 0.0f, y = 0.0f, z = 0.0f, w = 0.0f;
    EXPECT_TRUE(mesh.getControlPoint(4, x, y, z));
    EXPECT_EQ(Samples({x, y, z}), Samples({10.0f, 2.0f, 0.0f}));
    EXPECT_TRUE(mesh.getValidNormals() && mesh.getValidUVs() && mesh.getValidColours());
    EXPECT_TRUE(mesh.getNormal(6, x, y, z));
    EXPECT_EQ(Samples({x, y, z}), Samples({0.0f, 0.0f, -1.0f}));
    EXPECT_TRUE(mesh.getUV(2, x, y));
    EXPECT_EQ(Samples({x, y}), Samples({1.0f, 0.5f}));
    EXPECT_TRUE(mesh.getColour(6, x, y, z, w));
    EXPECT_EQ(Samples({x, y, z, w}), Samples({0.0f, 0.25f, 0.5f, 0.75f}));
}

TEST(FbxReading, MakesMeshesOfNurbs) {
    const Read read(&Fbx::getMeshes, optionsFor("nurbs_7400_ascii.fbx"));

    ASSERT_EQ(read.names(), Names({"sheet"}));
    EXPECT_GT(read.objects[0].getNumberOfPolygons(), 0);
}

// ---- Loading and counting for a caller's context ----

TEST(FbxLoadScene, FillsTheContextAndConvertsGeometry) {
    FbxSdk sdk;

    EXPECT_TRUE(Fbx().loadScene(dataFile("nurbs_7400_ascii.fbx"), sdk)) << lastError();

    EXPECT_EQ(sdk.getNumberOfMeshes(), 1);
}

TEST(FbxLoadScene, LeavesTheContextWithoutASceneAfterAFailure) {
    FbxSdk sdk;
    EXPECT_FALSE(Fbx().loadScene("", sdk));
    EXPECT_FALSE(lastError().empty());

    EXPECT_FALSE(Fbx().loadScene("there is no such file.fbx", sdk));
    EXPECT_THAT(lastError(), HasSubstr("there is no such file.fbx"));
    EXPECT_EQ(sdk.getScene(), nullptr);
}

TEST(FbxObjectCount, IsTheNumberOfCandidatesWhenAllAreRequested) {
    FbxSdk sdk; // names are not compared
    EXPECT_EQ(Fbx().getNumberOfObjects(5, true, 4, "", sdk), 5);
    EXPECT_EQ(Fbx().getNumberOfObjects(0, true, 4, "", sdk), 0);
    EXPECT_EQ(Fbx().getNumberOfObjects(-1, true, 4, "", sdk), 0);
    EXPECT_EQ(Fbx().getNumberOfObjects(-1, false, 4, "name", sdk), 0);
}

TEST(FbxObjectCount, IsOneOrNoneByName) {
    test::TestScene scene;
    scene.addNode("twice");
    scene.addNode("twice");
    const Fbx fbx;

    EXPECT_EQ(fbx.getNumberOfObjects(2, false, 0x4000, "twice", scene.sdk), 1);
    EXPECT_EQ(fbx.getNumberOfObjects(0, false, 0x4000, "twice", scene.sdk), 1) << "the count plays no part";
    EXPECT_EQ(fbx.getNumberOfObjects(2, false, 0x4000, "Twice", scene.sdk), 0);
    EXPECT_EQ(fbx.getNumberOfObjects(2, false, 0x4000, "", scene.sdk), 0);
    EXPECT_EQ(fbx.getNumberOfObjects(2, false, 64, "twice", scene.sdk), 0);
    EXPECT_EQ(fbx.getNumberOfObjects(2, false, 32, "Producer Back", scene.sdk), 1);
}

TEST(FbxObjectCount, IsNoneWithoutAScene) {
    FbxSdk sdk;
    EXPECT_EQ(Fbx().getNumberOfObjects(2, false, 0x4000, "name", sdk), 0);
}

// ---- Names and time ----

TEST(FbxNames, AreThoseOfStacksAndNodes) {
    Names stacks = {"to be removed"}, nodes = {"to be removed"};

    EXPECT_TRUE(Fbx().getAnimationStackNodeNames(dataFile("camera_7400_ascii.fbx").c_str(), 32, stacks, nodes));

    EXPECT_THAT(stacks, ElementsAre("Shot"));
    ASSERT_EQ(nodes.size(), 8u);
    EXPECT_EQ(nodes.front(), "Producer Perspective");
    EXPECT_EQ(nodes.back(), "shot");
}

TEST(FbxNames, OfAFileWithoutAStackAreThoseOfTheOneThatReadingMakes) {
    Names stacks, nodes;

    EXPECT_TRUE(Fbx().getAnimationStackNodeNames(dataFile("nulls_7400_ascii.fbx").c_str(), 0x4000, stacks, nodes));

    EXPECT_THAT(stacks, ElementsAre("Take 001"));
    EXPECT_THAT(nodes, ElementsAre("parent", "child"));
}

TEST(FbxNames, StayAsTheyAreWhenTheFileCannotBeRead) {
    for (const char* name : std::initializer_list<const char*>{"", "there is no such file.fbx", nullptr}) {
        Names stacks = {"stack"}, nodes = {"node"};

        EXPECT_FALSE(Fbx().getAnimationStackNodeNames(name, 0x4000, stacks, nodes));

        EXPECT_THAT(stacks, ElementsAre("stack"));
        EXPECT_THAT(nodes, ElementsAre("node"));
        EXPECT_FALSE(lastError().empty());
    }
}

TEST(FbxFrameRange, IsInSeconds) {
    float start = -1.0f, end = -1.0f;

    EXPECT_TRUE(Fbx().getAnimationFrameRange(dataFile("camera_7400_ascii.fbx").c_str(), start, end));

    EXPECT_FLOAT_EQ(start, 1001.0f / 24.0f);
    EXPECT_FLOAT_EQ(end, 1010.0f / 24.0f);
}

TEST(FbxFrameRange, FailsForAStillFileAndForNone) {
    float start = 1.0f, end = 2.0f;
    EXPECT_FALSE(Fbx().getAnimationFrameRange("", start, end));
    EXPECT_FALSE(Fbx().getAnimationFrameRange(nullptr, start, end));
    EXPECT_FALSE(Fbx().getAnimationFrameRange("there is no such file.fbx", start, end));
    EXPECT_EQ(start, 1.0f);
    EXPECT_EQ(end, 2.0f);

    EXPECT_FALSE(Fbx().getAnimationFrameRange(dataFile("nulls_7400_ascii.fbx").c_str(), start, end));
    EXPECT_GT(start, end);
    EXPECT_FALSE(lastError().empty());
}

// ---- The facade itself ----

TEST(FbxFacade, CanBeCopiedAndAssigned) {
    Fbx first;
    Fbx second(first);

    EXPECT_EQ(&(first = second), &first);
}

} // namespace
} // namespace Tarnell::Fbx
