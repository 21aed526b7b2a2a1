// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes built by hosts.
#include "GeometryFixture.h"

#include <fbxsdk/FbxNode.h>

using namespace fbxsdk;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

using Polygon = std::vector<int>;

class FbxMeshTest : public GeometryFixture {
protected:
    /// A quad 0 1 2 3 and a triangle 3 2 4, with one layer.
    FbxMesh* quadAndTriangle() {
        FbxMesh* mesh = make<FbxMesh>();
        mesh->InitControlPoints(5);
        mesh->CreateLayer();
        addPolygon(*mesh, {0, 1, 2, 3});
        addPolygon(*mesh, {3, 2, 4});
        return mesh;
    }

    /// Normals 0, 1, 2, … along x in layer 0.
    static FbxLayerElementNormal* addNormals(FbxMesh& mesh, FbxLayerElement::EMappingMode mapping, int count) {
        auto* normals = FbxLayerElementNormal::Create(&mesh, "");
        normals->SetMappingMode(mapping);
        for (int i = 0; i < count; ++i)
            normals->GetDirectArray().Add(FbxVector4(i, 0, 0));
        mesh.GetLayer(0)->SetNormals(normals);
        return normals;
    }

    /// The x of a corner's normal; -1 when there is none.
    static double normalOf(const FbxMesh& mesh, int polygon, int corner) {
        FbxVector4 normal(-1, 0, 0);
        const bool found = mesh.GetPolygonVertexNormal(polygon, corner, normal);
        EXPECT_EQ(found, normal[0] >= 0);
        return normal[0];
    }
};

} // namespace

TEST_F(FbxMeshTest, IsEmptyAtFirst) {
    const FbxMesh* mesh = make<FbxMesh>("empty");

    EXPECT_EQ(mesh->GetAttributeType(), FbxNodeAttribute::eMesh);
    EXPECT_EQ(mesh->GetControlPointsCount(), 0);
    EXPECT_EQ(mesh->GetControlPoints(), nullptr);
    EXPECT_EQ(mesh->GetPolygonCount(), 0);
    EXPECT_EQ(mesh->GetPolygonVertexCount(), 0);
    EXPECT_EQ(mesh->GetPolygonVertices(), nullptr);
    EXPECT_TRUE(mesh->IsTriangleMesh());
}

TEST_F(FbxMeshTest, HasTheDefaultsOfItsClass) {
    const FbxMesh* mesh = make<FbxMesh>();

    EXPECT_EQ(mesh->Color.Get(), FbxDouble3(0.8, 0.8, 0.8));
    EXPECT_TRUE(mesh->PrimaryVisibility.Get());
    EXPECT_TRUE(mesh->CastShadow.Get());
    EXPECT_TRUE(mesh->ReceiveShadow.Get());
}

TEST_F(FbxMeshTest, CreatesExactlyTheRequestedPointsAtTheOrigin) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->InitControlPoints(3);
    mesh->SetControlPointAt(FbxVector4(1, 2, 3), 0);

    mesh->InitControlPoints(2);

    EXPECT_THAT(pointsOf(*mesh), ElementsAre(FbxVector4(0, 0, 0, 1), FbxVector4(0, 0, 0, 1)));
}

TEST_F(FbxMeshTest, MakesNoPointsForANegativeCount) {
    FbxMesh* mesh = make<FbxMesh>();

    mesh->InitControlPoints(-1);

    EXPECT_EQ(mesh->GetControlPointsCount(), 0);
}

TEST_F(FbxMeshTest, KeepsPointsWithTheirW) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->InitControlPoints(2);

    mesh->SetControlPointAt(FbxVector4(1, 2, 3, 4), 1);

    EXPECT_EQ(mesh->GetControlPointAt(1), FbxVector4(1, 2, 3, 4));
    EXPECT_EQ(mesh->GetControlPoints()[1], FbxVector4(1, 2, 3, 4));
}

