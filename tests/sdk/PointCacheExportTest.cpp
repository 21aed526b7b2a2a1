// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Point caches of animated meshes: their location, the deformers that refer to them, and their samples.
#include "support/TemporaryFolder.h"
#include "support/WritingBuilders.h"

#include "Fbx.h"
#include "TnFbxError.h"
#include "access/PointCachePlace.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <filesystem>
#include <iostream>
#include <limits>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxCache;
using support::TemporaryFolder;
using test::movingMesh;
using test::WrittenObjects;
using test::WrittenScene;
using testing::Each;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;
namespace fs = std::filesystem;

TnFbxTime framesFrom(int first, int last, float rate = 24.0f) {
    TnFbxTime time;
    time.setTime(static_cast<float>(first), first, last, rate);
    return time;
}

/// A mesh node and the folder that its FBX file would be in.
struct CacheScene : WrittenScene {
    explicit CacheScene(bool isMaya = true, int sets = 3) : maya(isMaya), mesh(movingMesh("ball", sets)) {
        node = sdk.createMesh(manager, mesh.get(), "ball");
        scene->GetRootNode()->AddChild(node); // a cache is looked for next to the file of its scene
    }

    std::string fbxFile() const { return folder.file("out/shot.fbx"); }
    bool map() { return sdk.mapVertexCacheOnMesh(manager, node, maya, fbxFile()); }
    bool animate(const TnFbxTime& time, bool mcx = true) {
        return sdk.animateVertexCacheOnMesh(node, mesh.get(), maya, mcx, time);
    }

    fbxsdk::FbxVertexCacheDeformer* deformer() const {
        return fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(
            node->GetGeometry()->GetDeformer(0, fbxsdk::FbxDeformer::eVertexCache));
    }
    FbxCache& cache() const { return *deformer()->GetCache(); }

    /// The three points at a frame of the open cache.
    std::array<double, 9> pointsAt(int frame) const {
        std::array<double, 9> buffer;
        buffer.fill(-1.0);
        if (maya) {
            fbxsdk::FbxTime time;
            time.SetSecondDouble(frame / 24.0);
            EXPECT_TRUE(cache().Read(0, time, buffer.data(), 3u));
        } else {
            EXPECT_TRUE(cache().Read(static_cast<unsigned int>(frame), buffer.data(), 3u));
        }
        return buffer;
    }

    /// The Z of the second point, which numbers the sets, at a frame of the open cache.
    double setAt(int frame) const {
        const std::array<double, 9> points = pointsAt(frame);
        EXPECT_EQ(points[3], 1.0);
        EXPECT_EQ(points[6], 2.0);
        EXPECT_EQ(points[7], 4.0);
        return points[5];
    }

    TemporaryFolder folder;
    bool maya;
    std::unique_ptr<TnFbxMesh> mesh;
    fbxsdk::FbxNode* node;
};

/// The names in a folder, in order.
std::vector<std::string> filesIn(const std::string& folder) {
    std::vector<std::string> names;
    if (fs::is_directory(folder))
        for (const auto& entry : fs::directory_iterator(folder))
            names.push_back(entry.path().filename().string());
    std::sort(names.begin(), names.end());
    return names;
}

/// The output to standard output.
template <class Action>
std::string printedBy(Action action) {
    testing::internal::CaptureStdout();
    action();
    return testing::internal::GetCapturedStdout();
}

// ---- The vertex cache on the mesh ----

TEST(PointCacheMapping, NamesTheFileAfterTheNodeInAFolderNamedAfterTheFbxFile) {
    for (const bool maya : {true, false}) {
        CacheScene scene(maya);

        EXPECT_TRUE(scene.map());

        fbxsdk::FbxString relative, absolute;
        scene.cache().GetCacheFileName(relative, absolute);
        const std::string extension = maya ? ".xml" : ".pc2";
        EXPECT_EQ(std::string(relative), "shot_fpc/ball" + extension);
        EXPECT_EQ(std::string(absolute), scene.folder.file("out/shot_fpc/ball" + extension));
        EXPECT_EQ(scene.cache().GetCacheFileFormat(), maya ? FbxCache::eMayaCache : FbxCache::eMaxPointCacheV2);
        EXPECT_TRUE(fs::is_directory(scene.folder.file("out/shot_fpc")));
        EXPECT_THAT(filesIn(scene.folder.file("out/shot_fpc")), IsEmpty());
    }
}

