// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Point caches: they replace the points of a frame, or leave them to shapes and skins; and the time that they span.
#include "DeformationScenes.h"
#include "support/TemporaryFolder.h"

#include "TnFbxError.h"

#include <string>

namespace Tarnell::Fbx {
namespace {

using namespace test;

using fbxsdk::FbxCache;

/// A mesh of two points with a cache file next to it that moves them along Z by the frame number.
struct CacheScene : TestScene {
    explicit CacheScene(FbxCache::EFileFormat format, bool active = true) : TestScene(0, 10) {
        scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames24);
        fbxsdk::FbxTime::SetGlobalTimeMode(fbxsdk::FbxTime::eFrames24);
        node = addPoints(*this, 2);
        deformer = fbxsdk::FbxVertexCacheDeformer::Create(scene, "deformer");
        cache = FbxCache::Create(scene, "cache");
        const bool maya = format == FbxCache::eMayaCache;
        const std::string file = folder.file(maya ? "points.xml" : "points.pc2");
        cache->SetCacheFileFormat(format);
        cache->SetCacheFileName("", file.c_str());
        deformer->SetCache(cache);
        deformer->Channel.Set(fbxsdk::FbxString("ball"));
        deformer->Active.Set(active);
        node->GetMesh()->AddDeformer(deformer);
        maya ? writeMaya() : writeMax();
    }

    void writeMaya() {
        ASSERT_TRUE(cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, "ball", FbxCache::eMCC));
        for (int frame = 1; frame <= 3; ++frame) {
            std::vector<double> buffer = pointsAt(frame);
            fbxsdk::FbxTime time = test::timeOfFrame(frame);
            cache->BeginWriteAt(time);
            ASSERT_TRUE(cache->Write(0, time, buffer.data(), 2));
            cache->EndWriteAt();
        }
        ASSERT_TRUE(cache->CloseFile());
    }

    void writeMax() {
        ASSERT_TRUE(cache->OpenFileForWrite(1.0, 24.0, 3u, 2u));
        for (unsigned int frame = 1; frame <= 3; ++frame) {
            std::vector<double> buffer = pointsAt(static_cast<int>(frame));
            ASSERT_TRUE(cache->Write(frame, buffer.data()));
        }
        ASSERT_TRUE(cache->CloseFile());
    }

    static std::vector<double> pointsAt(int frame) {
        const auto z = static_cast<double>(frame);
        return {10.0, 0.0, z, 20.0, 0.0, z};
    }

    support::TemporaryFolder folder;
    fbxsdk::FbxNode* node;
    fbxsdk::FbxVertexCacheDeformer* deformer;
    FbxCache* cache;
};

class VertexCache : public testing::TestWithParam<FbxCache::EFileFormat> {};
INSTANTIATE_TEST_SUITE_P(BothFormats, VertexCache, testing::Values(FbxCache::eMayaCache, FbxCache::eMaxPointCacheV2));

TEST_P(VertexCache, GivesThePointsOfTheFrameWhateverRateThisThreadCountsAt) {
    CacheScene scene(GetParam());
    ASSERT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));
    fbxsdk::FbxTime::SetGlobalTimeMode(fbxsdk::FbxTime::eFrames60);

    const Points points = deformed(scene, scene.node, 2);

    EXPECT_EQ(points[0][2], 2.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

TEST_P(VertexCache, GivesThePointsOfTheFrame) {
    CacheScene scene(GetParam());
    EXPECT_TRUE(scene.sdk.getDeformation(scene.node->GetMesh()));
    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));
    EXPECT_TRUE(scene.cache->IsOpen());

    const Points points = deformed(scene, scene.node, 2);

    expectPoint(points[0], 10.0, 0.0, 2.0);
    expectPoint(points[1], 20.0, 0.0, 2.0);
    EXPECT_EQ(points[0][3], 1.0);
    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, false));
    EXPECT_FALSE(scene.cache->IsOpen());
}

TEST_P(VertexCache, IsReadThroughTheListOfMeshes) {
    CacheScene scene(GetParam());
    TnFbxReadInfo info = test::readAll();
    info.setTransformPoints(false);
    info.setFrame(3.0f);
    TnFbxMesh mesh;

    EXPECT_TRUE(scene.sdk.getMeshes(info, &mesh, 1));

    float x = 0.0f, y = 0.0f, z = 0.0f;
    EXPECT_TRUE(mesh.getControlPoint(1, x, y, z));
    EXPECT_EQ(x, 20.0f);
    EXPECT_EQ(z, 3.0f);
    EXPECT_FALSE(scene.cache->IsOpen());
}