TEST_F(FbxMeshTest, IgnoresPointsOutOfRange) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->InitControlPoints(1);

    mesh->SetControlPointAt(FbxVector4(1, 2, 3), 1);
    mesh->SetControlPointAt(FbxVector4(1, 2, 3), -1);

    EXPECT_THAT(pointsOf(*mesh), ElementsAre(FbxVector4(0, 0, 0, 1)));
    EXPECT_EQ(mesh->GetControlPointAt(1), FbxVector4(0, 0, 0, 1));
    EXPECT_EQ(mesh->GetControlPointAt(-1), FbxVector4(0, 0, 0, 1));
}

TEST_F(FbxMeshTest, SaysWhetherThereArePoints) {
    FbxMesh* mesh = make<FbxMesh>();
    FbxStatus status;

    EXPECT_EQ(mesh->GetControlPoints(&status), nullptr);
    EXPECT_TRUE(status.Error());

    mesh->InitControlPoints(1);
    EXPECT_NE(mesh->GetControlPoints(&status), nullptr);
    EXPECT_FALSE(status.Error());
}

TEST_F(FbxMeshTest, KeepsPolygonsOneAfterTheOther) {
    const FbxMesh* mesh = quadAndTriangle();

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0, 1, 2, 3}, Polygon{3, 2, 4}));
    EXPECT_EQ(mesh->GetPolygonVertexIndex(0), 0);
    EXPECT_EQ(mesh->GetPolygonVertexIndex(1), 4);
    EXPECT_EQ(mesh->GetPolygonVertexCount(), 7);
    EXPECT_EQ(mesh->GetPolygonVertices()[4], 3);
}

TEST_F(FbxMeshTest, ReturnsNothingOutOfRange) {
    FbxMesh* mesh = quadAndTriangle();

    for (const int polygon : {-1, 2, 1000000}) {
        EXPECT_EQ(mesh->GetPolygonSize(polygon), 0);
        EXPECT_EQ(mesh->GetPolygonVertexIndex(polygon), -1);
        EXPECT_EQ(mesh->GetPolygonVertex(polygon, 0), -1);
        EXPECT_EQ(mesh->GetTextureUVIndex(polygon, 0), -1);
        EXPECT_EQ(mesh->RemovePolygon(polygon), -1);
    }
    EXPECT_EQ(mesh->GetPolygonVertex(1, 3), -1);
    EXPECT_EQ(mesh->GetPolygonVertex(1, -1), -1);
    EXPECT_EQ(mesh->GetPolygonCount(), 2);
}

TEST_F(FbxMeshTest, MakesNoLayerForPolygonsWithoutMaterial) {
    FbxMesh* mesh = make<FbxMesh>();

    addPolygon(*mesh, {0, 1, 2});

    EXPECT_EQ(mesh->GetLayerCount(), 0);
}

TEST_F(FbxMeshTest, DoesNotCheckWhetherPointsExist) {
    FbxMesh* mesh = make<FbxMesh>();

    addPolygon(*mesh, {7, -3, 2147483647});

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{7, -3, 2147483647}));
}

TEST_F(FbxMeshTest, KeepsPolygonsOfFewerThanThreeCorners) {
    FbxMesh* mesh = make<FbxMesh>();

    addPolygon(*mesh, {});
    addPolygon(*mesh, {1});
    addPolygon(*mesh, {1, 2});

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{}, Polygon{1}, Polygon{1, 2}));
}

TEST_F(FbxMeshTest, TakesNoCornerOutsideAPolygon) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->AddPolygon(1);
    addPolygon(*mesh, {0, 1, 2});

    mesh->AddPolygon(3);

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0, 1, 2}));
}

TEST_F(FbxMeshTest, SaysWhetherAllPolygonsAreTriangles) {
    FbxMesh* mesh = make<FbxMesh>();
    addPolygon(*mesh, {0, 1, 2});
    EXPECT_TRUE(mesh->IsTriangleMesh());

    addPolygon(*mesh, {0, 1, 2, 3});
    EXPECT_FALSE(mesh->IsTriangleMesh());
}