TEST(PointCacheMapping, LiesBesideAnFbxFileInTheRootFolder) {
    const auto place = detail::pointCachePlace("/shot.fbx", "ball", ".xml");

    EXPECT_STREQ(place.folder, "/shot_fpc");
    EXPECT_STREQ(place.file, "/shot_fpc/ball.xml");
    EXPECT_STREQ(place.relative, "shot_fpc/ball.xml");
}

TEST(PointCacheMapping, AttachesAnActiveDeformerNamedAfterTheNode) {
    CacheScene scene;

    EXPECT_TRUE(scene.map());

    ASSERT_NE(scene.deformer(), nullptr);
    EXPECT_STREQ(scene.deformer()->GetName(), "ball");
    EXPECT_STREQ(scene.deformer()->Channel.Get(), "ball");
    EXPECT_TRUE(scene.deformer()->Active.Get());
    EXPECT_STREQ(scene.cache().GetName(), "ball");
}

TEST(PointCacheMapping, NeedsAFileNameAManagerAndAMesh) {
    CacheScene scene;

    EXPECT_FALSE(scene.sdk.mapVertexCacheOnMesh(scene.manager, scene.node, true, ""));
    EXPECT_FALSE(lastError().empty());
    EXPECT_FALSE(scene.sdk.mapVertexCacheOnMesh(nullptr, scene.node, true, scene.fbxFile()));
    EXPECT_FALSE(scene.sdk.mapVertexCacheOnMesh(scene.manager, nullptr, true, scene.fbxFile()));
    fbxsdk::FbxNode* bare = fbxsdk::FbxNode::Create(scene.scene, "bare");
    EXPECT_FALSE(scene.sdk.mapVertexCacheOnMesh(scene.manager, bare, true, scene.fbxFile()));

    EXPECT_EQ(scene.deformer(), nullptr);
    EXPECT_FALSE(fs::exists(scene.folder.file("out")));
}

TEST(PointCacheMapping, FailsWhereTheFolderCannotBeMade) {
    CacheScene scene;
    scene.folder.write("out", "a file, not a folder");

    EXPECT_FALSE(scene.map());

    EXPECT_THAT(lastError(), HasSubstr("shot_fpc"));
    EXPECT_EQ(scene.deformer(), nullptr);
}

TEST(PointCacheMapping, TakesTheLastExtensionOff) {
    CacheScene scene;

    EXPECT_TRUE(scene.sdk.mapVertexCacheOnMesh(scene.manager, scene.node, true, scene.folder.file("a/../shot.v2.fbx")));

    EXPECT_TRUE(fs::is_directory(scene.folder.file("shot.v2_fpc")));
}

TEST(PointCacheMapping, NeverLeavesTheFolder) {
    CacheScene scene;
    fbxsdk::FbxNode* outside = scene.sdk.createMesh(scene.manager, scene.mesh.get(), "../../elsewhere");

    EXPECT_TRUE(scene.sdk.mapVertexCacheOnMesh(scene.manager, outside, true, scene.fbxFile()));

    fbxsdk::FbxString relative, absolute;
    auto* deformer = fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(
        outside->GetGeometry()->GetDeformer(0, fbxsdk::FbxDeformer::eVertexCache));
    deformer->GetCache()->GetCacheFileName(relative, absolute);
    EXPECT_STREQ(relative, "shot_fpc/..%2F..%2Felsewhere.xml");
    EXPECT_STREQ(deformer->Channel.Get(), "../../elsewhere") << "the name of the node, as it is";
}

// ---- The samples ----

class PointCacheSamples : public testing::TestWithParam<bool> {};
INSTANTIATE_TEST_SUITE_P(BothFormats, PointCacheSamples, testing::Bool());

TEST_P(PointCacheSamples, AreOneSetOfPointsPerFrame) {
    CacheScene scene(/*isMaya*/ GetParam());
    ASSERT_TRUE(scene.map());

    EXPECT_TRUE(scene.animate(framesFrom(10, 12))) << lastError();

    ASSERT_TRUE(scene.cache().OpenFileForRead());
    EXPECT_EQ(scene.setAt(10), 0.0);
    EXPECT_EQ(scene.setAt(11), 1.0);
    EXPECT_EQ(scene.setAt(12), 2.0);
    EXPECT_TRUE(scene.cache().CloseFile());
}

