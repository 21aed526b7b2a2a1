// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes out of nodes: layout, points, baking, and what layers say about polygon corners.
#include "support/SceneBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <limits>
#include <memory>
#include <stdexcept>
#include <string>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxColor;
using fbxsdk::FbxVector2;
using fbxsdk::FbxVector4;
using test::TestScene;
using Element = fbxsdk::FbxLayerElement;
using Floats = std::vector<float>;

struct ReadOptions {
    bool transformPoints = false;
    bool global = false;
    float frame = 0.0f;
    float sampleRate = 0.0f; // converts key frames when above 0
};

bool readInto(TestScene& scene, fbxsdk::FbxNode* node, TnFbxMesh& mesh, ReadOptions options = {}) {
    TnFbxTime time = scene.time(options.frame);
    fbxsdk::FbxAMatrix geometric;
    if (node != nullptr) {
        geometric.SetTRS(node->GetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot),
                         node->GetGeometricRotation(fbxsdk::FbxNode::eSourcePivot),
                         node->GetGeometricScaling(fbxsdk::FbxNode::eSourcePivot));
    }
    return scene.sdk.getMesh(time, options.global, options.sampleRate > 0.0f, options.sampleRate, node,
                             options.transformPoints, mesh, geometric);
}

TnFbxMesh readMesh(TestScene& scene, fbxsdk::FbxNode* node, ReadOptions options = {}) {
    TnFbxMesh mesh;
    EXPECT_TRUE(readInto(scene, node, mesh, options)) << lastError();
    return mesh;
}

Floats pointOf(const TnFbxMesh& mesh, int index) {
    Floats p(3);
    EXPECT_TRUE(mesh.getControlPoint(index, p[0], p[1], p[2]));
    return p;
}

Floats normalOf(const TnFbxMesh& mesh, int polygonVertex) {
    Floats n(3);
    EXPECT_TRUE(mesh.getNormal(polygonVertex, n[0], n[1], n[2]));
    return n;
}

Floats uvOf(const TnFbxMesh& mesh, int polygonVertex) {
    Floats uv(2);
    EXPECT_TRUE(mesh.getUV(polygonVertex, uv[0], uv[1]));
    return uv;
}

Floats colourOf(const TnFbxMesh& mesh, int polygonVertex) {
    Floats c(4);
    EXPECT_TRUE(mesh.getColour(polygonVertex, c[0], c[1], c[2], c[3]));
    return c;
}

/// A quad 0 1 2 3 and a triangle 3 2 4, without layers.
fbxsdk::FbxNode* addTwoPolygons(TestScene& scene) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMesh>("mesh");
    test::fillMesh(*node->GetMesh(),
                   {{0.0, 0.0, 0.0}, {1.0, 0.0, 0.0}, {1.0, 1.0, 0.0}, {0.0, 1.0, 0.0}, {0.0, 2.0, 0.0}},
                   {{0, 1, 2, 3}, {3, 2, 4}});
    return node;
}

fbxsdk::FbxLayer& layerOf(fbxsdk::FbxNode* node, int index = 0) {
    fbxsdk::FbxMesh* mesh = node->GetMesh();
    while (mesh->GetLayerCount() <= index) {
        mesh->CreateLayer();
    }
    return *mesh->GetLayer(index);
}

template <class ElementType, class Value>
ElementType* makeElement(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                         const std::vector<Value>& values, const std::vector<int>& indices) {
    auto* element = ElementType::Create(node->GetMesh(), "");
    element->SetMappingMode(mapping);
    element->SetReferenceMode(reference);
    for (const Value& value : values) {
        element->GetDirectArray().Add(value);
    }
    for (const int index : indices) {
        element->GetIndexArray().Add(index);
    }
    return element;
}

void setNormals(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                const std::vector<FbxVector4>& values, const std::vector<int>& indices = {}, int layer = 0) {
    layerOf(node, layer)
        .SetNormals(makeElement<fbxsdk::FbxLayerElementNormal>(node, mapping, reference, values, indices));
}