TEST_F(FbxMeshTest, StoresMaterialAndGroupOfPolygonsWhereLayer0MapsThemByPolygon) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    auto* materials = FbxLayerElementMaterial::Create(mesh, "");
    materials->SetMappingMode(FbxLayerElement::eByPolygon);
    mesh->GetLayer(0)->SetMaterials(materials);
    auto* groups = FbxLayerElementPolygonGroup::Create(mesh, "");
    groups->SetMappingMode(FbxLayerElement::eAllSame);
    mesh->GetLayer(0)->SetPolygonGroups(groups);

    mesh->BeginPolygon();
    mesh->BeginPolygon(3, -1, 5);

    EXPECT_THAT(itemsOf(materials->GetIndexArray()), ElementsAre(0, 3));
    EXPECT_THAT(itemsOf(groups->GetIndexArray()), IsEmpty());
}

TEST_F(FbxMeshTest, StoresTheTextureCoordinateOfACornerWhereTheyAreIndexed) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    auto* uvs = FbxLayerElementUV::Create(mesh, "");
    uvs->SetMappingMode(FbxLayerElement::eByPolygonVertex);
    uvs->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    mesh->GetLayer(0)->SetUVs(uvs);

    mesh->BeginPolygon();
    mesh->AddPolygon(0, 4);
    mesh->AddPolygon(1);
    mesh->AddPolygon(2, 6);
    mesh->EndPolygon();

    EXPECT_THAT(itemsOf(uvs->GetIndexArray()), ElementsAre(4, 0, 6));
}

TEST_F(FbxMeshTest, StoresNoTextureCoordinateWhereTheyAreDirect) {
    FbxMesh* mesh = make<FbxMesh>();
    mesh->CreateLayer();
    auto* uvs = FbxLayerElementUV::Create(mesh, "");
    uvs->SetMappingMode(FbxLayerElement::eByPolygonVertex);
    mesh->GetLayer(0)->SetUVs(uvs);

    mesh->BeginPolygon();
    mesh->AddPolygon(0, 4);

    EXPECT_THAT(itemsOf(uvs->GetIndexArray()), IsEmpty());
}

TEST_F(FbxMeshTest, GivesNormalsByCorner) {
    FbxMesh* mesh = quadAndTriangle();
    addNormals(*mesh, FbxLayerElement::eByPolygonVertex, 7);

    EXPECT_EQ(normalOf(*mesh, 0, 3), 3);
    EXPECT_EQ(normalOf(*mesh, 1, 0), 4);
    EXPECT_EQ(normalOf(*mesh, 1, 3), -1);
    EXPECT_EQ(normalOf(*mesh, 2, 0), -1);
}

TEST_F(FbxMeshTest, GivesIndexedNormalsByCorner) {
    FbxMesh* mesh = quadAndTriangle();
    auto* normals = addNormals(*mesh, FbxLayerElement::eByPolygonVertex, 3);
    normals->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    for (const int index : {2, 1, 0, -1, 3, 2})
        normals->GetIndexArray().Add(index);

    EXPECT_EQ(normalOf(*mesh, 0, 0), 2);
    EXPECT_EQ(normalOf(*mesh, 0, 3), -1) << "a negative index";
    EXPECT_EQ(normalOf(*mesh, 1, 0), -1) << "an index beyond the normals";
    EXPECT_EQ(normalOf(*mesh, 1, 1), 2);
    EXPECT_EQ(normalOf(*mesh, 1, 2), -1) << "a corner beyond the indices";
}