TEST_P(VertexCache, ThatGivesNoPointsLeavesThePolygonsOfItsMesh) {
    CacheScene scene(GetParam());
    const char* data = GetParam() == FbxCache::eMayaCache ? "points.mc" : "points.pc2";
    const std::string whole = scene.folder.read(data);
    scene.folder.write(data, whole.substr(0, whole.size() - 1));
    TnFbxReadInfo info = test::readAll();
    info.setTransformPoints(false);
    info.setFrame(3.0f);
    TnFbxMesh mesh;

    EXPECT_TRUE(scene.sdk.getMeshes(info, &mesh, 1));

    const fbxsdk::FbxMesh& source = *scene.node->GetMesh();
    ASSERT_GT(source.GetPolygonCount(), 0);
    EXPECT_EQ(mesh.getNumberOfPolygons(), source.GetPolygonCount());
    EXPECT_EQ(mesh.getNumberOfPolygonVertices(), source.GetPolygonVertexCount());
    EXPECT_EQ(mesh.getPolygonVertexSize(0), source.GetPolygonSize(0));
    float x = 0.0f, y = 0.0f, z = -1.0f;
    EXPECT_TRUE(mesh.getControlPoint(1, x, y, z));
    EXPECT_EQ(z, 0.0f) << "not moved by the cache";
}

/// Moves every point by 100 along Y: half of the difference to a target, in percent.
void addShape(TestScene& scene, fbxsdk::FbxNode& node) {
    fbxsdk::FbxGeometry& mesh = *node.GetGeometry();
    auto* deformer = fbxsdk::FbxBlendShape::Create(scene.scene, "shapes");
    auto* channel = fbxsdk::FbxBlendShapeChannel::Create(scene.scene, "channel");
    auto* target = fbxsdk::FbxShape::Create(scene.scene, "target");
    target->InitControlPoints(mesh.GetControlPointsCount());
    for (int i = 0; i < mesh.GetControlPointsCount(); ++i)
        target->SetControlPointAt(mesh.GetControlPointAt(i) + FbxVector4(0.0, 2.0, 0.0), i);
    mesh.AddDeformer(deformer);
    deformer->AddBlendShapeChannel(channel);
    channel->AddTargetShape(target, 100.0);
    scene.key(channel->DeformPercent, nullptr, {{0, 50.0f}});
}

TEST_P(VertexCache, ReplacesShapesAndSkin) {
    CacheScene scene(GetParam());
    addShape(scene, *scene.node);
    addCluster(scene, addSkin(scene, scene.node), {0.0, 100.0, 0.0})->AddControlPointIndex(0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, true);

    expectPoint(deformed(scene, scene.node, 1)[0], 10.0, 0.0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

/// The warnings of a read of the mesh.
std::vector<std::string> warningsOf(CacheScene& scene) {
    TnFbxReadInfo info = test::readAll();
    info.setTransformPoints(false);
    info.setFrame(2.0f);
    TnFbxMesh mesh;
    EXPECT_TRUE(scene.sdk.getMeshes(info, &mesh, 1));
    return lastWarnings();
}

TEST_P(VertexCache, ThatFitsItsMeshIsNoWarning) {
    CacheScene scene(GetParam());
    EXPECT_EQ(warningsOf(scene), std::vector<std::string>());
}

TEST_P(VertexCache, OfAnotherNumberOfPointsIsAWarning) {
    CacheScene scene(GetParam());
    scene.node->GetMesh()->InitControlPoints(3);

    const std::vector<std::string> warnings = warningsOf(scene);

    ASSERT_EQ(warnings.size(), 1U);
    EXPECT_EQ(warnings[0].find("\"mesh\" is read without its point cache: "), 0U) << warnings[0];
}

TEST_P(VertexCache, ThatIsSwitchedOffIsAWarning) {
    CacheScene scene(GetParam(), /*active*/ false);
    EXPECT_EQ(warningsOf(scene),
              std::vector<std::string>{"\"mesh\" is read without its point cache: it is switched off"});
}

TEST_P(VertexCache, ThatTheDeformerLacksIsAWarning) {
    CacheScene scene(GetParam());
    scene.deformer->SetCache(nullptr);
    EXPECT_EQ(warningsOf(scene),
              std::vector<std::string>{"\"mesh\" is read without its point cache: the file does not specify a cache"});
}

TEST(MayaVertexCache, WithoutTheChannelOfItsDeformerIsAWarning) {
    CacheScene scene(FbxCache::eMayaCache);
    scene.deformer->Channel.Set(fbxsdk::FbxString("another"));

    EXPECT_EQ(warningsOf(scene),
              std::vector<std::string>{"\"mesh\" is read without its point cache: it has no channel \"another\""});
}

TEST_P(VertexCache, SwitchedOffLeavesTheSkin) {
    CacheScene scene(GetParam(), /*active*/ false);
    EXPECT_FALSE(scene.sdk.getDeformation(scene.node->GetMesh()));
    addCluster(scene, addSkin(scene, scene.node), {0.0, 100.0, 0.0})->AddControlPointIndex(0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, true);

    EXPECT_FALSE(scene.cache->IsOpen());
    expectPoint(deformed(scene, scene.node, 1)[0], 0.0, 100.0, 0.0);
}

TEST_P(VertexCache, ThatDoesNotOpenIsSwitchedOff) {
    CacheScene scene(GetParam());
    scene.cache->SetCacheFileName("", "there is no such file");
    addCluster(scene, addSkin(scene, scene.node), {0.0, 100.0, 0.0})->AddControlPointIndex(0, 1.0);

    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));

    EXPECT_FALSE(scene.deformer->Active.Get());
    expectPoint(deformed(scene, scene.node, 1)[0], 0.0, 100.0, 0.0);
}