void setUVs(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
            const std::vector<FbxVector2>& values, const std::vector<int>& indices = {}, int layer = 0) {
    layerOf(node, layer)
        .SetUVs(makeElement<fbxsdk::FbxLayerElementUV>(node, mapping, reference, values, indices),
                Element::eTextureDiffuse);
}

void setColours(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                const std::vector<FbxColor>& values, const std::vector<int>& indices = {}, int layer = 0) {
    layerOf(node, layer)
        .SetVertexColors(makeElement<fbxsdk::FbxLayerElementVertexColor>(node, mapping, reference, values, indices));
}

void setMaterials(fbxsdk::FbxNode* node, Element::EMappingMode mapping, Element::EReferenceMode reference,
                  const std::vector<int>& indices = {}, int layer = 0) {
    layerOf(node, layer)
        .SetMaterials(makeElement<fbxsdk::FbxLayerElementMaterial>(
            node, mapping, reference, std::vector<fbxsdk::FbxSurfaceMaterial*>(), indices));
}

template <class Material>
void addLambert(TestScene& scene, fbxsdk::FbxNode* node, double red, double transparency) {
    auto* material = Material::Create(scene.scene, "material");
    material->Diffuse.Set({red, 0.5, 0.25});
    material->TransparencyFactor.Set(transparency);
    node->AddMaterial(material);
}

// No call damages an element. What an explicit instantiation names may be private: so its array can be taken away.
template <class Value>
using DirectArray = std::unique_ptr<fbxsdk::FbxLayerElementArrayTemplate<Value>>;
void removeDirectArray(fbxsdk::FbxLayerElementTemplate<FbxVector4>& element);
void removeDirectArray(fbxsdk::FbxLayerElementTemplate<FbxVector2>& element);
void removeDirectArray(fbxsdk::FbxLayerElementTemplate<FbxColor>& element);
template <class Value, DirectArray<Value> fbxsdk::FbxLayerElementTemplate<Value>::*kArray>
struct DirectArrayRemoval {
    friend void removeDirectArray(fbxsdk::FbxLayerElementTemplate<Value>& element) { (element.*kArray).reset(); }
};
template struct DirectArrayRemoval<FbxVector4, &fbxsdk::FbxLayerElementTemplate<FbxVector4>::mDirectArray>;
template struct DirectArrayRemoval<FbxVector2, &fbxsdk::FbxLayerElementTemplate<FbxVector2>::mDirectArray>;
template struct DirectArrayRemoval<FbxColor, &fbxsdk::FbxLayerElementTemplate<FbxColor>::mDirectArray>;

/// Reads a mesh that is damaged; what the reader throws.
std::string messageOfReading(TestScene& scene, fbxsdk::FbxNode* node, TnFbxMesh& mesh) {
    try {
        readInto(scene, node, mesh);
    } catch (const std::runtime_error& error) {
        return error.what();
    }
    return "";
}

constexpr const char* kMissingDirectArray = "FbxLayerElementArrayTemplate - mDirectArray is NULL";

const std::vector<FbxVector4> kSevenNormals = {{0.0, 0.0, 1.0}, {0.0, 0.0, 2.0}, {0.0, 0.0, 3.0}, {0.0, 0.0, 4.0},
                                               {0.0, 0.0, 5.0}, {0.0, 0.0, 6.0}, {0.0, 0.0, 7.0}};
const Floats kWhite = {1.0f, 1.0f, 1.0f, 1.0f};
const Floats kZero3 = {0.0f, 0.0f, 0.0f};
const Floats kZero2 = {0.0f, 0.0f};

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
    for (int i = 0; i < 7; ++i) {
        EXPECT_EQ(mesh.getPointIndex(i), corners[i]);
    }
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

/// Turned by its geometric rotation about X, then by its own about Z.
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

// ---- Normals ----

TEST(MeshNormals, ByPolygonVertexDirect) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByPolygonVertex, Element::eDirect, kSevenNormals);

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidNormals());
    for (int i = 0; i < 7; ++i) {
        EXPECT_EQ(normalOf(mesh, i), Floats({0.0f, 0.0f, static_cast<float>(i + 1)}));
    }
}