TEST_P(PointCacheSamples, MayStartBeforeFrameZero) {
    CacheScene scene(/*isMaya*/ GetParam());
    ASSERT_TRUE(scene.map());

    EXPECT_TRUE(scene.animate(framesFrom(-1, 1))) << lastError();

    ASSERT_TRUE(scene.cache().OpenFileForRead());
    EXPECT_EQ(scene.setAt(-1), 0.0);
    EXPECT_EQ(scene.setAt(0), 1.0);
    EXPECT_EQ(scene.setAt(1), 2.0);
    EXPECT_TRUE(scene.cache().CloseFile());
}

TEST_P(PointCacheSamples, AreNoneUnlessThereIsExactlyOneSetPerFrame) {
    const bool maya = GetParam();
    CacheScene scene(maya, /*sets*/ 2);
    ASSERT_TRUE(scene.map());

    EXPECT_EQ(printedBy([&scene] {
                  EXPECT_FALSE(scene.animate(framesFrom(10, 12)));
                  EXPECT_FALSE(scene.animate(framesFrom(10, 10)));
                  EXPECT_FALSE(scene.animate(framesFrom(12, 10)));
                  EXPECT_FALSE(scene.animate(framesFrom(std::numeric_limits<int>::min(), //
                                                        std::numeric_limits<int>::max())));
              }),
              "");

    EXPECT_FALSE(lastError().empty());
    EXPECT_THAT(filesIn(scene.folder.file("out/shot_fpc")), IsEmpty());
}

TEST_P(PointCacheSamples, AreZeroWhereASetHasNoPoints) {
    CacheScene scene(/*isMaya*/ GetParam(), /*sets*/ 1);
    scene.mesh->addControlPointSet(); // without the points that belong to it
    ASSERT_TRUE(scene.map());

    EXPECT_TRUE(scene.animate(framesFrom(0, 1))) << lastError();

    ASSERT_TRUE(scene.cache().OpenFileForRead());
    EXPECT_THAT(scene.pointsAt(1), Each(0.0));
    EXPECT_TRUE(scene.cache().CloseFile());
}

TEST_P(PointCacheSamples, SayOnStandardOutputThatTheFileCannotBeOpened) {
    CacheScene scene(/*isMaya*/ GetParam());
    ASSERT_TRUE(scene.map());
    fs::remove_all(scene.folder.file("out"));

    bool result = true;
    const std::string printed = printedBy([&] { result = scene.animate(framesFrom(10, 12)); });

    EXPECT_FALSE(result);
    EXPECT_EQ(printed, "Error opening file for write: cannot be written: No such file or directory\n");
    EXPECT_THAT(lastError(), StartsWith(scene.folder.file("out/shot_fpc/ball.")));
    EXPECT_THAT(lastError(), EndsWith(": cannot be written: No such file or directory"));
}

TEST_P(PointCacheSamples, ReplaceThoseOfAnEarlierWrite) {
    CacheScene scene(/*isMaya*/ GetParam());
    ASSERT_TRUE(scene.map());
    EXPECT_TRUE(scene.animate(framesFrom(10, 12))) << lastError();

    EXPECT_TRUE(scene.animate(framesFrom(20, 22))) << lastError();

    ASSERT_TRUE(scene.cache().OpenFileForRead());
    EXPECT_EQ(scene.setAt(10), 0.0) << "held before the first sample";
    EXPECT_EQ(scene.setAt(22), 2.0);
    EXPECT_TRUE(scene.cache().CloseFile());
}

TEST_P(PointCacheSamples, NeedAMeshWithPointsAndAVertexCache) {
    CacheScene scene(/*isMaya*/ GetParam());
    const TnFbxMesh empty;
    const TnFbxTime time = framesFrom(10, 12);

    EXPECT_FALSE(scene.animate(time)) << "nothing is mapped yet";
    EXPECT_FALSE(lastError().empty());
    EXPECT_FALSE(scene.sdk.animateVertexCacheOnMesh(nullptr, scene.mesh.get(), GetParam(), true, time));
    EXPECT_FALSE(scene.sdk.animateVertexCacheOnMesh(scene.node, nullptr, GetParam(), true, time));
    EXPECT_FALSE(scene.sdk.animateVertexCacheOnMesh(scene.node, &empty, GetParam(), true, time));
    fbxsdk::FbxNode* bare = fbxsdk::FbxNode::Create(scene.scene, "bare");
    EXPECT_FALSE(scene.sdk.animateVertexCacheOnMesh(bare, scene.mesh.get(), GetParam(), true, time));
}