TEST_F(FbxMeshTest, GivesNormalsByPoint) {
    FbxMesh* mesh = quadAndTriangle();
    auto* normals = addNormals(*mesh, FbxLayerElement::eByControlPoint, 4);

    EXPECT_EQ(normalOf(*mesh, 1, 0), 3);
    EXPECT_EQ(normalOf(*mesh, 1, 2), -1) << "point 4 has none";

    normals->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    for (const int index : {0, 0, 1, 2})
        normals->GetIndexArray().Add(index);
    EXPECT_EQ(normalOf(*mesh, 1, 0), 2);
}

TEST_F(FbxMeshTest, GivesNoNormalsForOtherMappings) {
    FbxMesh* mesh = quadAndTriangle();
    EXPECT_EQ(normalOf(*mesh, 0, 0), -1) << "without normals";

    for (const auto mapping :
         {FbxLayerElement::eNone, FbxLayerElement::eByPolygon, FbxLayerElement::eByEdge, FbxLayerElement::eAllSame}) {
        addNormals(*mesh, mapping, 7);
        EXPECT_EQ(normalOf(*mesh, 0, 0), -1) << mapping;
    }
}

TEST_F(FbxMeshTest, GivesThePlaceOfTextureCoordinates) {
    FbxMesh* mesh = quadAndTriangle();
    EXPECT_EQ(mesh->GetTextureUVIndex(1, 1), -1) << "without coordinates";
    auto* uvs = FbxLayerElementUV::Create(mesh, "");
    mesh->GetLayer(0)->SetUVs(uvs);
    EXPECT_EQ(mesh->GetTextureUVIndex(1, 1), -1) << "without mapping";

    uvs->SetMappingMode(FbxLayerElement::eByPolygonVertex);
    EXPECT_EQ(mesh->GetTextureUVIndex(1, 1), 5);
    EXPECT_EQ(mesh->GetTextureUVIndex(1, 1, FbxLayerElement::eTextureBump), -1);

    uvs->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    for (const int index : {10, 11, 12, 13, 14, 15})
        uvs->GetIndexArray().Add(index);
    EXPECT_EQ(mesh->GetTextureUVIndex(1, 1), 15);
    EXPECT_EQ(mesh->GetTextureUVIndex(1, 2), -1) << "beyond the indices";

    uvs->SetMappingMode(FbxLayerElement::eByControlPoint);
    EXPECT_EQ(mesh->GetTextureUVIndex(1, 1), -1);
}

TEST_F(FbxMeshTest, RemovesAPolygonWithWhatBelongsToIt) {
    FbxMesh* mesh = quadAndTriangle();
    addPolygon(*mesh, {0, 1, 4});
    auto* normals = addNormals(*mesh, FbxLayerElement::eByPolygonVertex, 10);
    auto* materials = FbxLayerElementMaterial::Create(mesh, "");
    materials->SetMappingMode(FbxLayerElement::eByPolygon);
    materials->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    for (const int index : {7, 8, 9})
        materials->GetIndexArray().Add(index);
    mesh->GetLayer(0)->SetMaterials(materials);
    mesh->CreateLayer();
    mesh->GetLayer(1)->SetMaterials(materials);

    EXPECT_EQ(mesh->RemovePolygon(1), 1);

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0, 1, 2, 3}, Polygon{0, 1, 4}));
    EXPECT_EQ(normals->GetDirectArray().GetCount(), 7);
    EXPECT_EQ(normalOf(*mesh, 1, 0), 7);
    EXPECT_THAT(itemsOf(materials->GetIndexArray()), ElementsAre(7, 9)) << "cut once, although it is in two layers";
}

TEST_F(FbxMeshTest, IsTheAttributeOfSeveralNodes) {
    FbxMesh* mesh = make<FbxMesh>();
    FbxNode* node = make<FbxNode>();
    FbxNode* instance = make<FbxNode>();

    node->SetNodeAttribute(mesh);
    instance->SetNodeAttribute(mesh);

    EXPECT_EQ(mesh->GetNodeCount(), 2);
    EXPECT_EQ(node->GetMesh(), mesh);
    EXPECT_EQ(instance->GetMesh(), mesh);
}