TEST(MeshNormals, ByPolygonVertexIndexed) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByPolygonVertex, Element::eIndexToDirect, kSevenNormals, {6, 5, 4, 3, 2, 1, 0});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_EQ(normalOf(mesh, 0), Floats({0.0f, 0.0f, 7.0f}));
    EXPECT_EQ(normalOf(mesh, 6), Floats({0.0f, 0.0f, 1.0f}));
}

TEST(MeshNormals, ByPolygonVertexWithAnIndexAloneAreReadThroughIt) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByPolygonVertex, Element::eIndex, kSevenNormals, {6, 5, 4, 3, 2, 1, 0});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidNormals());
    EXPECT_EQ(normalOf(mesh, 0), Floats({0.0f, 0.0f, 7.0f}));
    EXPECT_EQ(normalOf(mesh, 6), Floats({0.0f, 0.0f, 1.0f}));
}

TEST(MeshNormals, ByControlPointDirectAndIndexed) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByControlPoint, Element::eDirect, kSevenNormals);
    EXPECT_EQ(normalOf(readMesh(scene, node), 6), Floats({0.0f, 0.0f, 5.0f})); // point 4

    setNormals(node, Element::eByControlPoint, Element::eIndexToDirect, kSevenNormals, {0, 0, 0, 0, 6});
    const TnFbxMesh mesh = readMesh(scene, node);
    EXPECT_EQ(normalOf(mesh, 6), Floats({0.0f, 0.0f, 7.0f}));
    EXPECT_EQ(normalOf(mesh, 5), Floats({0.0f, 0.0f, 1.0f}));
}

TEST(MeshNormals, ByControlPointWithAnIndexAloneAreNone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByControlPoint, Element::eIndex, kSevenNormals, {0, 1, 2, 3, 4});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_EQ(normalOf(mesh, 0), kZero3);
}

TEST(MeshNormals, ByPolygonEdgeOrForAllAreNotRead) {
    for (const auto mapping : {Element::eByPolygon, Element::eAllSame, Element::eByEdge, Element::eNone}) {
        TestScene scene;
        fbxsdk::FbxNode* node = addTwoPolygons(scene);
        setNormals(node, mapping, Element::eDirect, kSevenNormals);

        const TnFbxMesh mesh = readMesh(scene, node, {/*transformPoints*/ true});

        EXPECT_FALSE(mesh.getValidNormals());
        EXPECT_EQ(normalOf(mesh, 3), kZero3);
    }
}

TEST(MeshNormals, BeyondTheirArraysAreZeroAndTheRestIsValid) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByControlPoint, Element::eIndexToDirect, kSevenNormals, {1, -1, 100});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidNormals());
    EXPECT_EQ(normalOf(mesh, 0), Floats({0.0f, 0.0f, 2.0f}));
    for (const int corner : {1, 2, 3}) {
        EXPECT_EQ(normalOf(mesh, corner), kZero3);
    }
}

TEST(MeshNormals, OfLaterLayersAreNotRead) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByPolygonVertex, Element::eDirect, kSevenNormals, {}, /*layer*/ 1);
    setUVs(node, Element::eByControlPoint, Element::eDirect, std::vector<FbxVector2>(5, FbxVector2(0.5, 0.5)), {}, 1);

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_FALSE(mesh.getValidUVs());
    EXPECT_EQ(uvOf(mesh, 0), kZero2);
}

TEST(MeshNormals, OfAnElementWithoutDirectArrayThrowAndLeaveTheMeshPartlyFilled) {
    for (const auto mapping : {Element::eByControlPoint, Element::eByPolygonVertex}) {
        TestScene scene;
        fbxsdk::FbxNode* node = addTwoPolygons(scene);
        setNormals(node, mapping, Element::eDirect, kSevenNormals);
        setUVs(node, Element::eByControlPoint, Element::eDirect, std::vector<FbxVector2>(5, FbxVector2(0.5, 0.5)));
        removeDirectArray(*layerOf(node).GetNormals());
        TnFbxMesh mesh;

        EXPECT_EQ(messageOfReading(scene, node, mesh), kMissingDirectArray);

        EXPECT_EQ(mesh.getName(), "mesh");
        EXPECT_EQ(mesh.getNumberOfPolygons(), 2);
        EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 7);
        EXPECT_EQ(pointOf(mesh, 4), Floats({0.0f, 2.0f, 0.0f}));
        EXPECT_EQ(normalOf(mesh, 6), kZero3);
        EXPECT_EQ(uvOf(mesh, 6), kZero2);
        EXPECT_FALSE(mesh.getValidNormals() || mesh.getValidUVs() || mesh.getValidColours());
    }
}

