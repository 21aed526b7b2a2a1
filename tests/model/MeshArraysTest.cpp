// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Filling the arrays of a mesh one after the other.
#include "model/MeshArrays.h"

#include <array>

#include <gtest/gtest.h>

namespace Tarnell::Fbx {
namespace {

using detail::MeshArrays;

std::array<float, 9> cornerOf(const TnFbxMesh& mesh, int polygonVertex) {
    std::array<float, 9> c = {-1, -1, -1, -1, -1, -1, -1, -1, -1};
    EXPECT_TRUE(mesh.getNormal(polygonVertex, c[0], c[1], c[2]));
    EXPECT_TRUE(mesh.getUV(polygonVertex, c[3], c[4]));
    EXPECT_TRUE(mesh.getColour(polygonVertex, c[5], c[6], c[7], c[8]));
    return c;
}

std::array<float, 3> pointOf(const TnFbxMesh& mesh, int index) {
    std::array<float, 3> p = {-1, -1, -1};
    EXPECT_TRUE(mesh.getControlPoint(index, p[0], p[1], p[2]));
    return p;
}

constexpr std::array<float, 9> kDefaults = {0, 0, 0, 0, 0, 1, 1, 1, 1};

TEST(MeshArrays, HoldsDefaultsForWhatWasNotAdded) {
    TnFbxMesh mesh;
    EXPECT_TRUE(MeshArrays(mesh).allocate(2, 4, 6));

    EXPECT_EQ(mesh.getNumberOfPolygons(), 2);
    EXPECT_EQ(mesh.getNumberOfControlPoints(), 4);
    EXPECT_EQ(mesh.getNumberOfControlPointSets(), 1);
    EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 6);
    EXPECT_EQ(mesh.getPolygonVertexSize(1), 0);
    EXPECT_EQ(mesh.getPointIndex(5), 0);
    EXPECT_EQ(cornerOf(mesh, 5), kDefaults);
}

TEST(MeshArrays, KeepsWhatIsAdded) {
    TnFbxMesh mesh;
    {
        MeshArrays arrays(mesh);
        ASSERT_TRUE(arrays.allocate(1, 2, 3));
        arrays.addPolygonVertexSize(3);
        arrays.addPointIndex(0);
        const std::array<int, 2> indices = {6, 7};
        arrays.addPointIndices(indices.data(), indices.size());
        arrays.addControlPoint({1, 2, 3});
        arrays.addNormal({0, 0, 0});
        arrays.addNormal({1, 2, 3});
        arrays.addUV({0, 0});
        arrays.addUV({4, 5});
        arrays.colours()[1] = {6, 7, 8, 9};
        EXPECT_EQ(arrays.colours()[1].green, 7); // requesting it again changes nothing
    }

    EXPECT_EQ(mesh.getPolygonVertexSize(0), 3);
    EXPECT_EQ(mesh.getPointIndex(1), 6);
    EXPECT_EQ(mesh.getPointIndex(2), 7);
    EXPECT_EQ(pointOf(mesh, 0), (std::array<float, 3>{1, 2, 3}));
    EXPECT_EQ(pointOf(mesh, 1), (std::array<float, 3>{0, 0, 0}));
    EXPECT_EQ(cornerOf(mesh, 1), (std::array<float, 9>{1, 2, 3, 4, 5, 6, 7, 8, 9}));
    EXPECT_EQ(cornerOf(mesh, 2), kDefaults);
}

TEST(MeshArrays, LeavesAnEmptyMeshWhenANumberIsBelowOne) {
    TnFbxMesh mesh;
    for (const auto& [polygons, points, corners] :
         {std::array<int, 3>{0, 1, 1}, std::array<int, 3>{1, 0, 1}, std::array<int, 3>{1, 1, -1}}) {
        ASSERT_TRUE(mesh.allocateGeometryData(2, 2, 2));
        EXPECT_FALSE(MeshArrays(mesh).allocate(polygons, points, corners));
        EXPECT_EQ(mesh.getNumberOfPolygons(), 0);
        EXPECT_EQ(mesh.getNumberOfControlPoints(), 0);
        EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 0);
    }
}

TEST(MeshArrays, StartsOverWithAMeshThatHadMore) {
    TnFbxMesh mesh;
    ASSERT_TRUE(mesh.allocateGeometryData(10, 10, 10));
    mesh.setNormal(0, 5, 5, 5);
    mesh.setValidNormals(true);

    EXPECT_TRUE(MeshArrays(mesh).allocate(1, 1, 2));

    EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 2);
    EXPECT_EQ(cornerOf(mesh, 0), kDefaults);
    EXPECT_FALSE(mesh.getValidNormals());
}

} // namespace
} // namespace Tarnell::Fbx