TEST_P(VertexCache, ThatDoesNotOpenLeavesShapesAndSkin) {
    CacheScene scene(GetParam());
    scene.cache->SetCacheFileName("", "there is no such file");
    addShape(scene, *scene.node);
    addCluster(scene, addSkin(scene, scene.node), {5.0, 0.0, 0.0})->AddControlPointIndex(0, 1.0);
    scene.sdk.openClosePointCacheData(scene.scene, true);

    const Points points = deformed(scene, scene.node, 1);

    expectPoint(points[0], 5.0, 100.0, 0.0);
    expectPoint(points[1], 1.0, 100.0, 0.0);
}

TEST_P(VertexCache, ThatIsTruncatedLeavesThePointsUnchanged) {
    CacheScene scene(GetParam());
    const char* data = GetParam() == FbxCache::eMayaCache ? "points.mc" : "points.pc2";
    const std::string whole = scene.folder.read(data);
    ASSERT_FALSE(whole.empty());
    scene.folder.write(data, whole.substr(0, whole.size() - 1));

    scene.sdk.openClosePointCacheData(scene.scene, true);

    expectPoint(deformed(scene, scene.node, 1)[1], 1.0, 0.0, 0.0);
}

TEST_P(VertexCache, OfAnInstanceStaysOpenForBothNodes) {
    CacheScene scene(GetParam());
    scene.addNode("instance")->SetNodeAttribute(scene.node->GetMesh());

    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));

    EXPECT_TRUE(scene.deformer->Active.Get());
    EXPECT_TRUE(scene.cache->IsOpen());
    scene.sdk.openClosePointCacheData(scene.scene, false);
    EXPECT_FALSE(scene.cache->IsOpen());
}

TEST_P(VertexCache, ThatIsNotOpenLeavesThePointsAlone) {
    CacheScene scene(GetParam());

    expectPoint(deformed(scene, scene.node, 1)[1], 1.0, 0.0, 0.0);
}

TEST_P(VertexCache, WithAnotherNumberOfPointsLeavesThePointsAlone) {
    CacheScene scene(GetParam());
    test::fillMesh(*scene.node->GetMesh(), {{7.0, 0.0, 0.0}, {8.0, 0.0, 0.0}, {9.0, 0.0, 0.0}}, {});
    scene.sdk.openClosePointCacheData(scene.scene, true);

    expectPoint(deformed(scene, scene.node, 1)[2], 9.0, 0.0, 0.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

TEST(MayaCache, WithoutTheChannelLeavesThePointsAlone) {
    CacheScene scene(FbxCache::eMayaCache);
    scene.deformer->Channel.Set(fbxsdk::FbxString("another"));
    scene.sdk.openClosePointCacheData(scene.scene, true);

    expectPoint(deformed(scene, scene.node, 1)[1], 1.0, 0.0, 0.0);
    scene.sdk.openClosePointCacheData(scene.scene, false);
}

TEST(MayaCache, ExtendsTheTimeOfAStillScene) {
    CacheScene scene(FbxCache::eMayaCache);
    float start = 0.0f, end = 0.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_FLOAT_EQ(start, 1.0f / 24.0f);
    EXPECT_FLOAT_EQ(end, 3.0f / 24.0f);
    EXPECT_FALSE(scene.cache->IsOpen());
}

TEST(MayaCache, DoesNotWidenTheTimeOfKeys) {
    CacheScene scene(FbxCache::eMayaCache);
    scene.key(scene.node->LclTranslation, "X", {{0, 0.0f}, {1, 1.0f}});
    float start = 9.0f, end = 9.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, 0.0f);
    EXPECT_FLOAT_EQ(end, 1.0f / 24.0f);
}

TEST(MaxCache, SaysNothingAboutTheTimeOfAScene) {
    CacheScene scene(FbxCache::eMaxPointCacheV2);
    float start = 0.0f, end = 0.0f;

    EXPECT_FALSE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, std::numeric_limits<float>::max());
}

TEST(PointCaches, CannotBeOpenedWithoutAScene) {
    FbxSdk sdk;

    EXPECT_FALSE(sdk.openClosePointCacheData(nullptr, true));
    EXPECT_FALSE(sdk.openClosePointCacheData(nullptr, false));
}

TEST(PointCaches, OfADeformerWithoutACacheAreNone) {
    TestScene scene;
    fbxsdk::FbxNode* node = addPoints(scene, 2);
    auto* deformer = fbxsdk::FbxVertexCacheDeformer::Create(scene.scene, "deformer");
    deformer->Active.Set(true);
    node->GetMesh()->AddDeformer(deformer);

    EXPECT_TRUE(scene.sdk.openClosePointCacheData(scene.scene, true));
    EXPECT_TRUE(deformer->Active.Get());
    EXPECT_TRUE(scene.sdk.getDeformation(node->GetMesh()));
    expectPoint(deformed(scene, node, 1)[1], 1.0, 0.0, 0.0);
}

} // namespace
} // namespace Tarnell::Fbx