TEST_P(PointCacheSamples, FailForTheOtherFormatThanTheMappedOne) {
    const bool maya = GetParam();
    CacheScene scene(maya);
    ASSERT_TRUE(scene.map());
    scene.maya = !maya;

    const std::string printed = printedBy([&scene] { EXPECT_FALSE(scene.animate(framesFrom(10, 12))); });

    EXPECT_THAT(printed, StartsWith("Error opening file for write: "));
}

TEST(MaxPointCache, IsWrittenByFrameNumbersFromItsStartFrameOn) {
    CacheScene scene(/*isMaya*/ false);
    ASSERT_TRUE(scene.map());

    EXPECT_TRUE(scene.animate(framesFrom(10, 12))) << lastError();

    ASSERT_TRUE(scene.cache().OpenFileForRead());
    EXPECT_EQ(scene.cache().GetFrameStartOffset(), 10.0);
    EXPECT_EQ(scene.cache().GetSampleCount(), 3u);
    EXPECT_EQ(scene.cache().GetPointCount(), 3u);
    EXPECT_EQ(scene.setAt(10), 0.0);
    EXPECT_EQ(scene.setAt(12), 2.0);
    EXPECT_TRUE(scene.cache().CloseFile());
    EXPECT_THAT(filesIn(scene.folder.file("out/shot_fpc")), ElementsAre("ball.pc2"));
}

TEST(MayaPointCache, HasOneSampleForEveryFrameOfTheRange) {
    CacheScene scene;
    ASSERT_TRUE(scene.map());

    EXPECT_TRUE(scene.animate(framesFrom(10, 12))) << lastError();

    const std::string data = scene.folder.read("out/shot_fpc/ball.mcx");
    int samples = 0;
    for (std::size_t at = data.find("MYCH"); at != std::string::npos; at = data.find("MYCH", at + 1))
        ++samples;
    EXPECT_EQ(samples, 3);
}

TEST(MayaPointCache, IsNarrowOrWide) {
    for (const bool wide : {true, false}) {
        CacheScene scene;
        ASSERT_TRUE(scene.map());

        EXPECT_TRUE(scene.animate(framesFrom(10, 12), wide)) << lastError();

        EXPECT_THAT(filesIn(scene.folder.file("out/shot_fpc")), ElementsAre(wide ? "ball.mcx" : "ball.mc", "ball.xml"));
        EXPECT_THAT(scene.folder.read("out/shot_fpc/ball.xml"), HasSubstr(wide ? "Format=\"mcx\"" : "Format=\"mcc\""));
    }
}

TEST(MayaPointCache, HasOneChannelOfPointsNamedAfterTheNode) {
    CacheScene scene;
    ASSERT_TRUE(scene.map());
    EXPECT_TRUE(scene.animate(framesFrom(10, 12))) << lastError();

    ASSERT_TRUE(scene.cache().OpenFileForRead());
    EXPECT_EQ(scene.cache().GetChannelCount(), 1);
    EXPECT_EQ(scene.cache().GetChannelIndex("ball"), 0);
    FbxCache::EMCDataType type = FbxCache::eUnknownData;
    EXPECT_TRUE(scene.cache().GetChannelDataType(0, type));
    EXPECT_EQ(type, FbxCache::eDoubleVectorArray);
    EXPECT_EQ(scene.cache().GetSamplingFrameRate(), 24.0);
    fbxsdk::FbxTime start, end;
    EXPECT_TRUE(scene.cache().GetAnimationRange(0, start, end));
    EXPECT_DOUBLE_EQ(start.GetSecondDouble(), 10.0 / 24.0);
    EXPECT_DOUBLE_EQ(end.GetSecondDouble(), 0.5);
    EXPECT_TRUE(scene.cache().CloseFile());
    EXPECT_THAT(scene.folder.read("out/shot_fpc/ball.xml"), HasSubstr("\"Points\""));
}

TEST(MayaPointCache, CannotBeOpenedForAnInvalidRate) {
    for (const float rate : {0.0f, -24.0f, std::numeric_limits<float>::quiet_NaN()}) {
        CacheScene scene;
        ASSERT_TRUE(scene.map());

        const std::string printed = printedBy([&] { EXPECT_FALSE(scene.animate(framesFrom(10, 12, rate))); });

        EXPECT_THAT(printed, StartsWith("Error opening file for write: "));
    }
}

