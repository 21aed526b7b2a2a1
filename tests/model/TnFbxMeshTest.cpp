// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The mesh's arrays: how they are sized, grown, read and copied.
#include "TnFbxMesh.h"

#include "TransformOwner.h"

#include <array>
#include <type_traits>

namespace Tarnell::Fbx {
namespace {

using test::expectMarkedTransform;
using test::kHighest;
using test::kLowest;
using test::markTransform;

static_assert(std::is_base_of_v<TnFbxTransform, TnFbxMesh>);

static_assert(TnFbxMesh::kDefaultMeshPX == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshPY == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshPZ == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshNX == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshNY == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshNZ == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshU == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshV == 0.0f);
static_assert(TnFbxMesh::kDefaultMeshRed == 1.0f);
static_assert(TnFbxMesh::kDefaultMeshGreen == 1.0f);
static_assert(TnFbxMesh::kDefaultMeshBlue == 1.0f);
static_assert(TnFbxMesh::kDefaultMeshAlpha == 1.0f);

using Values = std::array<float, 4>;
constexpr float kUntouched = -77.0f;
constexpr Values kRejected = {kUntouched, kUntouched, kUntouched, kUntouched};

// What a getter stores, with the components it does not have, and all of them after a rejection, untouched.

Values controlPoint(const TnFbxMesh& mesh, int index) {
    Values v = kRejected;
    const bool found = mesh.getControlPoint(index, v[0], v[1], v[2]);
    EXPECT_EQ(found, v != kRejected);
    return v;
}

Values normal(const TnFbxMesh& mesh, int polygonVertex) {
    Values v = kRejected;
    const bool found = mesh.getNormal(polygonVertex, v[0], v[1], v[2]);
    EXPECT_EQ(found, v != kRejected);
    return v;
}

Values uv(const TnFbxMesh& mesh, int polygonVertex) {
    Values v = kRejected;
    const bool found = mesh.getUV(polygonVertex, v[0], v[1]);
    EXPECT_EQ(found, v != kRejected);
    return v;
}

Values colour(const TnFbxMesh& mesh, int polygonVertex) {
    Values v = kRejected;
    const bool found = mesh.getColour(polygonVertex, v[0], v[1], v[2], v[3]);
    EXPECT_EQ(found, v != kRejected);
    return v;
}

Values three(float x, float y, float z) { return {x, y, z, kUntouched}; }
Values two(float u, float v) { return {u, v, kUntouched, kUntouched}; }

/// Two triangles over four points.
TnFbxMesh twoTriangles() {
    TnFbxMesh mesh;
    mesh.allocateGeometryData(2, 4, 6);
    return mesh;
}

/// Two triangles with every element different.
TnFbxMesh filledMesh() {
    TnFbxMesh mesh = twoTriangles();
    for (int polygon = 0; polygon < 2; ++polygon)
        EXPECT_TRUE(mesh.setPolygonVertexSize(polygon, 3 + polygon));
    for (int i = 0; i < 4; ++i) {
        const float f = static_cast<float>(i);
        EXPECT_TRUE(mesh.setControlPoint(i, f, f + 0.25f, f + 0.5f));
    }
    for (int i = 0; i < 6; ++i) {
        const float f = static_cast<float>(i);
        EXPECT_TRUE(mesh.setPointIndex(i, 10 - i));
        EXPECT_TRUE(mesh.setNormal(i, f, -f, 1.0f));
        EXPECT_TRUE(mesh.setUV(i, f + 0.125f, 2.0f * f));
        EXPECT_TRUE(mesh.setColour(i, f, f + 1.0f, f + 2.0f, f + 3.0f));
    }
    EXPECT_TRUE(mesh.setValidNormals(true));
    EXPECT_TRUE(mesh.setValidUVs(true));
    EXPECT_TRUE(mesh.setValidColours(true));
    return mesh;
}

void expectFilled(const TnFbxMesh& mesh) {
    EXPECT_EQ(mesh.getNumberOfPolygons(), 2);
    EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 6);
    EXPECT_EQ(mesh.getNumberOfControlPoints(), 4);
    EXPECT_EQ(mesh.getPolygonVertexSize(0), 3);
    EXPECT_EQ(mesh.getPolygonVertexSize(1), 4);
    for (int i = 0; i < 4; ++i) {
        const float f = static_cast<float>(i);
        EXPECT_EQ(controlPoint(mesh, i), three(f, f + 0.25f, f + 0.5f));
    }
    for (int i = 0; i < 6; ++i) {
        const float f = static_cast<float>(i);
        EXPECT_EQ(mesh.getPointIndex(i), 10 - i);
        EXPECT_EQ(normal(mesh, i), three(f, -f, 1.0f));
        EXPECT_EQ(uv(mesh, i), two(f + 0.125f, 2.0f * f));
        EXPECT_EQ(colour(mesh, i), (Values{f, f + 1.0f, f + 2.0f, f + 3.0f}));
    }
    EXPECT_TRUE(mesh.getValidNormals());
    EXPECT_TRUE(mesh.getValidUVs());
    EXPECT_TRUE(mesh.getValidColours());
}

void expectEmpty(const TnFbxMesh& mesh) {
    EXPECT_EQ(mesh.getNumberOfPolygons(), 0);
    EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 0);
    EXPECT_EQ(mesh.getNumberOfControlPoints(), 0);
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 0);
    EXPECT_EQ(mesh.getPolygonVertexSize(0), -1);
    EXPECT_EQ(controlPoint(mesh, 0), kRejected);
    EXPECT_EQ(normal(mesh, 0), kRejected);
    EXPECT_EQ(uv(mesh, 0), kRejected);
    EXPECT_EQ(colour(mesh, 0), kRejected);
    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_FALSE(mesh.getValidUVs());
    EXPECT_FALSE(mesh.getValidColours());
}

