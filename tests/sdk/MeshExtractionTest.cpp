// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading meshes from nodes: layout, points and baking.
#include "MeshScenes.h"

#include <gmock/gmock.h>

#include <cmath>
#include <limits>

namespace Tarnell::Fbx {
namespace {

using namespace test;

// ---- Layout and points ----

TEST(MeshExtraction, ReadsNameTransformLayoutAndPoints) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    node->LclTranslation.Set({5.0, 0.0, 0.0});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_EQ(mesh.getName(), "mesh");
    EXPECT_EQ(mesh.getTransformValue(TnFbxTransform::kFbxTransformPositionX), 5.0f);
    ASSERT_EQ(mesh.getNumberOfPolygons(), 2);
    ASSERT_EQ(mesh.getNumberOfControlPoints(), 5);
    ASSERT_EQ(mesh.getNumberOfPolygonVertices(), 7);
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 1);
    EXPECT_EQ(mesh.getPolygonVertexSize(0), 4);
    EXPECT_EQ(mesh.getPolygonVertexSize(1), 3);
    const int corners[] = {0, 1, 2, 3, 3, 2, 4};
    for (int i = 0; i < 7; ++i)
        EXPECT_EQ(mesh.getPointIndex(i), corners[i]);
    EXPECT_EQ(pointOf(mesh, 1), Floats({1.0f, 0.0f, 0.0f}));
    EXPECT_EQ(pointOf(mesh, 4), Floats({0.0f, 2.0f, 0.0f}));
}

TEST(MeshExtraction, WithoutLayersHasNoNormalsCoordinatesOrColours) {
    TestScene scene;

    const TnFbxMesh mesh = readMesh(scene, addTwoPolygons(scene));

    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_FALSE(mesh.getValidUVs());
    EXPECT_FALSE(mesh.getValidColours());
    EXPECT_EQ(normalOf(mesh, 0), kZero3);
    EXPECT_EQ(uvOf(mesh, 0), kZero2);
    EXPECT_EQ(colourOf(mesh, 0), kWhite);
}

TEST(MeshExtraction, WithAnEmptyLayerHasTheDefaults) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    layerOf(node);

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_FALSE(mesh.getValidNormals() || mesh.getValidUVs() || mesh.getValidColours());
    EXPECT_EQ(colourOf(mesh, 6), kWhite);
}

TEST(MeshExtraction, KeepsPointIndicesThatNameNoPoint) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>("damaged");
    test::fillMesh(*node->GetMesh(), {{0.0, 0.0, 0.0}}, {{0, 99, -5}});
    setNormals(node, Element::eByControlPoint, Element::eDirect, {{0.0, 0.0, 1.0}});
    setUVs(node, Element::eByControlPoint, Element::eDirect, {{0.5, 0.5}});
    setColours(node, Element::eByControlPoint, Element::eDirect, {{0.5, 0.5, 0.5, 0.5}});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_EQ(mesh.getPointIndex(1), 99);
    EXPECT_EQ(mesh.getPointIndex(2), -5);
    EXPECT_EQ(normalOf(mesh, 0), Floats({0.0f, 0.0f, 1.0f}));
    for (const int corner : {1, 2}) {
        EXPECT_EQ(normalOf(mesh, corner), kZero3);
        EXPECT_EQ(uvOf(mesh, corner), kZero2);
        EXPECT_EQ(colourOf(mesh, corner), kWhite);
    }
}

TEST(MeshExtraction, FailsForAMeshWithoutPolygonsOrPoints) {
    TestScene scene;
    fbxsdk::FbxNode* empty = scene.add<fbxsdk::FbxMesh>("empty");
    fbxsdk::FbxNode* pointsOnly = scene.add<fbxsdk::FbxMesh>("points only");
    test::fillMesh(*pointsOnly->GetMesh(), {{0.0, 0.0, 0.0}}, {});
    fbxsdk::FbxNode* polygonsOnly = scene.add<fbxsdk::FbxMesh>("polygons only");
    test::fillMesh(*polygonsOnly->GetMesh(), {}, {{0, 1, 2}});

    for (fbxsdk::FbxNode* node : {empty, pointsOnly, polygonsOnly}) {
        TnFbxMesh mesh;
        mesh.allocateGeometryData(1, 1, 1);
        EXPECT_FALSE(readInto(scene, node, mesh));
        EXPECT_EQ(mesh.getName(), node->GetName());
        EXPECT_EQ(mesh.getNumberOfPolygons(), 0);
        EXPECT_THAT(lastError(), testing::HasSubstr(node->GetName()));
    }
}