// ---- As part of a scene ----

TnFbxWriteInfo animatedInfo(const TemporaryFolder& folder, float start, float end) {
    TnFbxWriteInfo info;
    info.setFileName(folder.file("out/shot.fbx"));
    info.setAnimationStackName("Take 001");
    info.setStartFrame(start);
    info.setEndFrame(end);
    return info;
}

TEST(PointCachesOfAScene, AreOnePerMeshInOneFolder) {
    TemporaryFolder folder;
    WrittenScene scene;
    const auto first = movingMesh("first", 3), second = movingMesh("second", 3);
    WrittenObjects objects;
    objects.meshes = {first.get(), second.get()};

    EXPECT_TRUE(scene.create(objects, animatedInfo(folder, 10.0f, 12.0f)));

    EXPECT_THAT(filesIn(folder.file("out")), ElementsAre("shot_fpc"));
    EXPECT_THAT(filesIn(folder.file("out/shot_fpc")),
                ElementsAre("first.mcx", "first.xml", "second.mcx", "second.xml"));
    EXPECT_EQ(scene.child()->GetGeometry()->GetDeformerCount(fbxsdk::FbxDeformer::eVertexCache), 1);
}

TEST(PointCachesOfAScene, AreNamedInTheFileByAPathFromItsFolder) {
    for (const bool maya : {true, false}) {
        TemporaryFolder folder;
        const auto mesh = movingMesh("ball", 3);
        TnFbxWriteInfo info = animatedInfo(folder, 10.0f, 12.0f);
        info.setMayaVertexCacheFormat(maya);
        info.setFileFormat(true);

        EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {}, {mesh.get()})) << lastError();

        const std::string relative = std::string("shot_fpc/ball") + (maya ? ".xml" : ".pc2");
        EXPECT_THAT(folder.read("out/shot.fbx"),
                    HasSubstr("P: \"CacheFileName\", \"KString\", \"\", \"\", \"" + relative + "\""));
    }
}

TEST(PointCachesOfAScene, TruncateTheRangeTowardZero) {
    TemporaryFolder folder;
    WrittenScene scene;
    const auto mesh = movingMesh("mesh", 4);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};

    EXPECT_TRUE(scene.create(objects, animatedInfo(folder, -1.9f, 2.9f))); // frames -1 to 2

    EXPECT_THAT(filesIn(folder.file("out/shot_fpc")), ElementsAre("mesh.mcx", "mesh.xml"));
}

TEST(PointCachesOfAScene, AreWideOnlyForExactlyTheNewestVersion) {
    for (const int version : {-1, 0, 1, 2, 3, 4, 5, 6, 17}) {
        TemporaryFolder folder;
        WrittenScene scene;
        const auto mesh = movingMesh("mesh", 3);
        WrittenObjects objects;
        objects.meshes = {mesh.get()};
        TnFbxWriteInfo info = animatedInfo(folder, 10.0f, 12.0f);
        info.setCompatibilityVersion(static_cast<TnFbxWriteInfo::eCompatibilityVersion>(version));

        EXPECT_TRUE(scene.create(objects, info));

        EXPECT_THAT(filesIn(folder.file("out/shot_fpc")),
                    ElementsAre(version == 5 ? "mesh.mcx" : "mesh.mc", "mesh.xml"))
            << version;
    }
}

TEST(PointCachesOfAScene, AreOfTheRequestedFormat) {
    TemporaryFolder folder;
    WrittenScene scene;
    const auto mesh = movingMesh("mesh", 3);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};
    TnFbxWriteInfo info = animatedInfo(folder, 10.0f, 12.0f);
    info.setMayaVertexCacheFormat(false);

    EXPECT_TRUE(scene.create(objects, info));

    EXPECT_THAT(filesIn(folder.file("out/shot_fpc")), ElementsAre("mesh.pc2"));
}

TEST(PointCachesOfAScene, AreNotCreatedWhenNotRequested) {
    TemporaryFolder folder;
    WrittenScene scene;
    const auto mesh = movingMesh("mesh", 3);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};
    TnFbxWriteInfo info = animatedInfo(folder, 10.0f, 12.0f);
    info.setAnimateMeshVertices(false);

    EXPECT_TRUE(scene.create(objects, info));

    EXPECT_FALSE(fs::exists(folder.file("out")));
    EXPECT_EQ(scene.child()->GetGeometry()->GetDeformerCount(), 0);
}

