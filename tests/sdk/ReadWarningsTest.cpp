// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a read notices without failing: `lastWarnings()` lists it, with the file and the object.
#include "FixtureFiles.h"
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"
#include "support/TemporaryFolder.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <memory>
#include <string>

namespace Tarnell::Fbx {
namespace {

using namespace test;
using testing::AllOf;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

auto says(const std::string& file, const std::string& object, const std::string& reason) {
    return Contains(AllOf(StartsWith(file + ": "), HasSubstr('"' + object + '"'), HasSubstr(reason)));
}

/// The fixture of point caches in a folder of its own.
struct CopiedCaches {
    CopiedCaches() {
        std::filesystem::copy(fixture("caches_7400_ascii.fbx"), folder.file("caches_7400_ascii.fbx"));
        std::filesystem::copy(fixture("caches"), folder.file("caches"), std::filesystem::copy_options::recursive);
    }
    [[nodiscard]] std::string file() const { return folder.file("caches_7400_ascii.fbx"); }

    support::TemporaryFolder folder;
};

TEST(ReadWarnings, AreNoneForASoundFile) {
    FacadeRead<TnFbxNull> nulls(fixture("curves_7400_ascii.fbx"));

    EXPECT_THAT(lastWarnings(), IsEmpty());
}

TEST(ReadWarnings, NameMeshesWhoseCacheIsMissing) {
    const CopiedCaches copy;
    std::filesystem::remove_all(copy.folder.file("caches"));

    FacadeRead<TnFbxMesh> meshes(localRead(copy.file()));

    EXPECT_GT(meshes.count, 0);
    for (const std::string& name : meshes.names())
        EXPECT_THAT(lastWarnings(), says(copy.file(), name, "read without its point cache: "));
}

TEST(ReadWarnings, NameMeshesWhoseCacheIsDamaged) {
    const CopiedCaches copy;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(copy.folder.file("caches")))
        if (entry.is_regular_file())
            std::filesystem::resize_file(entry.path(), entry.file_size() / 2);

    FacadeRead<TnFbxMesh> meshes(localRead(copy.file()));

    for (const std::string& name : meshes.names())
        EXPECT_THAT(lastWarnings(), says(copy.file(), name, "read without its point cache: "));
}

TEST(ReadWarnings, NameMeshesThatAreDroppedBecauseTheirNameOccursTwice) {
    const support::TemporaryFolder folder;
    const std::string mesh = "Model: \"Model::ball\", \"Mesh\" { Vertices: 0,0,0,1,0,0,0,1,0\n"
                             "PolygonVertexIndex: 0,1,-3\n }\n";
    const std::string file = folder.write("a.fbx", "; FBX 6.1.0 project file\nObjects: {\n" + mesh + mesh +
                                                       "}\nConnections: { Connect: \"OO\", \"Model::ball\", "
                                                       "\"Model::Scene\" }\n");
    FacadeRead<TnFbxMesh> meshes(localRead(file));

    EXPECT_EQ(meshes.count, 1);
    EXPECT_THAT(lastWarnings(), says(file, "Model::ball", "this one is left out"));
}

TEST(ReadWarnings, NameSurfacesThatAreCountedButNotRead) {
    TestScene scene;
    scene.add<fbxsdk::FbxNurbsSurface>("surface");
    scene.addNode("null");
    TnFbxReadInfo info = readAll();
    TnFbxNull nulls[2];
    EXPECT_TRUE(scene.sdk.getNulls(info, nulls, 2));
    EXPECT_THAT(lastWarnings(), Contains(HasSubstr("1 NURBS surface is counted but not read")));

    info.setAllObjects(false);
    info.setObjectName("surface");
    TnFbxTransform transform;
    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));
    EXPECT_EQ(transform.getName(), "");
    EXPECT_THAT(lastWarnings(), Contains(HasSubstr("\"surface\" is a NURBS surface, which is counted but not read")));

    info.setObjectName("null");
    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));
    EXPECT_THAT(lastWarnings(), IsEmpty());
}

/// Two meshes with the same geometry, whose last corner refers to the eighth of three points; or there are none.
std::string cornersBeyondThePoints(bool hasPoints) {
    const std::string points = hasPoints ? "Vertices: *9 {\na: 1,0,0,2,0,0,3,1,0\n}\n" : "";
    return "; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\nObjects: {\n"
           "Geometry: 10, \"Geometry::\", \"Mesh\" {\n" +
           points +
           "PolygonVertexIndex: *3 {\na: 1,2,-8\n}\n}\n"
           "Model: 1, \"Model::one\", \"Mesh\" {\n}\nModel: 2, \"Model::two\", \"Mesh\" {\n}\n}\n"
           "Connections: {\nC: \"OO\",1,0\nC: \"OO\",2,0\nC: \"OO\",10,1\nC: \"OO\",10,2\n}\n";
}

class CornersBeyondThePoints : public testing::TestWithParam<EFbxFidelity> {
protected:
    std::string write(bool hasPoints) { return mFolder.write("corners.fbx", cornersBeyondThePoints(hasPoints)); }
    static TnFbxReadInfo info(const std::string& file) {
        TnFbxReadInfo info = localRead(file);
        info.setFidelity(GetParam());
        if (GetParam() == kFbxFidelityFaithful)
            info.setAnimationStackName("");
        return info;
    }

private:
    support::TemporaryFolder mFolder;
};

TEST_P(CornersBeyondThePoints, AreReadAsTheFirstPointWithAWarning) {
    const std::string file = write(/*hasPoints*/ true);
    FacadeRead<TnFbxMesh> meshes(info(file));

    ASSERT_EQ(meshes.count, 2);
    EXPECT_EQ(meshes["one"].getPointIndex(1), 2);
    EXPECT_EQ(meshes["one"].getPointIndex(2), 0);
    EXPECT_EQ(meshes["two"].getPointIndex(2), 0);
    EXPECT_THAT(lastWarnings(),
                testing::ElementsAre(file + ": \"one\" and 1 more: polygons refer to control points that do not exist; "
                                            "control point 0 is read instead"));
}

TEST_P(CornersBeyondThePoints, AreReportedAsLeftOutWhereThereIsNoPoint) {
    const std::string file = write(/*hasPoints*/ false);
    TnFbxReadInfo options = info(file);
    TnFbxMesh* meshes = nullptr;
    int count = 0;

    static_cast<void>(Fbx().getMeshes(options, &meshes, count));

    const std::unique_ptr<TnFbxMesh[]> owner(meshes);
    EXPECT_THAT(lastWarnings(),
                Contains(file + ": \"one\" and 1 more: polygons refer to control points, but the mesh has none; "
                                "the polygons are left out"));
}

INSTANTIATE_TEST_SUITE_P(BothFidelities, CornersBeyondThePoints,
                         testing::Values(kFbxFidelityCompatible, kFbxFidelityFaithful), [](const auto& param) {
                             return param.param == kFbxFidelityFaithful ? "Faithful" : "Compatible";
                         });

} // namespace
} // namespace Tarnell::Fbx