// ---- Texture coordinates ----

TEST(MeshUVs, ByPolygonVertexIndexedAndDirect) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setUVs(node, Element::eByPolygonVertex, Element::eIndexToDirect, {{0.0, 0.25}, {0.5, 0.75}}, {0, 1, 0, 1, 0, 1, 0});
    TnFbxMesh mesh = readMesh(scene, node);
    EXPECT_TRUE(mesh.getValidUVs());
    EXPECT_EQ(uvOf(mesh, 0), Floats({0.0f, 0.25f}));
    EXPECT_EQ(uvOf(mesh, 5), Floats({0.5f, 0.75f}));

    setUVs(node, Element::eByPolygonVertex, Element::eDirect,
           {{0.0, 0.0}, {0.0, 0.1}, {0.0, 0.2}, {0.0, 0.3}, {0.0, 0.4}, {0.0, 0.5}, {0.0, 0.6}});
    mesh = readMesh(scene, node);
    EXPECT_EQ(uvOf(mesh, 5), Floats({0.0f, 0.5f}));
}

TEST(MeshUVs, ByControlPoint) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setUVs(node, Element::eByControlPoint, Element::eDirect,
           {{0.0, 0.0}, {0.1, 0.0}, {0.2, 0.0}, {0.3, 0.0}, {0.4, 0.0}});

    EXPECT_EQ(uvOf(readMesh(scene, node), 6), Floats({0.4f, 0.0f}));
}

TEST(MeshUVs, WithOtherModesAreNone) {
    struct Row {
        Element::EMappingMode mapping;
        Element::EReferenceMode reference;
    };
    for (const Row& row :
         {Row{Element::eByPolygon, Element::eDirect}, Row{Element::eAllSame, Element::eDirect},
          Row{Element::eByPolygonVertex, Element::eIndex}, Row{Element::eByControlPoint, Element::eIndex}}) {
        TestScene scene;
        fbxsdk::FbxNode* node = addTwoPolygons(scene);
        setUVs(node, row.mapping, row.reference, std::vector<FbxVector2>(7, FbxVector2(0.5, 0.5)),
               {0, 1, 2, 3, 4, 5, 6});

        const TnFbxMesh mesh = readMesh(scene, node);

        EXPECT_FALSE(mesh.getValidUVs());
        EXPECT_EQ(uvOf(mesh, 0), kZero2);
    }
}

TEST(MeshUVs, OfCornersThatAreNotMappedAreZero) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setUVs(node, Element::eByPolygonVertex, Element::eIndexToDirect, {{0.5, 0.75}}, {0, -1, 7});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidUVs());
    EXPECT_EQ(uvOf(mesh, 0), Floats({0.5f, 0.75f}));
    EXPECT_EQ(uvOf(mesh, 1), kZero2);
    EXPECT_EQ(uvOf(mesh, 2), kZero2);
    EXPECT_EQ(uvOf(mesh, 6), kZero2);
}

TEST(MeshUVs, OfOtherTextureChannelsAreNotRead) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    layerOf(node).SetUVs(makeElement<fbxsdk::FbxLayerElementUV>(node, Element::eByControlPoint, Element::eDirect,
                                                                std::vector<FbxVector2>(5, FbxVector2(0.5, 0.5)), {}),
                         Element::eTextureBump);

    EXPECT_FALSE(readMesh(scene, node).getValidUVs());
}

