// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Points and polygons from the records of files, valid and invalid.
#include "GeometryFixture.h"

#include <cmath>
#include <string>

using namespace fbxsdk;
using testing::ElementsAre;
using testing::IsEmpty;

namespace {

using Polygon = std::vector<int>;

class MeshReading : public GeometryFixture {};

const std::string kFourPoints = "Vertices: *12 { a: 0,0,0, 1,0,0, 1,1,0, 0,1,0 }\n";

} // namespace

TEST_F(MeshReading, ReadsPointsWithAWOfOne) {
    const FbxMesh* mesh = read<FbxMesh>("Vertices: *6 { a: 1,2,3,4.5,-5,6e3 }");

    EXPECT_THAT(pointsOf(*mesh), ElementsAre(FbxVector4(1, 2, 3, 1), FbxVector4(4.5, -5, 6000, 1)));
}

TEST_F(MeshReading, ReadsListsOfOldFiles) {
    const FbxMesh* mesh = read<FbxMesh>("Vertices: 0,0,0,1,0,0,0,1,0\nPolygonVertexIndex: 0,1,-3");

    EXPECT_THAT(pointsOf(*mesh), ElementsAre(FbxVector4(0, 0, 0), FbxVector4(1, 0, 0), FbxVector4(0, 1, 0)));
    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0, 1, 2}));
}

TEST_F(MeshReading, SpreadsManyPointsInPlace) {
    std::string records = "Vertices: *3000 { a: 0";
    for (int i = 1; i < 3000; ++i)
        records += "," + std::to_string(i);
    const FbxMesh* mesh = read<FbxMesh>(records + " }");

    ASSERT_EQ(mesh->GetControlPointsCount(), 1000);
    for (int i = 0; i < 1000; ++i)
        ASSERT_EQ(mesh->GetControlPoints()[i], FbxVector4(3.0 * i, 3.0 * i + 1, 3.0 * i + 2, 1)) << i;
}

TEST_F(MeshReading, EndsPolygonsAtInvertedIndices) {
    const FbxMesh* mesh = read<FbxMesh>(kFourPoints + "PolygonVertexIndex: *7 { a: 0,1,2,-4,2,1,-1 }");

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0, 1, 2, 3}, Polygon{2, 1, 0}));
    EXPECT_EQ(mesh->GetPolygonVertexCount(), 7);
}

TEST_F(MeshReading, EndsTheLastPolygonWithTheList) {
    const FbxMesh* mesh = read<FbxMesh>(kFourPoints + "PolygonVertexIndex: *5 { a: 0,1,-3,2,3 }");

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0, 1, 2}, Polygon{2, 3}));
}

TEST_F(MeshReading, KeepsPolygonsOfOneAndTwoCorners) {
    const FbxMesh* mesh = read<FbxMesh>(kFourPoints + "PolygonVertexIndex: *6 { a: -1,1,-1,0,1,-3 }");

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0}, Polygon{1, 0}, Polygon{0, 1, 2}));
}

TEST_F(MeshReading, LeadsCornersAtMissingPointsToPointZero) {
    const FbxMesh* mesh = read<FbxMesh>(kFourPoints + "PolygonVertexIndex: *6 { a: 1,4,-3,1,2147483647,-2147483648 }");

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{1, 0, 2}, Polygon{1, 0, 0}));
}

TEST_F(MeshReading, HasNoPolygonsWithoutPoints) {
    const FbxMesh* mesh = read<FbxMesh>("PolygonVertexIndex: *3 { a: 0,1,-3 }");

    EXPECT_EQ(mesh->GetPolygonCount(), 0);
    EXPECT_EQ(mesh->GetPolygonVertexCount(), 0);
}

TEST_F(MeshReading, DropsNumbersThatMakeNoWholePoint) {
    EXPECT_EQ(read<FbxMesh>("Vertices: *5 { a: 1,2,3,4,5 }")->GetControlPointsCount(), 1);
    EXPECT_EQ(read<FbxMesh>("Vertices: *2 { a: 1,2 }")->GetControlPointsCount(), 0);
}

TEST_F(MeshReading, MakesAnEmptyMeshOfNoRecords) {
    const FbxMesh* mesh = read<FbxMesh>("");

    EXPECT_EQ(mesh->GetControlPointsCount(), 0);
    EXPECT_EQ(mesh->GetPolygonCount(), 0);
    EXPECT_EQ(mesh->GetLayerCount(), 0);
}

TEST_F(MeshReading, MakesAnEmptyMeshOfRecordsWithoutNumbers) {
    const FbxMesh* mesh = read<FbxMesh>("Vertices: \"many\"\nPolygonVertexIndex: { Deep: 1 }\nLayer: \"x\" { }");

    EXPECT_EQ(mesh->GetControlPointsCount(), 0);
    EXPECT_EQ(mesh->GetPolygonCount(), 0);
}

TEST_F(MeshReading, KeepsCoordinatesThatAreNoNumbers) {
    const FbxMesh* mesh = read<FbxMesh>("Vertices: *3 { a: nan,1,inf }");

    ASSERT_EQ(mesh->GetControlPointsCount(), 1);
    EXPECT_TRUE(std::isnan(mesh->GetControlPoints()[0][0]));
    EXPECT_EQ(mesh->GetControlPoints()[0][1], 1);
    EXPECT_TRUE(std::isinf(mesh->GetControlPoints()[0][2]));
}