TEST(MeshExtraction, FailsWithoutANodeOrAMesh) {
    TestScene scene;
    TnFbxMesh mesh;

    EXPECT_FALSE(readInto(scene, nullptr, mesh));
    EXPECT_FALSE(readInto(scene, scene.addNode("bare"), mesh));
    EXPECT_FALSE(readInto(scene, scene.add<fbxsdk::FbxLight>("light"), mesh));
    EXPECT_EQ(mesh.getName(), "");
}

TEST(MeshExtraction, ReplacesWhatTheObjectHeld) {
    TestScene scene;
    TnFbxMesh mesh;
    mesh.allocateGeometryData(10, 10, 30);
    mesh.setValidNormals(true);

    EXPECT_TRUE(readInto(scene, addTwoPolygons(scene), mesh));

    EXPECT_EQ(mesh.getNumberOfPolygons(), 2);
    EXPECT_FALSE(mesh.getValidNormals());
}

TEST(MeshExtraction, ConvertsKeyFramesToTheSampleRate) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {10, 10.0f}});

    const TnFbxMesh mesh = readMesh(scene, node, {false, false, 0.0f, /*sampleRate*/ 48.0f});

    test::expectRange(mesh.getTransformTime(TnFbxTransform::kFbxTransformPositionX), 0, 20, 24.0f);
}

// ---- Baking ----

TEST(MeshBaking, MultipliesByTheLocalTransformTimesTheGeometricOne) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    node->LclTranslation.Set({10.0, 0.0, 0.0});
    node->LclScaling.Set({2.0, 2.0, 2.0});
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(0.0, 0.0, 3.0));

    EXPECT_EQ(pointOf(readMesh(scene, node, {/*transformPoints*/ true}), 1), Floats({12.0f, 0.0f, 6.0f}));
    EXPECT_EQ(pointOf(readMesh(scene, node, {/*transformPoints*/ false}), 1), Floats({1.0f, 0.0f, 0.0f}));
}

TEST(MeshBaking, LeavesTheGeometricTransformToTheWorldTransform) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set({100.0, 0.0, 0.0});
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    parent->AddChild(node);
    node->SetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(0.0, 0.0, 3.0));

    const TnFbxMesh mesh = readMesh(scene, node, {/*transformPoints*/ true, /*global*/ true});

    EXPECT_EQ(pointOf(mesh, 1), Floats({101.0f, 0.0f, 3.0f})); // once, not twice
}

TEST(MeshBaking, TakesTheTransformAtTheFrame) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    node->LclTranslation.Set({50.0, 0.0, 0.0});
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {10, 100.0f}});

    EXPECT_EQ(pointOf(readMesh(scene, node, {true, false, 2.5f}), 0), Floats({25.0f, 0.0f, 0.0f}));
    EXPECT_EQ(pointOf(readMesh(scene, node, {true, true, 5.0f}), 0), Floats({50.0f, 0.0f, 0.0f}));
}

TEST(MeshBaking, TurnsNormalsByTheRotationAlone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    node->LclTranslation.Set({10.0, 20.0, 30.0});
    node->LclRotation.Set({0.0, 90.0, 0.0});
    node->LclScaling.Set({5.0, 5.0, 5.0});
    setNormals(node, Element::eByPolygonVertex, Element::eDirect, kSevenNormals);

    const Floats normal = normalOf(readMesh(scene, node, {/*transformPoints*/ true}), 1);

    EXPECT_NEAR(normal[0], 2.0f, 1e-6f);
    EXPECT_NEAR(normal[1], 0.0f, 1e-6f);
    EXPECT_NEAR(normal[2], 0.0f, 1e-6f);
    EXPECT_EQ(normalOf(readMesh(scene, node), 1), Floats({0.0f, 0.0f, 2.0f}));
}

