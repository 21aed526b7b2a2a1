// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What meshes take is held against the memory limit.
#include "Fbx.h"
#include "TnFbxError.h"
#include "TnFbxLimits.h"
#include "TnFbxMesh.h"

#include "FixtureFiles.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <memory>

namespace Tarnell::Fbx {
namespace {

/// A limit that is in force for a test.
class Limited {
public:
    explicit Limited(std::uint64_t bytes) { setMemoryLimit(bytes); }
    ~Limited() { setMemoryLimit(0); }
    Limited(const Limited&) = delete;
    Limited& operator=(const Limited&) = delete;
};

struct Meshes {
    bool read = false;
    int count = -1;
    std::unique_ptr<TnFbxMesh[]> all;
};

Meshes readMeshes() {
    TnFbxReadInfo info = test::readAtFrame("mesh_7400_ascii.fbx", 0.0f);
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
    EXPECT_THAT(lastError(), testing::HasSubstr("would be needed, and the limit is 100 bytes"));
}

TEST(MeshMemory, WithinTheLimitIsHandedOut) {
    const Limited limit(100000);

    const Meshes meshes = readMeshes();

    EXPECT_TRUE(meshes.read) << lastError();
    ASSERT_GT(meshes.count, 0);
    EXPECT_GT(meshes.all[0].getNumberOfPolygons(), 0);
}

} // namespace
} // namespace Tarnell::Fbx