TEST(TnFbxMesh, StartsEmpty) {
    const TnFbxMesh mesh;

    expectEmpty(mesh);
    EXPECT_EQ(mesh.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 1.0f);
}

TEST(TnFbxMesh, AllocatesOneSetOfPointsAndItsPolygonVertices) {
    TnFbxMesh mesh;

    EXPECT_TRUE(mesh.allocateGeometryData(2, 4, 6));

    EXPECT_EQ(mesh.getNumberOfPolygons(), 2);
    EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 6);
    EXPECT_EQ(mesh.getNumberOfControlPoints(), 4);
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 1);
    for (int polygon = 0; polygon < 2; ++polygon)
        EXPECT_EQ(mesh.getPolygonVertexSize(polygon), 0);
    for (int i = 0; i < 4; ++i)
        EXPECT_EQ(controlPoint(mesh, i), three(0.0f, 0.0f, 0.0f));
    for (int i = 0; i < 6; ++i) {
        EXPECT_EQ(mesh.getPointIndex(i), 0);
        EXPECT_EQ(normal(mesh, i), three(0.0f, 0.0f, 0.0f));
        EXPECT_EQ(uv(mesh, i), two(0.0f, 0.0f));
        EXPECT_EQ(colour(mesh, i), (Values{1.0f, 1.0f, 1.0f, 1.0f}));
    }
    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_FALSE(mesh.getValidUVs());
    EXPECT_FALSE(mesh.getValidColours());
}

TEST(TnFbxMesh, AFailedAllocationLeavesAnEmptyMesh) {
    const struct {
        int polygons, controlPoints, polygonVertices;
    } rejected[] = {{0, 4, 6}, {2, 0, 6}, {2, 4, 0}, {-1, 4, 6}, {2, kLowest, 6}, {2, 4, -1}, {0, 0, 0}};
    for (const auto& [polygons, controlPoints, polygonVertices] : rejected) {
        TnFbxMesh mesh = filledMesh();
        EXPECT_FALSE(mesh.allocateGeometryData(polygons, controlPoints, polygonVertices));
        expectEmpty(mesh);
    }
}

TEST(TnFbxMesh, AllocatingAgainStartsFromTheDefaults) {
    TnFbxMesh mesh = filledMesh();
    mesh.addControlPointSet();
    mesh.addControlPoint(9.0f, 9.0f, 9.0f);

    EXPECT_TRUE(mesh.allocateGeometryData(1, 5, 3));

    EXPECT_EQ(mesh.getNumberOfPolygons(), 1);
    EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 3);
    EXPECT_EQ(mesh.getNumberOfControlPoints(), 5);
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 1);
    EXPECT_EQ(controlPoint(mesh, 4), three(0.0f, 0.0f, 0.0f));
    EXPECT_EQ(controlPoint(mesh, 5), kRejected);
    EXPECT_EQ(colour(mesh, 2), (Values{1.0f, 1.0f, 1.0f, 1.0f}));
    EXPECT_EQ(mesh.getPointIndex(1), 0);
    EXPECT_FALSE(mesh.getValidNormals());
}

TEST(TnFbxMesh, StoresEveryElementInItsOwnPlace) { expectFilled(filledMesh()); }

TEST(TnFbxMesh, AnswersABadPolygonWithMinusOneAndABadPolygonVertexWithZero) {
    const TnFbxMesh mesh = filledMesh();

    for (const int polygon : {-1, 2, kLowest, kHighest})
        EXPECT_EQ(mesh.getPolygonVertexSize(polygon), -1) << polygon;
    for (const int polygonVertex : {-1, 6, kLowest, kHighest})
        EXPECT_EQ(mesh.getPointIndex(polygonVertex), 0) << polygonVertex;
}