void expectNear(const Floats& values, const Floats& expected) {
    EXPECT_THAT(values, testing::Pointwise(testing::FloatNear(1e-5f), expected));
}

/// Rotated by its geometric rotation about X, then by its own about Z.
fbxsdk::FbxNode* addTurnedPolygons(TestScene& scene) {
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    node->LclRotation.Set({0.0, 0.0, 90.0});
    node->SetGeometricRotation(fbxsdk::FbxNode::eSourcePivot, FbxVector4(90.0, 0.0, 0.0));
    setNormals(node, Element::eByPolygonVertex, Element::eDirect, std::vector<FbxVector4>(7, {0.0, 1.0, 2.0}));
    return node;
}

TEST(MeshBaking, TurnsPointsAndNormalsByTheGeometricRotationFirst) {
    for (const bool global : {false, true}) {
        SCOPED_TRACE(global);
        TestScene scene;
        fbxsdk::FbxNode* node = addTurnedPolygons(scene);
        node->LclTranslation.Set({10.0, 0.0, 0.0});

        const TnFbxMesh mesh = readMesh(scene, node, {/*transformPoints*/ true, global});

        expectNear(pointOf(mesh, 2), {10.0f, 1.0f, 1.0f}); // (1, 1, 0) by way of (1, 0, 1)
        expectNear(normalOf(mesh, 0), {2.0f, 0.0f, 1.0f}); // (0, 1, 2) by way of (0, −2, 1)
    }
}

TEST(MeshBaking, AppliesTheAnglesOfTheOriginInTheOrderXYZ) {
    TestScene scene;

    const TnFbxMesh mesh = readMesh(scene, addTurnedPolygons(scene), {/*transformPoints*/ true, /*global*/ true});

    // There the angles are those that give the rotation in the order ZXY.
    expectNear({mesh.getTransformValue(TnFbxTransform::kFbxTransformRotationX),
                mesh.getTransformValue(TnFbxTransform::kFbxTransformRotationY),
                mesh.getTransformValue(TnFbxTransform::kFbxTransformRotationZ)},
               {0.0f, 90.0f, 90.0f});
    expectNear(pointOf(mesh, 2), {-1.0f, 0.0f, -1.0f});
    expectNear(normalOf(mesh, 0), {-1.0f, 2.0f, 0.0f});
}

TEST(MeshBaking, IsFalsifiedAtTheOriginByOneAngleOrAMirroredAxisAlone) {
    const float half = std::sqrt(3.0f);
    for (const double offset : {0.0, 1e-9}) {
        SCOPED_TRACE(offset);
        TestScene scene;
        fbxsdk::FbxNode* node = addTwoPolygons(scene);
        node->LclTranslation.Set({offset, 0.0, 0.0});
        const bool right = offset != 0.0;

        node->LclRotation.Set({120.0, 0.0, 0.0}); // 60, 180, 180 at the origin: in the order XYZ that is −120 about X
        expectNear(pointOf(readMesh(scene, node, {/*transformPoints*/ true, /*global*/ true}), 4),
                   {0.0f, -1.0f, right ? half : -half});
        node->LclRotation.Set({0.0, 0.0, 0.0});
        node->LclScaling.Set({1.0, -1.0, 1.0}); // half a turn about Z and three negative scales there
        expectNear(pointOf(readMesh(scene, node, {true, true}), 2), {1.0f, right ? -1.0f : 1.0f, 0.0f});
    }
}

TEST(MeshExtraction, PassesOnNumbersThatAreNone) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>("damaged");
    test::fillMesh(*node->GetMesh(), {{nan, 1e300, -1e300}, {0.0, 0.0, 0.0}, {0.0, 0.0, 0.0}}, {{0, 1, 2}});
    node->LclScaling.Set({nan, 0.0, 0.0});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_NE(pointOf(mesh, 0)[0], pointOf(mesh, 0)[0]);
    EXPECT_EQ(pointOf(mesh, 0)[1], std::numeric_limits<float>::infinity());
    readMesh(scene, node, {/*transformPoints*/ true, /*global*/ true});
}

} // namespace
} // namespace Tarnell::Fbx
