// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The values of a mesh's layers at polygon corners: normals, texture coordinates, colours and materials.
#include "MeshScenes.h"

#include <memory>
#include <stdexcept>
#include <string>

namespace Tarnell::Fbx {
namespace {

using namespace test;

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

// No call damages an element. An explicit instantiation may name private members: so its array can be removed.
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

/// Reads a damaged mesh; returns what the reader throws.
std::string messageOfReading(TestScene& scene, fbxsdk::FbxNode* node, TnFbxMesh& mesh) {
    try {
        readInto(scene, node, mesh);
    } catch (const std::runtime_error& error) {
        return error.what();
    }
    return "";
}

constexpr const char* kMissingDirectArray = "FbxLayerElementArrayTemplate - mDirectArray is NULL";

// ---- Normals ----

TEST(MeshNormals, ByPolygonVertexDirect) {
    TestScene scene;
    fbxsdk::FbxNode* node = addTwoPolygons(scene);
    setNormals(node, Element::eByPolygonVertex, Element::eDirect, kSevenNormals);

    const TnFbxMesh mesh = readMesh(scene, node);

    EXPECT_TRUE(mesh.getValidNormals());
    for (int i = 0; i < 7; ++i)
        EXPECT_EQ(normalOf(mesh, i), Floats({0.0f, 0.0f, static_cast<float>(i + 1)}));
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
    for (const int corner : {1, 2, 3})
        EXPECT_EQ(normalOf(mesh, corner), kZero3);
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
    for (int i = 0; i < 7; ++i)
        addLambert<fbxsdk::FbxSurfaceLambert>(scene, node, 0.125 * i, 0.0);
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

} // namespace
} // namespace Tarnell::Fbx