TEST(MeshUVs, OfAnElementWithoutDirectArrayThrow) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByPolygonVertex, Element::eDirect, kSevenNormals);
    setUVs(node, Element::eByPolygonVertex, Element::eIndexToDirect, {{0.5, 0.5}}, {0, 0, 0, 0, 0, 0, 0});
    removeDirectArray(*layerOf(node).GetUVs());
    TnFbxMesh mesh;

    EXPECT_EQ(messageOfReading(scene, node, mesh), kMissingDirectArray);

    EXPECT_EQ(mesh.getPointIndex(6), 4);
    EXPECT_EQ(uvOf(mesh, 6), kZero2);
    EXPECT_FALSE(mesh.getValidNormals() || mesh.getValidUVs()) << "nothing is valid of a mesh that is read in part";
}

// ---- Colours ----

TEST(MeshColours, ByPolygonVertexAndByControlPoint) {
    const std::vector<FbxColor> values = {{0.0, 0.1, 0.2, 0.3}, {0.1, 0.1, 0.2, 0.3}, {0.2, 0.1, 0.2, 0.3},
                                          {0.3, 0.1, 0.2, 0.3}, {0.4, 0.1, 0.2, 0.3}, {0.5, 0.1, 0.2, 0.3},
                                          {0.6, 0.1, 0.2, 0.3}};
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);

    setColours(node, Element::eByPolygonVertex, Element::eDirect, values);
    TnFbxMesh mesh = readMesh(scene, node);
    EXPECT_TRUE(mesh.getValidColours());
    EXPECT_EQ(colourOf(mesh, 6), Floats({0.6f, 0.1f, 0.2f, 0.3f}));

    setColours(node, Element::eByControlPoint, Element::eDirect, values);
    EXPECT_EQ(colourOf(readMesh(scene, node), 6), Floats({0.4f, 0.1f, 0.2f, 0.3f}));

    setColours(node, Element::eByPolygonVertex, Element::eIndexToDirect, values, {6, 5, 4, 3, 2, 1, 0});
    EXPECT_EQ(colourOf(readMesh(scene, node), 6), Floats({0.0f, 0.1f, 0.2f, 0.3f}));
}

TEST(MeshColours, WithOtherModesAreNoneAndHideTheMaterials) {
    struct Row {
        Element::EMappingMode mapping;
        Element::EReferenceMode reference;
    };
    for (const Row& row : {Row{Element::eByPolygon, Element::eDirect}, Row{Element::eAllSame, Element::eDirect},
                           Row{Element::eByPolygonVertex, Element::eIndex}}) {
        TestScene scene;
        fbxsdk::FbxNode* node = addTwoPolygons(scene);
        addLambert<fbxsdk::FbxSurfaceLambert>(scene, node, 0.75, 0.0);
        setMaterials(node, Element::eByPolygon, Element::eIndexToDirect, {0, 0});
        setColours(node, row.mapping, row.reference, std::vector<FbxColor>(7, FbxColor(0.1, 0.1, 0.1, 0.1)),
                   {0, 1, 2, 3, 4, 5, 6});

        const TnFbxMesh mesh = readMesh(scene, node);

        EXPECT_FALSE(mesh.getValidColours());
        EXPECT_EQ(colourOf(mesh, 0), kWhite);
    }
}

TEST(MeshColours, OfTheLastLayerAreKept) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setColours(node, Element::eByControlPoint, Element::eDirect,
               std::vector<FbxColor>(5, FbxColor(0.1, 0.1, 0.1, 0.1)));
    setColours(node, Element::eByControlPoint, Element::eDirect, std::vector<FbxColor>(5, FbxColor(0.2, 0.2, 0.2, 0.2)),
               {}, /*layer*/ 1);

    EXPECT_EQ(colourOf(readMesh(scene, node), 0), Floats({0.2f, 0.2f, 0.2f, 0.2f}));
}

TEST(MeshColours, AreOverwrittenByALastLayerThatHasNone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setColours(node, Element::eByControlPoint, Element::eDirect,
               std::vector<FbxColor>(5, FbxColor(0.1, 0.1, 0.1, 0.1)));
    layerOf(node, 1);

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidColours());
    EXPECT_EQ(colourOf(mesh, 0), kWhite);
}