TEST(PointCachesOfAScene, LeaveTheMeshInItWhenTheyCannotBeAttached) {
    TemporaryFolder folder;
    folder.write("out", "a file, not a folder");
    WrittenScene scene;
    const auto mesh = movingMesh("mesh", 3);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};

    EXPECT_TRUE(scene.create(objects, animatedInfo(folder, 10.0f, 12.0f)));

    ASSERT_THAT(scene.childNames(), ElementsAre("mesh"));
    EXPECT_EQ(scene.child()->GetGeometry()->GetDeformerCount(), 0);
}

TEST(PointCachesOfAScene, LeaveADeformerWithoutAFileWhenTheSetsDoNotMatch) {
    TemporaryFolder folder;
    WrittenScene scene;
    const auto mesh = movingMesh("mesh", 2);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};

    EXPECT_TRUE(scene.create(objects, animatedInfo(folder, 10.0f, 12.0f)));

    ASSERT_THAT(scene.childNames(), ElementsAre("mesh"));
    EXPECT_EQ(scene.child()->GetGeometry()->GetDeformerCount(fbxsdk::FbxDeformer::eVertexCache), 1);
    EXPECT_THAT(filesIn(folder.file("out/shot_fpc")), IsEmpty());
}

TEST(PointCachesOfAScene, OverwriteEachOtherForMeshesOfOneName) {
    TemporaryFolder folder;
    WrittenScene scene;
    const auto first = movingMesh("mesh", 3), second = movingMesh("mesh", 3);
    WrittenObjects objects;
    objects.meshes = {first.get(), second.get()};

    EXPECT_TRUE(scene.create(objects, animatedInfo(folder, 10.0f, 12.0f)));

    EXPECT_THAT(scene.childNames(), ElementsAre("mesh", "mesh"));
    EXPECT_THAT(filesIn(folder.file("out/shot_fpc")), ElementsAre("mesh.mcx", "mesh.xml"));
}

TEST(PointCachesOfAScene, StayWhenTheSceneCannotBeSaved) {
    TemporaryFolder folder;
    fs::create_directories(folder.file("out/shot.fbx")); // a folder with the name of the file
    WrittenScene scene;
    const auto mesh = movingMesh("mesh", 3);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};
    const TnFbxWriteInfo info = animatedInfo(folder, 10.0f, 12.0f);
    ASSERT_TRUE(scene.create(objects, info));

    EXPECT_FALSE(scene.sdk.saveScene(info));

    EXPECT_THAT(filesIn(folder.file("out/shot_fpc")), ElementsAre("mesh.mcx", "mesh.xml"));
}

TEST(PointCachesOfAScene, AreWrittenWithTheSceneWhenTheyAreToAppearWithIt) {
    TemporaryFolder folder;
    WrittenScene scene;
    scene.sdk.letPointCachesAppearWithScene();
    const auto mesh = movingMesh("mesh", 3);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};
    const TnFbxWriteInfo info = animatedInfo(folder, 10.0f, 12.0f);
    ASSERT_TRUE(scene.create(objects, info));
    EXPECT_FALSE(fs::exists(folder.file("out/shot_fpc/mesh.xml")));

    EXPECT_TRUE(scene.sdk.saveScene(info)) << lastError();

    EXPECT_THAT(filesIn(folder.file("out/shot_fpc")), ElementsAre("mesh.mcx", "mesh.xml"));
}

TEST(PointCachesOfAScene, SurviveAnInvalidRange) {
    const float kNaN = std::numeric_limits<float>::quiet_NaN();
    const std::pair<float, float> ranges[] = {{kNaN, kNaN}, {-1e30f, 1e30f}, {1e30f, -1e30f}, {1e30f, 1e30f}};
    for (const auto& [start, end] : ranges) {
        TemporaryFolder folder;
        WrittenScene scene;
        const auto mesh = movingMesh("mesh", 3);
        WrittenObjects objects;
        objects.meshes = {mesh.get()};

        EXPECT_TRUE(scene.create(objects, animatedInfo(folder, start, end)));
        EXPECT_THAT(filesIn(folder.file("out/shot_fpc")), IsEmpty());
    }
}

} // namespace
} // namespace Tarnell::Fbx
