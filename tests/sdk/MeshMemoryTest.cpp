// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The memory of meshes is checked against the memory limit.
#include "Fbx.h"
#include "TnFbxError.h"
#include "TnFbxMesh.h"

#include "FixtureFiles.h"
#include "support/MemoryLimitScope.h"
#include "support/TemporaryFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace Tarnell::Fbx {
namespace {

using Limited = support::MemoryLimitScope;

struct Meshes {
    bool read = false;
    int count = -1;
    std::unique_ptr<TnFbxMesh[]> all;
};

Meshes readMeshes(TnFbxReadInfo info = test::readAtFrame("mesh_7400_ascii.fbx", 0.0f)) {
    Meshes meshes;
    TnFbxMesh* array = nullptr;
    meshes.read = Fbx().getMeshes(info, &array, meshes.count);
    meshes.all.reset(array);
    return meshes;
}

TEST(MeshMemory, BeyondTheLimitFailsAndSaysWhatWouldBeNeeded) {
    const Limited limit(100);

    const Meshes meshes = readMeshes();

    EXPECT_FALSE(meshes.read);
    ASSERT_GT(meshes.count, 0);
    EXPECT_EQ(meshes.all[0].getNumberOfPolygons(), 0) << "the array is handed out all the same";
    EXPECT_THAT(lastError(), testing::HasSubstr("mesh_7400_ascii.fbx: "));
    EXPECT_THAT(lastError(), testing::HasSubstr("would be needed; the limit is 100 bytes"));
}

TEST(MeshMemory, WithinTheLimitIsReturned) {
    const Limited limit(100000);

    const Meshes meshes = readMeshes();

    EXPECT_TRUE(meshes.read) << lastError();
    ASSERT_GT(meshes.count, 0);
    EXPECT_GT(meshes.all[0].getNumberOfPolygons(), 0);
}

// ---- Meshes that are on many nodes ----

/// A fan of triangles on that many nodes, which are side by side or all in one place; those after the first mirrored or
/// not.
std::string instances(int count, bool sideBySide, bool mirrored) {
    constexpr int kTriangles = 1000;
    std::string corners;
    std::string points = "0,0,0,1,0,0";
    for (int i = 0; i < kTriangles; ++i) {
        corners += (i == 0 ? "" : ",") + std::string("0,") + std::to_string(i + 1) + ",-" + std::to_string(i + 3);
        points += "," + std::to_string(i % 7) + "," + std::to_string(i % 5) + ",1";
    }
    std::string text = "; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\nObjects: {\n"
                       "Geometry: 10, \"Geometry::\", \"Mesh\" {\nVertices: *" +
                       std::to_string(3 * (kTriangles + 2)) + " {\na: " + points + "\n}\nPolygonVertexIndex: *" +
                       std::to_string(3 * kTriangles) + " {\na: " + corners + "\n}\n}\n";
    std::string connections;
    for (int i = 0; i < count; ++i) {
        const std::string id = std::to_string(100 + i);
        text += "Model: " + id + ", \"Model::m" + id + "\", \"Mesh\" {\nProperties70: {\n" +
                "P: \"Lcl Translation\", \"Lcl Translation\", \"\", \"A\"," + (sideBySide ? std::to_string(i) : "0") +
                ",0,0\nP: \"Lcl Scaling\", \"Lcl Scaling\", \"\", \"A\"," + (mirrored && i > 0 ? "-1" : "1") +
                ",1,1\n}\n}\n";
        connections += "C: \"OO\"," + id + ",0\nC: \"OO\",10," + id + "\n";
    }
    return text + "}\nConnections: {\n" + connections + "}\n";
}

constexpr int kInstances = 100;
constexpr std::uint64_t kPointBytes = 1002 * 12;
constexpr std::uint64_t kOneMesh = kPointBytes + 1000 * 4 + 3000 * 40; // polygons, and corners with all their values
constexpr std::uint64_t kObjects = kInstances * sizeof(TnFbxMesh);

class MeshInstancesOf : public testing::TestWithParam<EFbxFidelity> {
protected:
    Meshes read(bool sideBySide, bool mirrored) {
        TnFbxReadInfo info =
            test::localRead(mFolder.write("instances.fbx", instances(kInstances, sideBySide, mirrored)));
        if (GetParam() == kFbxFidelityFaithful)
            info.setAnimationStackName("");
        info.setFidelity(GetParam());
        info.setTransformPoints(true);
        info.setGlobalTransform(true);
        return readMeshes(info);
    }
    /// Faithful reads count the objects themselves, too.
    static std::uint64_t objects() { return GetParam() == kFbxFidelityFaithful ? kObjects : 0; }

private:
    support::TemporaryFolder mFolder;
};

void expectPlaced(const Meshes& meshes, bool sideBySide) {
    ASSERT_EQ(meshes.count, kInstances);
    for (int i = 0; i < kInstances; ++i) {
        const TnFbxMesh& mesh = meshes.all[static_cast<std::size_t>(i)];
        ASSERT_EQ(mesh.getNumberOfPolygons(), 1000);
        EXPECT_EQ(mesh.getPolygonVertexSize(999), 3);
        EXPECT_EQ(mesh.getNumberOfPolygonVertices(), 3000);
        float x = -1.0f, y = 0.0f, z = 0.0f;
        ASSERT_TRUE(mesh.getControlPoint(0, x, y, z));
        EXPECT_EQ(x, sideBySide ? static_cast<float>(i) : 0.0f);
    }
}

TEST_P(MeshInstancesOf, OnePlaceTakeWhatOneMeshTakes) {
    const Limited limit(objects() + 2 * kOneMesh);
    const Meshes meshes = read(/*sideBySide*/ false, /*mirrored*/ false);

    EXPECT_TRUE(meshes.read) << lastError();
    expectPlaced(meshes, false);
}

TEST_P(MeshInstancesOf, ManyPlacesHaveTheirPointsAlone) {
    const Limited limit(objects() + 2 * kOneMesh + kInstances * kPointBytes);
    const Meshes meshes = read(/*sideBySide*/ true, /*mirrored*/ false);

    EXPECT_TRUE(meshes.read) << lastError();
    expectPlaced(meshes, true);
}

TEST_P(MeshInstancesOf, ManyPlacesDoNotFitIntoLessThanTheirPoints) {
    const Limited limit(kInstances * kPointBytes);
    const Meshes meshes = read(/*sideBySide*/ true, /*mirrored*/ false);

    EXPECT_FALSE(meshes.read);
    EXPECT_THAT(lastError(), testing::HasSubstr("would be needed; the limit is 1.1 MiB"));
}

TEST_P(MeshInstancesOf, MirroredPlacesGoTheirOwnWayRound) {
    const Limited limit(objects() + 3 * kOneMesh + kInstances * kPointBytes);
    const Meshes meshes = read(/*sideBySide*/ true, /*mirrored*/ true);

    EXPECT_TRUE(meshes.read) << lastError();
    expectPlaced(meshes, true);
    const bool turned = GetParam() == kFbxFidelityFaithful;
    EXPECT_EQ(meshes.all[0].getPointIndex(1), 1);
    EXPECT_EQ(meshes.all[1].getPointIndex(1), turned ? 2 : 1);
    EXPECT_EQ(meshes.all[99].getPointIndex(1), turned ? 2 : 1);
}

TEST_P(MeshInstancesOf, OneMeshAreChangedOneByOne) {
    Meshes meshes = read(/*sideBySide*/ false, /*mirrored*/ false);

    meshes.all[1].setControlPoint(0, 5.0f, 5.0f, 5.0f);
    meshes.all[1].setPolygonVertexSize(999, 5);
    meshes.all[1].addControlPoint(1.0f, 2.0f, 3.0f);

    meshes.all[1].setControlPoint(0, 0.0f, 0.0f, 0.0f);
    meshes.all[1].setPolygonVertexSize(999, 3);
    expectPlaced(meshes, false);
    float x = 0.0f, y = 0.0f, z = 0.0f;
    EXPECT_TRUE(meshes.all[1].getControlPoint(1002, x, y, z));
    EXPECT_FALSE(meshes.all[0].getControlPoint(1002, x, y, z));
}

INSTANTIATE_TEST_SUITE_P(BothFidelities, MeshInstancesOf, testing::Values(kFbxFidelityCompatible, kFbxFidelityFaithful),
                         [](const auto& param) {
                             return param.param == kFbxFidelityFaithful ? "Faithful" : "Compatible";
                         });

} // namespace
} // namespace Tarnell::Fbx
