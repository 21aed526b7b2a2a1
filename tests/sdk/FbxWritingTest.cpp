// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writing through the facade: what the options must name, what is skipped, and the state after a failure.
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>

namespace Tarnell::Fbx {
namespace {

using support::TemporaryFolder;
using test::FacadeRead;
using test::samplesOf;
using test::timeOf;
using test::WrittenObjects;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;
namespace fs = std::filesystem;

TnFbxWriteInfo optionsFor(const std::string& fileName) {
    TnFbxWriteInfo info;
    info.setFileName(fileName);
    info.setAnimationStackName("walk");
    return info;
}

bool write(const TnFbxWriteInfo& info, const WrittenObjects& objects = {}) {
    return Fbx().writeFile(info, objects.cameras, objects.lights, objects.transforms, objects.nulls, objects.meshes);
}

TnFbxNull keyedNull(const char* name) {
    TnFbxNull null;
    null.setName(name);
    null.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, timeOf(1, 2), {1.0f, 2.0f});
    return null;
}

TEST(FbxWriting, OfNothingStillWritesAFileWithItsStack) {
    TemporaryFolder folder;

    EXPECT_TRUE(write(optionsFor(folder.file("shot.fbx")))) << lastError();
    EXPECT_TRUE(lastError().empty());

    std::vector<std::string> stacks, nodes;
    EXPECT_TRUE(Fbx().getAnimationStackNodeNames(folder.file("shot.fbx").c_str(), 0x4005 | 64, stacks, nodes));
    EXPECT_THAT(stacks, ElementsAre("Take 001")) << "not the name in the options";
    EXPECT_THAT(nodes, IsEmpty());
}

TEST(FbxWriting, NeedsAFileName) {
    EXPECT_FALSE(write(optionsFor("")));
    EXPECT_THAT(lastError(), HasSubstr("file"));
}

TEST(FbxWriting, NeedsAnAnimationStackName) {
    TemporaryFolder folder;
    TnFbxWriteInfo info = optionsFor(folder.file("out/shot.fbx"));
    info.setAnimationStackName("");
    const auto mesh = test::movingMesh("mesh", 1);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};

    EXPECT_FALSE(write(info, objects));

    EXPECT_THAT(lastError(), HasSubstr("animation stack"));
    EXPECT_FALSE(fs::exists(folder.file("out"))) << "nothing is made before the options are complete";
}

TEST(FbxWriting, IsTextByDefault) {
    TemporaryFolder folder;
    TnFbxWriteInfo info = optionsFor(folder.file("shot.fbx"));
    EXPECT_TRUE(write(info)) << lastError();
    EXPECT_THAT(folder.read("shot.fbx"), StartsWith("; FBX 7.5.0 project file"));

    info.setFileFormat(false);
    EXPECT_TRUE(write(info)) << lastError();
    EXPECT_THAT(folder.read("shot.fbx"), StartsWith("Kaydara FBX Binary"));
}

TEST(FbxWriting, LeavesNullPointersOut) {
    TemporaryFolder folder;
    TnFbxNull null = keyedNull("null");
    WrittenObjects objects;
    objects.cameras = {nullptr};
    objects.lights = {nullptr, nullptr};
    objects.transforms = {nullptr};
    objects.nulls = {nullptr, &null, nullptr};
    objects.meshes = {nullptr};

    EXPECT_TRUE(write(optionsFor(folder.file("shot.fbx")), objects)) << lastError();

    EXPECT_THAT(FacadeRead<TnFbxTransform>(folder.file("shot.fbx")).names(), ElementsAre("null"));
}

TEST(FbxWriting, OnlyReadsTheObjects) {
    TemporaryFolder folder;
    TnFbxNull null = keyedNull("null");
    WrittenObjects objects;
    objects.nulls = {&null};

    EXPECT_TRUE(write(optionsFor(folder.file("first.fbx")), objects)) << lastError();

    EXPECT_EQ(null.getName(), "null");
    EXPECT_THAT(samplesOf(null, TnFbxTransform::kFbxTransformPositionX), ElementsAre(1.0f, 2.0f));
    EXPECT_TRUE(write(optionsFor(folder.file("second.fbx")), objects)) << lastError();
    EXPECT_THAT(FacadeRead<TnFbxNull>(folder.file("second.fbx")).names(), ElementsAre("null"));
}

TEST(FbxWriting, ReplacesAFileThatIsThere) {
    TemporaryFolder folder;
    folder.write("shot.fbx", std::string(1000000, 'x'));

    EXPECT_TRUE(write(optionsFor(folder.file("shot.fbx")))) << lastError();

    EXPECT_EQ(FacadeRead<TnFbxNull>(folder.file("shot.fbx")).count, 0);
}

TEST(FbxWriting, SaysWhichFileCannotBeWritten) {
    TemporaryFolder folder;
    const std::string file = folder.file("no folder/shot.fbx");

    EXPECT_FALSE(write(optionsFor(file)));

    EXPECT_THAT(lastError(), StartsWith(file + ": "));
}