TEST(MeshColours, ComeFromTheMaterialsOfThePolygons) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    addLambert<fbxsdk::FbxSurfaceLambert>(scene, node, 0.75, 0.25);
    addLambert<fbxsdk::FbxSurfacePhong>(scene, node, 0.125, 1.0);
    setMaterials(node, Element::eByPolygon, Element::eIndexToDirect, {1, 0});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidColours());
    EXPECT_EQ(colourOf(mesh, 0), Floats({0.125f, 0.5f, 0.25f, 0.0f}));
    EXPECT_EQ(colourOf(mesh, 6), Floats({0.75f, 0.5f, 0.25f, 0.75f}));
}

TEST(MeshColours, ComeFromMaterialsByPolygonVertexPointAndNumber) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    for (int i = 0; i < 7; ++i) {
        addLambert<fbxsdk::FbxSurfaceLambert>(scene, node, 0.125 * i, 0.0);
    }
    setMaterials(node, Element::eByPolygonVertex, Element::eIndexToDirect, {0, 1, 2, 3, 4, 5, 6});
    EXPECT_EQ(colourOf(readMesh(scene, node), 6)[0], 0.75f);
    setMaterials(node, Element::eByControlPoint, Element::eIndexToDirect, {0, 1, 2, 3, 5});
    EXPECT_EQ(colourOf(readMesh(scene, node), 6)[0], 0.625f);
    setMaterials(node, Element::eByPolygon, Element::eDirect);
    EXPECT_EQ(colourOf(readMesh(scene, node), 6)[0], 0.125f); // the number of the polygon
    setMaterials(node, Element::eByPolygonVertex, Element::eDirect);
    EXPECT_EQ(colourOf(readMesh(scene, node), 6)[0], 0.75f); // the number of the corner
}

TEST(MeshColours, AreNotTakenFromOneMaterialForAllOrFromAnIndexAlone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    addLambert<fbxsdk::FbxSurfaceLambert>(scene, node, 0.75, 0.0);

    setMaterials(node, Element::eAllSame, Element::eIndexToDirect, {0});
    EXPECT_FALSE(readMesh(scene, node).getValidColours());
    setMaterials(node, Element::eByPolygon, Element::eIndex, {0, 0});
    EXPECT_FALSE(readMesh(scene, node).getValidColours());
}

TEST(MeshColours, OfMaterialsThatDoNotExistAreNone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    addLambert<fbxsdk::FbxSurfaceLambert>(scene, node, 0.75, 0.0);
    setMaterials(node, Element::eByPolygon, Element::eIndexToDirect, {-1, 1});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_FALSE(mesh.getValidColours());
    EXPECT_EQ(colourOf(mesh, 0), kWhite);
    EXPECT_EQ(colourOf(mesh, 6), kWhite);
}

TEST(MeshColours, OfAMaterialWithoutADiffuseColourAreTheDefaultAndValid) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    node->AddMaterial(fbxsdk::FbxSurfaceMaterial::Create(scene.scene, "shader"));
    setMaterials(node, Element::eByPolygon, Element::eIndexToDirect, {0, 0});

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidColours());
    EXPECT_EQ(colourOf(mesh, 0), kWhite);
}

TEST(MeshColours, OfAnInstanceComeFromTheFirstNode) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    addLambert<fbxsdk::FbxSurfaceLambert>(scene, node, 0.75, 0.0);
    fbxsdk::FbxNode* instance = scene.addNode("instance");
    instance->SetNodeAttribute(node->GetMesh());
    addLambert<fbxsdk::FbxSurfaceLambert>(scene, instance, 0.125, 0.0);
    setMaterials(node, Element::eByPolygon, Element::eIndexToDirect, {0, 0});

    EXPECT_EQ(colourOf(readMesh(scene, instance), 0)[0], 0.75f);
}

TEST(MeshColours, OfAnElementWithoutDirectArrayThrow) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setColours(node, Element::eByControlPoint, Element::eDirect, {{0.5, 0.5, 0.5, 0.5}});
    removeDirectArray(*layerOf(node).GetVertexColors());
    TnFbxMesh mesh;

    EXPECT_EQ(messageOfReading(scene, node, mesh), kMissingDirectArray);

    EXPECT_EQ(mesh.getPointIndex(6), 4);
    EXPECT_EQ(colourOf(mesh, 6), kWhite);
    EXPECT_FALSE(mesh.getValidColours());
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
