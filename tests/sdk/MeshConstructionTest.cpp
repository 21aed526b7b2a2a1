// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The factory of meshes: points, polygons, normals, texture coordinates and colours by polygon vertex.
#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxLayerElement;
using test::polygonMesh;
using test::WrittenScene;
using testing::ElementsAre;
using testing::IsEmpty;
using Corners = std::vector<std::vector<int>>;

/// The control point of every corner, polygon by polygon.
Corners cornersOf(const fbxsdk::FbxMesh& mesh) {
    Corners corners;
    for (int polygon = 0; polygon < mesh.GetPolygonCount(); ++polygon) {
        corners.emplace_back();
        for (int corner = 0; corner < mesh.GetPolygonSize(polygon); ++corner)
            corners.back().push_back(mesh.GetPolygonVertex(polygon, corner));
    }
    return corners;
}

/// A mesh whose polygon vertices refer to the points 0, 1, 2, … with polygons of these sizes.
std::unique_ptr<TnFbxMesh> meshOf(const std::vector<int>& sizes, int corners) {
    auto mesh = std::make_unique<TnFbxMesh>();
    EXPECT_TRUE(mesh->allocateGeometryData(static_cast<int>(sizes.size()), corners, corners));
    for (std::size_t i = 0; i < sizes.size(); ++i)
        mesh->setPolygonVertexSize(static_cast<int>(i), sizes[i]);
    for (int i = 0; i < corners; ++i)
        mesh->setPointIndex(i, i);
    return mesh;
}

/// A scene and one mesh made in it.
struct Constructed {
    explicit Constructed(const TnFbxMesh& mesh) : node(scene.sdk.createMesh(scene.manager, &mesh, "mesh")) {}
    fbxsdk::FbxMesh& mesh() const { return *node->GetMesh(); }
    fbxsdk::FbxLayer& layer() const { return *mesh().GetLayer(0); }

    WrittenScene scene;
    fbxsdk::FbxNode* node;
};

template <class Element>
void expectMode(const Element* element, FbxLayerElement::EReferenceMode mode, const char* name) {
    ASSERT_NE(element, nullptr);
    EXPECT_EQ(element->GetMappingMode(), FbxLayerElement::eByPolygonVertex);
    EXPECT_EQ(element->GetReferenceMode(), mode);
    EXPECT_STREQ(element->GetName(), name);
}

TEST(MeshConstruction, WidensThePointsOfTheFirstSet) {
    const auto source = test::movingMesh("mesh", 3);
    source->setControlPoint(1, 0.1f, -2.5f, 3.0f);

    const Constructed made(*source);

    ASSERT_EQ(made.mesh().GetControlPointsCount(), 3);
    const fbxsdk::FbxVector4 point = made.mesh().GetControlPointAt(1);
    EXPECT_EQ(point[0], static_cast<double>(0.1f));
    EXPECT_EQ(point[1], -2.5);
    EXPECT_EQ(point[2], 3.0);
    EXPECT_EQ(point[3], 1.0);
    EXPECT_EQ(made.mesh().GetControlPointAt(2)[2], 0.0) << "not the last set";
    EXPECT_THAT(cornersOf(made.mesh()), ElementsAre(ElementsAre(0, 1, 2)));
}

TEST(MeshConstruction, NamesMeshAndNodeAndShadesTextures) {
    const Constructed made(*polygonMesh("not this name"));

    EXPECT_STREQ(made.node->GetName(), "mesh");
    EXPECT_STREQ(made.mesh().GetName(), "mesh");
    EXPECT_EQ(made.node->GetShadingMode(), fbxsdk::FbxNode::eTextureShading);
    EXPECT_EQ(made.node->GetMaterialCount(), 0);
}

TEST(MeshConstruction, MakesALayerWithoutElementsWhenNothingIsValid) {
    const Constructed made(*polygonMesh("mesh"));

    EXPECT_EQ(made.mesh().GetLayerCount(), 1);
    EXPECT_EQ(made.layer().GetNormals(), nullptr);
    EXPECT_EQ(made.layer().GetUVs(), nullptr);
    EXPECT_EQ(made.layer().GetVertexColors(), nullptr);
}

TEST(MeshConstruction, WritesNormalsByPolygonVertexDirectly) {
    const auto source = polygonMesh("mesh");
    source->setValidNormals(true);
    source->setNormal(2, 0.25f, -1.0f, 0.5f);

    const Constructed made(*source);

    const auto* normals = made.layer().GetNormals();
    expectMode(normals, FbxLayerElement::eDirect, "");
    ASSERT_EQ(normals->GetDirectArray().GetCount(), 3);
    const fbxsdk::FbxVector4 normal = normals->GetDirectArray().GetAt(2);
    EXPECT_EQ(normal[0], 0.25);
    EXPECT_EQ(normal[1], -1.0);
    EXPECT_EQ(normal[2], 0.5);
    EXPECT_EQ(normal[3], 1.0);
}

TEST(MeshConstruction, WritesTextureCoordinatesByPolygonVertexWithIndicesThatCount) {
    const auto source = polygonMesh("mesh", 4);
    source->setValidUVs(true);
    source->setUV(1, 0.5f, 0.75f);
    source->setUV(3, 0.5f, 0.75f);

    const Constructed made(*source);

    const auto* uvs = made.layer().GetUVs();
    expectMode(uvs, FbxLayerElement::eIndexToDirect, "map1");
    ASSERT_EQ(uvs->GetDirectArray().GetCount(), 4) << "equal ones are not merged";
    EXPECT_EQ(uvs->GetDirectArray().GetAt(3)[0], 0.5);
    EXPECT_EQ(uvs->GetDirectArray().GetAt(3)[1], 0.75);
    ASSERT_EQ(uvs->GetIndexArray().GetCount(), 4);
    for (int i = 0; i < 4; ++i)
        EXPECT_EQ(uvs->GetIndexArray().GetAt(i), i);
}

