// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which arrays meshes of one source share.
#include "model/MeshInstances.h"

#include "model/MeshArrays.h"

#include <gtest/gtest.h>

namespace Tarnell::Fbx {
namespace {

using detail::MeshArrays;
using detail::MeshInstances;

constexpr std::uint64_t kPointBytes = 12;
constexpr std::uint64_t kNormalBytes = 12;
constexpr std::uint64_t kColourBytes = 16;

/// A triangle of three points, which lie at x.
void fill(MeshArrays& arrays, float x) {
    for (int i = 0; i < 3; ++i)
        arrays.addControlPoint({x, 0.0f, 0.0f});
    arrays.addNormal({0.0f, 1.0f, 0.0f});
}

TnFbxMesh triangle(float x) {
    TnFbxMesh mesh;
    MeshArrays arrays(mesh);
    arrays.allocate(1, 3, 3);
    arrays.addPolygonVertexSize(3);
    fill(arrays, x);
    arrays.complete();
    return mesh;
}

TnFbxMesh another(const MeshInstances::Geometry& first, float x) {
    TnFbxMesh mesh;
    MeshArrays arrays(mesh);
    arrays.allocateLike(first);
    fill(arrays, x);
    arrays.complete();
    return mesh;
}

const int kSource = 0;
constexpr MeshInstances::Source kStraight = {&kSource, false};
constexpr MeshInstances::Source kReversed = {&kSource, true};

float firstX(const TnFbxMesh& mesh) {
    float x = -1.0f, y = 0.0f, z = 0.0f;
    EXPECT_TRUE(mesh.getControlPoint(0, x, y, z));
    return x;
}

TEST(MeshInstances, HoldNothingTwiceWhenTheyArePlacedAlike) {
    MeshInstances instances;
    TnFbxMesh first = triangle(5.0f);
    EXPECT_EQ(instances.keep(kStraight, first), 0u);
    ASSERT_NE(instances.find(kStraight), nullptr);

    TnFbxMesh second = another(*instances.find(kStraight), 5.0f);

    EXPECT_EQ(second.getPolygonVertexSize(0), 3);
    EXPECT_EQ(instances.keep(kStraight, second), 3 * (kPointBytes + kNormalBytes + kColourBytes));
    EXPECT_EQ(firstX(second), 5.0f);
    EXPECT_EQ(MeshArrays::bytesOfAnother(3, 3), 3 * (kPointBytes + kNormalBytes + kColourBytes));
}

TEST(MeshInstances, HoldTheirOwnPointsWhereTheyArePlacedElsewhere) {
    MeshInstances instances;
    TnFbxMesh first = triangle(5.0f);
    instances.keep(kStraight, first);

    TnFbxMesh second = another(*instances.find(kStraight), 6.0f);

    EXPECT_EQ(instances.keep(kStraight, second), 3 * (kNormalBytes + kColourBytes));
    EXPECT_EQ(firstX(first), 5.0f);
    EXPECT_EQ(firstX(second), 6.0f);
    TnFbxMesh third = another(*instances.find(kStraight), 6.0f);
    EXPECT_EQ(instances.keep(kStraight, third), 3 * (kPointBytes + kNormalBytes + kColourBytes)) << "as the second is";
}

TEST(MeshInstances, StayAsTheyAreWhenOneIsChanged) {
    MeshInstances instances;
    TnFbxMesh first = triangle(5.0f);
    instances.keep(kStraight, first);
    TnFbxMesh second = another(*instances.find(kStraight), 5.0f);
    instances.keep(kStraight, second);

    second.setControlPoint(0, 9.0f, 0.0f, 0.0f);
    second.setPolygonVertexSize(0, 4);

    EXPECT_EQ(firstX(first), 5.0f);
    EXPECT_EQ(first.getPolygonVertexSize(0), 3);
}

TEST(MeshInstances, OfAnotherSourceOrOrderOfCornersAreUnknown) {
    MeshInstances instances;
    EXPECT_TRUE(instances.isFirst(kStraight));
    EXPECT_FALSE(instances.isFirst(kStraight));
    EXPECT_TRUE(instances.isFirst(kReversed));
    EXPECT_EQ(instances.find(kStraight), nullptr) << "none was kept";
    TnFbxMesh first = triangle(5.0f);
    instances.keep(kStraight, first);

    EXPECT_NE(instances.find(kStraight), nullptr);
    EXPECT_EQ(instances.find(kReversed), nullptr);
    instances.forget();
    EXPECT_EQ(instances.find(kStraight), nullptr);
    EXPECT_TRUE(instances.isFirst(kStraight));
}

TEST(MeshInstances, ShareArraysThatHoldDefaultsAlone) {
    MeshInstances instances;
    TnFbxMesh first = triangle(5.0f), second = triangle(6.0f);
    instances.keep(kStraight, first);
    EXPECT_EQ(instances.keep(kStraight, second), 3 * sizeof(float) * 3 + 3 * sizeof(float) * 4)
        << "normals and colours";
    EXPECT_EQ(firstX(second), 6.0f);
}

} // namespace
} // namespace Tarnell::Fbx