TEST(TnFbxMesh, RejectsIndexesOutsideItsArraysAndChangesNothing) {
    TnFbxMesh mesh = filledMesh();

    for (const int index : {-1, 6, 7, kLowest, kHighest}) { // beyond all arrays
        SCOPED_TRACE(index);
        EXPECT_FALSE(mesh.setPolygonVertexSize(index, 1));
        EXPECT_FALSE(mesh.setPointIndex(index, 1));
        EXPECT_FALSE(mesh.setControlPoint(index, 1.0f, 1.0f, 1.0f));
        EXPECT_FALSE(mesh.setNormal(index, 1.0f, 1.0f, 1.0f));
        EXPECT_FALSE(mesh.setUV(index, 1.0f, 1.0f));
        EXPECT_FALSE(mesh.setColour(index, 1.0f, 1.0f, 1.0f, 1.0f));
        EXPECT_EQ(controlPoint(mesh, index), kRejected);
        EXPECT_EQ(normal(mesh, index), kRejected);
        EXPECT_EQ(uv(mesh, index), kRejected);
        EXPECT_EQ(colour(mesh, index), kRejected);
    }
    EXPECT_FALSE(mesh.setPolygonVertexSize(2, 1));
    EXPECT_FALSE(mesh.setControlPoint(4, 1.0f, 1.0f, 1.0f));
    expectFilled(mesh);
}

TEST(TnFbxMesh, DoesNotCheckWhatIsStored) {
    TnFbxMesh mesh = twoTriangles();

    EXPECT_TRUE(mesh.setPolygonVertexSize(0, -5));
    EXPECT_TRUE(mesh.setPointIndex(0, kHighest));
    EXPECT_TRUE(mesh.setPointIndex(1, kLowest));

    EXPECT_EQ(mesh.getPolygonVertexSize(0), -5);
    EXPECT_EQ(mesh.getPointIndex(0), kHighest);
    EXPECT_EQ(mesh.getPointIndex(1), kLowest);
}

TEST(TnFbxMesh, HoldsFurtherSetsOfPointsBehindTheFirst) {
    TnFbxMesh mesh = filledMesh();

    EXPECT_TRUE(mesh.addControlPointSet());
    for (int i = 4; i < 8; ++i) {
        const float f = static_cast<float>(i);
        EXPECT_TRUE(mesh.addControlPoint(f, f + 0.25f, f + 0.5f));
    }

    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 2);
    EXPECT_EQ(mesh.getNumberOfControlPoints(), 4);
    EXPECT_EQ(controlPoint(mesh, 4), three(4.0f, 4.25f, 4.5f));
    EXPECT_EQ(controlPoint(mesh, 7), three(7.0f, 7.25f, 7.5f));
    EXPECT_EQ(controlPoint(mesh, 8), kRejected);
    EXPECT_TRUE(mesh.setControlPoint(7, 1.0f, 2.0f, 3.0f));
    EXPECT_EQ(controlPoint(mesh, 7), three(1.0f, 2.0f, 3.0f));
    expectFilled(mesh);
}

TEST(TnFbxMesh, DeclaringASetAddsNoPoint) {
    TnFbxMesh mesh = filledMesh();

    EXPECT_TRUE(mesh.addControlPointSet());

    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 2);
    EXPECT_EQ(controlPoint(mesh, 4), kRejected);
    expectFilled(mesh);
}

TEST(TnFbxMesh, AddingAPointDeclaresNothing) {
    TnFbxMesh mesh;

    EXPECT_TRUE(mesh.addControlPoint(1.0f, 2.0f, 3.0f));

    EXPECT_EQ(mesh.getNumberOfControlPoints(), 0);
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 0);
    EXPECT_EQ(controlPoint(mesh, 0), three(1.0f, 2.0f, 3.0f));
}

TEST(TnFbxMesh, KeepsTheFlagsApart) {
    TnFbxMesh mesh;

    EXPECT_TRUE(mesh.setValidUVs(true));
    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_TRUE(mesh.getValidUVs());
    EXPECT_FALSE(mesh.getValidColours());

    EXPECT_TRUE(mesh.setValidNormals(true));
    EXPECT_TRUE(mesh.setValidUVs(false));
    EXPECT_TRUE(mesh.getValidNormals());
    EXPECT_FALSE(mesh.getValidUVs());

    EXPECT_TRUE(mesh.setValidNormals(false));
    EXPECT_TRUE(mesh.setValidColours(true));
    EXPECT_FALSE(mesh.getValidNormals());
    EXPECT_TRUE(mesh.getValidColours());
}