TEST(MeshConstruction, WritesColoursByPolygonVertexWithIndicesThatCount) {
    const auto source = polygonMesh("mesh");
    source->setValidColours(true);
    source->setColour(1, 0.125f, 0.25f, 0.5f, 0.75f);

    const Constructed made(*source);

    const auto* colours = made.layer().GetVertexColors();
    expectMode(colours, FbxLayerElement::eIndexToDirect, "");
    ASSERT_EQ(colours->GetDirectArray().GetCount(), 3);
    const fbxsdk::FbxColor colour = colours->GetDirectArray().GetAt(1);
    EXPECT_EQ(colour.mRed, 0.125);
    EXPECT_EQ(colour.mGreen, 0.25);
    EXPECT_EQ(colour.mBlue, 0.5);
    EXPECT_EQ(colour.mAlpha, 0.75);
    ASSERT_EQ(colours->GetIndexArray().GetCount(), 3);
    EXPECT_EQ(colours->GetIndexArray().GetAt(2), 2);
}

TEST(MeshConstruction, WritesTheDefaultsOfWhatIsNotSet) {
    TnFbxMesh source;
    ASSERT_TRUE(source.allocateGeometryData(1, 3, 3));
    source.setPolygonVertexSize(0, 3);
    source.setValidNormals(true);
    source.setValidUVs(true);
    source.setValidColours(true);

    const Constructed made(source);

    float x = 0, y = 0, z = 0, u = 0, v = 0, red = 0, green = 0, blue = 0, alpha = 0;
    for (int i = 0; i < 3; ++i) {
        ASSERT_TRUE(source.getControlPoint(i, x, y, z));
        EXPECT_EQ(made.mesh().GetControlPointAt(i), fbxsdk::FbxVector4(x, y, z));
        ASSERT_TRUE(source.getNormal(i, x, y, z));
        EXPECT_EQ(made.layer().GetNormals()->GetDirectArray().GetAt(i), fbxsdk::FbxVector4(x, y, z));
        ASSERT_TRUE(source.getUV(i, u, v));
        EXPECT_EQ(made.layer().GetUVs()->GetDirectArray().GetAt(i), fbxsdk::FbxVector2(u, v));
        ASSERT_TRUE(source.getColour(i, red, green, blue, alpha));
        EXPECT_EQ(made.layer().GetVertexColors()->GetDirectArray().GetAt(i), fbxsdk::FbxColor(red, green, blue, alpha));
    }
    EXPECT_THAT(cornersOf(made.mesh()), ElementsAre(ElementsAre(0, 0, 0)));
}

TEST(MeshConstruction, SkipsPolygonsWithoutVerticesAndContinuesWithTheNextVertex) {
    const Constructed made(*meshOf({3, 0, 4, -2, 1}, 8));

    EXPECT_THAT(cornersOf(made.mesh()), ElementsAre(ElementsAre(0, 1, 2), ElementsAre(3, 4, 5, 6), ElementsAre(7)));
}

TEST(MeshConstruction, LeavesOutCornersThatNoPolygonClaims) {
    const Constructed made(*meshOf({3}, 5));

    EXPECT_THAT(cornersOf(made.mesh()), ElementsAre(ElementsAre(0, 1, 2)));
}

TEST(MeshConstruction, MayHavePolygonsWithoutASingleCorner) {
    const Constructed made(*meshOf({0, 0}, 3));

    ASSERT_NE(made.node, nullptr);
    EXPECT_THAT(cornersOf(made.mesh()), IsEmpty());
}

TEST(MeshConstruction, PutsAtPointZeroTheCornersThatThereAreNot) {
    const Constructed made(*meshOf({2, 3}, 3));

    EXPECT_THAT(cornersOf(made.mesh()), ElementsAre(ElementsAre(0, 1), ElementsAre(2, 0, 0)));
}

TEST(MeshConstruction, WritesPointIndicesWithoutACheck) {
    const auto source = polygonMesh("mesh");
    source->setPointIndex(0, 77);
    source->setPointIndex(1, -5);

    const Constructed made(*source);

    EXPECT_THAT(cornersOf(made.mesh()), ElementsAre(ElementsAre(77, -5, 2)));
}

TEST(MeshConstruction, RefusesPolygonsWithFarMoreCornersThanThereAre) {
    constexpr int kMost = std::numeric_limits<int>::max();
    EXPECT_EQ(Constructed(*meshOf({kMost}, 3)).node, nullptr);
    EXPECT_FALSE(lastError().empty());
    EXPECT_EQ(Constructed(*meshOf({kMost, kMost, kMost}, 3)).node, nullptr);
    EXPECT_EQ(Constructed(*meshOf({3 + 65537}, 3)).node, nullptr);
    EXPECT_NE(Constructed(*meshOf({3 + 65536}, 3)).node, nullptr);
}

TEST(MeshConstruction, NeedsAMeshWithGeometry) {
    WrittenScene scene;
    const TnFbxMesh empty;

    EXPECT_EQ(scene.sdk.createMesh(scene.manager, nullptr, "mesh"), nullptr);
    EXPECT_FALSE(lastError().empty());
    EXPECT_EQ(scene.sdk.createMesh(scene.manager, &empty, "mesh"), nullptr);

    TnFbxMesh onlyAPoint; // appending changes no count
    onlyAPoint.addControlPoint(1.0f, 2.0f, 3.0f);
    EXPECT_EQ(scene.sdk.createMesh(scene.manager, &onlyAPoint, "mesh"), nullptr);
}

} // namespace
} // namespace Tarnell::Fbx