TEST_F(MeshReading, HasNoPointsWhereTheirListIsCorrupt) {
    const auto document = std::make_shared<fbxsdk::detail::Document>();
    document->tree = std::make_unique<fbxsdk::detail::RecordTree>();
    fbxsdk::detail::StoredArray& array = document->tree->newArray();
    array.compressed = true;
    array.count = 300;
    array.bytes = std::span("this is no zlib stream", 22);
    fbxsdk::detail::Record& vertices = document->tree->newRecord("Vertices");
    vertices.values = document->tree->newValues(1);
    document->tree->root.firstChild = &vertices;
    const auto values = document->tree->newValues(1);
    values[0] = fbxsdk::detail::Value::ofArray(array);
    vertices.values = values;
    document->objects.emplace_back().body = &document->tree->root;
    FbxMesh* mesh = make<FbxMesh>();

    fbxsdk::detail::attachSource(*mesh, document, document->objects.front());

    EXPECT_EQ(mesh->GetControlPointsCount(), 0);
    EXPECT_EQ(mesh->GetControlPoints(), nullptr);
}

TEST_F(MeshReading, WaitsForTheFirstAccess) {
    FbxMesh* mesh = read<FbxMesh>(kFourPoints);

    (void)mesh->GetName();
    (void)mesh->GetAttributeType();
    (void)mesh->GetDeformerCount();
    EXPECT_TRUE(mesh->isPending());

    EXPECT_EQ(mesh->GetControlPointsCount(), 4);
    EXPECT_FALSE(mesh->isPending());
}

TEST_F(MeshReading, IsSetOffByEveryKindOfAccess) {
    const std::string records = kFourPoints + "PolygonVertexIndex: *3 { a: 0,1,-3 }\n"
                                              "LayerElementNormal: 0 { MappingInformationType: \"AllSame\"\n"
                                              "ReferenceInformationType: \"Direct\"\n Normals: *3 { a: 0,0,1 } }\n";
    FbxVector4 normal;

    EXPECT_NE(read<FbxMesh>(records)->GetControlPoints(), nullptr);
    EXPECT_EQ(read<FbxMesh>(records)->GetControlPointAt(1), FbxVector4(1, 0, 0));
    EXPECT_EQ(read<FbxMesh>(records)->GetPolygonCount(), 1);
    EXPECT_EQ(read<FbxMesh>(records)->GetPolygonSize(0), 3);
    EXPECT_EQ(read<FbxMesh>(records)->GetPolygonVertexCount(), 3);
    EXPECT_EQ(read<FbxMesh>(records)->GetPolygonVertexIndex(0), 0);
    EXPECT_EQ(read<FbxMesh>(records)->GetPolygonVertex(0, 2), 2);
    EXPECT_NE(read<FbxMesh>(records)->GetPolygonVertices(), nullptr);
    EXPECT_FALSE(read<FbxMesh>(records)->GetPolygonVertexNormal(0, 0, normal));
    EXPECT_TRUE(read<FbxMesh>(records)->IsTriangleMesh());
    EXPECT_EQ(read<FbxMesh>(records)->GetLayerCount(), 1);
    EXPECT_EQ(read<FbxMesh>(records)->GetLayerCount(FbxLayerElement::eNormal), 1);
    EXPECT_NE(read<FbxMesh>(records)->GetLayer(0), nullptr);
    EXPECT_EQ(read<FbxMesh>(records)->RemovePolygon(0), 0);
}

TEST_F(MeshReading, ComesBeforeChangesByTheHost) {
    FbxMesh* mesh = read<FbxMesh>(kFourPoints + "PolygonVertexIndex: *3 { a: 0,1,-3 }\n");

    addPolygon(*mesh, {0, 2, 3});
    mesh->SetControlPointAt(FbxVector4(9, 9, 9), 3);

    EXPECT_THAT(polygonsOf(*mesh), ElementsAre(Polygon{0, 1, 2}, Polygon{0, 2, 3}));
    EXPECT_EQ(mesh->GetControlPointAt(2), FbxVector4(1, 1, 0));
    EXPECT_EQ(mesh->GetControlPointAt(3), FbxVector4(9, 9, 9));
}

TEST_F(MeshReading, ReadsEdgesWhenTheyAreAccessed) {
    FbxMesh* mesh = read<FbxMesh>(kFourPoints + "PolygonVertexIndex: *3 { a: 0,1,-3 }\nEdges: *3 { a: 0,1,2 }\n");

    EXPECT_THAT(std::vector<int>(mesh->edges().begin(), mesh->edges().end()), ElementsAre(0, 1, 2));
}

TEST_F(MeshReading, HasNoEdgesAnyMoreWhenPolygonsChange) {
    const std::string records = kFourPoints + "PolygonVertexIndex: *3 { a: 0,1,-3 }\nEdges: *3 { a: 0,1,2 }\n";
    FbxMesh* grown = read<FbxMesh>(records);
    FbxMesh* cut = read<FbxMesh>(records);
    EXPECT_EQ(cut->edges().count(), 3);

    addPolygon(*grown, {0, 2, 3});
    cut->RemovePolygon(0);

    EXPECT_EQ(grown->edges().count(), 0);
    EXPECT_EQ(cut->edges().count(), 0);
}

TEST_F(MeshReading, KeepsTheFileAsLongAsItIsNeeded) {
    FbxMesh* mesh = make<FbxMesh>();
    std::weak_ptr<const fbxsdk::detail::Document> watched;
    {
        const auto document = documentOf(kFourPoints);
        watched = document;
        fbxsdk::detail::attachSource(*mesh, document, document->objects.front());
    }
    EXPECT_FALSE(watched.expired());

    EXPECT_EQ(mesh->GetControlPointsCount(), 4);
    EXPECT_TRUE(watched.expired());
}

TEST_F(MeshReading, IsNoTroubleForAnObjectThatIsDestroyedBefore) {
    FbxMesh* mesh = read<FbxMesh>(kFourPoints);

    mesh->Destroy();

    EXPECT_THAT(manager, testing::NotNull());
}