TEST(TnFbxMesh, InitAndDeleteRemoveTheGeometryAlone) {
    TnFbxMesh mesh = filledMesh();
    markTransform(mesh, "mesh", 5.0f);
    EXPECT_TRUE(mesh.initMesh());
    expectEmpty(mesh);
    expectMarkedTransform(mesh, "mesh", 5.0f);

    mesh = filledMesh();
    EXPECT_TRUE(mesh.deleteMesh());
    expectEmpty(mesh);
    expectMarkedTransform(mesh, "mesh", 5.0f);
}

TEST(TnFbxMesh, AssignmentCopiesTheGeometryAndKeepsTransformAndName) {
    TnFbxMesh source = filledMesh();
    source.addControlPointSet();
    markTransform(source, "source", 5.0f);
    TnFbxMesh target;
    target.allocateGeometryData(7, 8, 9);
    markTransform(target, "target", -1.0f);

    target = source;
    source.deleteMesh();

    expectFilled(target);
    EXPECT_EQ(target.getNumberOfControlPointSets(), 2);
    expectMarkedTransform(target, "target", -1.0f);
}

TEST(TnFbxMesh, SaysWhetherItsPointsArePlacedUntilItsGeometryGoes) {
    TnFbxMesh mesh;
    EXPECT_FALSE(mesh.getPointsPlaced());
    EXPECT_TRUE(mesh.setPointsPlaced(true));
    TnFbxMesh assigned;
    assigned = mesh;
    EXPECT_TRUE(assigned.getPointsPlaced());
    EXPECT_TRUE(TnFbxMesh(mesh).getPointsPlaced());
    mesh.initMesh();
    EXPECT_FALSE(mesh.getPointsPlaced());
}

TEST(TnFbxMesh, AssignmentToItselfChangesNothing) {
    TnFbxMesh mesh = filledMesh();
    const TnFbxMesh& alias = mesh;

    mesh = alias;

    expectFilled(mesh);
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 1);
}

TEST(TnFbxMesh, ACopyHasTheGeometryTheTransformAndTheName) {
    TnFbxMesh source = filledMesh();
    markTransform(source, "mesh", 5.0f);

    const TnFbxMesh copy(source);

    expectFilled(copy);
    expectMarkedTransform(copy, "mesh", 5.0f);
}

/// Changes every array, and adds a point.
void changeEverywhere(TnFbxMesh& mesh) {
    EXPECT_TRUE(mesh.setPolygonVertexSize(0, 77));
    EXPECT_TRUE(mesh.setPointIndex(0, 77));
    EXPECT_TRUE(mesh.setControlPoint(0, 7.0f, 7.0f, 7.0f));
    EXPECT_TRUE(mesh.addControlPoint(8.0f, 8.0f, 8.0f));
    EXPECT_TRUE(mesh.setNormal(0, 7.0f, 7.0f, 7.0f));
    EXPECT_TRUE(mesh.setUV(0, 7.0f, 7.0f));
    EXPECT_TRUE(mesh.setColour(0, 7.0f, 7.0f, 7.0f, 7.0f));
}

TEST(TnFbxMesh, ChangingACopyLeavesTheOriginalAsItWas) {
    const TnFbxMesh source = filledMesh();
    TnFbxMesh copy(source);
    TnFbxMesh assigned;
    assigned = copy;

    changeEverywhere(copy);

    expectFilled(source);
    expectFilled(assigned);
    EXPECT_EQ(controlPoint(source, 4), kRejected);
    EXPECT_EQ(copy.getPolygonVertexSize(0), 77);
    EXPECT_EQ(copy.getPointIndex(0), 77);
    EXPECT_EQ(controlPoint(copy, 0), three(7.0f, 7.0f, 7.0f));
    EXPECT_EQ(controlPoint(copy, 1), three(1.0f, 1.25f, 1.5f));
    EXPECT_EQ(controlPoint(copy, 4), three(8.0f, 8.0f, 8.0f));
    EXPECT_EQ(normal(copy, 0), three(7.0f, 7.0f, 7.0f));
    EXPECT_EQ(uv(copy, 0), two(7.0f, 7.0f));
    EXPECT_EQ(colour(copy, 0), (Values{7.0f, 7.0f, 7.0f, 7.0f}));
}

TEST(TnFbxMesh, EmptyingOrAllocatingTheOriginalLeavesACopyAsItWas) {
    TnFbxMesh source = filledMesh();
    const TnFbxMesh copy(source);

    source.deleteMesh();
    expectFilled(copy);
    source = copy;
    source.allocateGeometryData(1, 2, 3);

    expectFilled(copy);
    EXPECT_EQ(source.getNumberOfPolygonVertices(), 3);
    EXPECT_EQ(normal(source, 2), three(0.0f, 0.0f, 0.0f));
}

} // namespace
} // namespace Tarnell::Fbx