/// A mesh with a point cache of two frames.
bool writeMovingMesh(const std::string& fileName) {
    const auto mesh = test::movingMesh("mesh", 2);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};
    TnFbxWriteInfo info = optionsFor(fileName);
    info.setEndFrame(2.0f);
    return write(info, objects);
}

TEST(FbxWriting, ThatFailsLeavesNoPointCacheThatWasNotThere) {
    TemporaryFolder folder;
    fs::create_directories(folder.file("shot.fbx")); // a folder with the name of the file

    EXPECT_FALSE(writeMovingMesh(folder.file("shot.fbx")));

    EXPECT_THAT(lastError(), HasSubstr("shot.fbx"));
    EXPECT_TRUE(fs::is_directory(folder.file("shot.fbx")));
    EXPECT_FALSE(fs::exists(folder.file("shot_fpc")));
}

TEST(FbxWriting, ThatFailsLeavesTheOldPointCache) {
    TemporaryFolder folder;
    fs::create_directories(folder.file("shot.fbx"));
    folder.write("shot_fpc/mesh.xml", "old");
    folder.write("shot_fpc/mesh.mcx", "old data");

    EXPECT_FALSE(writeMovingMesh(folder.file("shot.fbx")));

    EXPECT_EQ(folder.read("shot_fpc/mesh.xml"), "old");
    EXPECT_EQ(folder.read("shot_fpc/mesh.mcx"), "old data");
    EXPECT_EQ(folder.files("shot_fpc").size(), 2U);
}

TEST(FbxWriting, ThatFailsTakesTheFoldersAwayThatItMade) {
    TemporaryFolder folder;
    folder.write("here/other", "somebody else's");
    fs::create_directories(folder.file("here/there/shot.fbx"));

    EXPECT_FALSE(writeMovingMesh(folder.file("here/there/shot.fbx")));

    EXPECT_EQ(folder.files("here/there"), std::vector<std::string>{"shot.fbx"});
}

TEST(FbxWriting, OfMeshesOfOneNameSaysThatTheyShareACache) {
    TemporaryFolder folder;
    const auto first = test::movingMesh("mesh", 2), second = test::movingMesh("mesh", 2);
    WrittenObjects objects;
    objects.meshes = {first.get(), second.get()};
    TnFbxWriteInfo info = optionsFor(folder.file("shot.fbx"));
    info.setEndFrame(2.0f);

    EXPECT_TRUE(write(info, objects)) << lastError();
    EXPECT_TRUE(write(info, objects)) << lastError();

    EXPECT_THAT(lastWarnings(), ElementsAre(StartsWith("mesh: meshes with the same name share one point cache")));
    EXPECT_EQ(folder.files("shot_fpc"), (std::vector<std::string>{"mesh.mcx", "mesh.xml"}));
}

TEST(FbxWriting, OfAMeshWhoseSetsDoNotFitTheRangeStillWritesTheMesh) {
    TemporaryFolder folder;
    const auto mesh = test::movingMesh("mesh", 2);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};

    EXPECT_TRUE(write(optionsFor(folder.file("shot.fbx")), objects)) << lastError(); // frames 1 to 1

    FacadeRead<TnFbxMesh> meshes(folder.file("shot.fbx"));
    float x = 0.0f, y = 0.0f, z = -1.0f;
    EXPECT_TRUE(meshes["mesh"].getControlPoint(2, x, y, z));
    EXPECT_EQ(x, 2.0f);
    EXPECT_EQ(y, 4.0f);
    EXPECT_EQ(z, 0.0f);
}

TEST(FbxWriting, WritesALightsDirectionSoThatTheWorldGivesItBack) {
    TemporaryFolder folder;
    TnFbxLight light;
    light.setName("light");
    light.setLightType(TnFbxLight::kFbxLightDirectional);
    light.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
    light.setTransformValue(TnFbxTransform::kFbxTransformPositionX, 1.0f);
    light.setTransformValue(TnFbxTransform::kFbxTransformRotationX, 20.0f);
    light.setTransformValue(TnFbxTransform::kFbxTransformRotationY, 30.0f);
    WrittenObjects objects;
    objects.lights = {&light};
    EXPECT_TRUE(write(optionsFor(folder.file("shot.fbx")), objects)) << lastError();

    TnFbxReadInfo info = test::localRead(folder.file("shot.fbx"));
    info.setGlobalTransform(true);
    FacadeRead<TnFbxLight> lights(info);

    const TnFbxLight& read = lights["light"];
    EXPECT_NEAR(read.getTransformValue(TnFbxTransform::kFbxTransformRotationX), 20.0f, 1e-4f);
    EXPECT_NEAR(read.getTransformValue(TnFbxTransform::kFbxTransformRotationY), 30.0f, 1e-4f);
    EXPECT_NEAR(read.getTransformValue(TnFbxTransform::kFbxTransformRotationZ), 0.0f, 1e-4f);
}

} // namespace
} // namespace Tarnell::Fbx
