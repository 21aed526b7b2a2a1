// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The time that a scene's animation covers: that of its keys, or that of all its Maya caches together.
#include "support/SceneBuilders.h"
#include "support/TemporaryFolder.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

namespace Tarnell::Fbx {
namespace {

using fbxsdk::FbxCache;
using test::TestScene;

/// A triangle with a Maya cache that has samples from one frame to another.
fbxsdk::FbxNode* addCached(TestScene& scene, const support::TemporaryFolder& folder, const char* name, int firstFrame,
                           int lastFrame, fbxsdk::FbxNode* parent = nullptr) {
    fbxsdk::FbxNode* node = addTriangle(scene, name);
    if (parent != nullptr)
        parent->AddChild(node);
    FbxCache* cache = FbxCache::Create(scene.scene, name);
    cache->SetCacheFileFormat(FbxCache::eMayaCache);
    cache->SetCacheFileName("", folder.file(std::string(name) + ".xml").c_str());
    EXPECT_TRUE(cache->OpenFileForWrite(FbxCache::eMCOneFile, 24.0, name, FbxCache::eMCC));
    for (int frame = firstFrame; frame <= lastFrame; ++frame) {
        double points[9] = {};
        fbxsdk::FbxTime time = test::timeOfFrame(frame);
        EXPECT_TRUE(cache->BeginWriteAt(time));
        EXPECT_TRUE(cache->Write(0, time, points, 3));
        EXPECT_TRUE(cache->EndWriteAt());
    }
    EXPECT_TRUE(cache->CloseFile());

    auto* deformer = fbxsdk::FbxVertexCacheDeformer::Create(scene.scene, name);
    deformer->SetCache(cache);
    deformer->Channel.Set(fbxsdk::FbxString(name));
    deformer->Active.Set(true);
    node->GetMesh()->AddDeformer(deformer);
    return node;
}

FbxCache* cacheOf(fbxsdk::FbxNode& node) {
    fbxsdk::FbxDeformer* deformer = node.GetMesh()->GetDeformer(0, fbxsdk::FbxDeformer::eVertexCache);
    return fbxsdk::FbxCast<fbxsdk::FbxVertexCacheDeformer>(deformer)->GetCache();
}

TEST(AnimationFrameRange, IsInSeconds) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.addNode("node");
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {48, 1.0f}});
    float start = -1.0f, end = -1.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, 0.0f);
    EXPECT_EQ(end, 2.0f);
}

TEST(AnimationFrameRange, IsThatOfTheKeysNotOfTheStack) {
    TestScene scene(0, 240);
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    scene.key(parent->LclTranslation, "X", {{12, 0.0f}, {24, 1.0f}});
    scene.key(scene.addNode("child", parent)->LclScaling, "Z", {{36, 0.0f}, {60, 1.0f}});
    float start = -1.0f, end = -1.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, 0.5f);
    EXPECT_EQ(end, 2.5f);
}

TEST(AnimationFrameRange, OfAStillSceneIsTheInvertedRangeOfAllFloats) {
    TestScene scene;
    scene.add<fbxsdk::FbxCamera>("camera", addTriangle(scene, "mesh"));
    float start = 0.0f, end = 0.0f;

    EXPECT_FALSE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, std::numeric_limits<float>::max());
    EXPECT_EQ(end, -std::numeric_limits<float>::max());
    EXPECT_FALSE(lastError().empty());
}

TEST(AnimationFrameRange, LeavesTheOutputsAloneWithoutARoot) {
    FbxSdk sdk;
    float start = 3.0f, end = 4.0f;

    EXPECT_FALSE(sdk.getAnimationFrameRange(start, end));

    EXPECT_EQ(start, 3.0f);
    EXPECT_EQ(end, 4.0f);
}

TEST(AnimationFrameRange, FindsNoCachesBelowANullNodeOrAStillMesh) {
    TestScene scene;
    float start = 3.0f, end = 4.0f;

    EXPECT_FALSE(scene.sdk.getAnimationFrameRangeRecursive(nullptr, start, end));
    EXPECT_FALSE(scene.sdk.getAnimationFrameRangeRecursive(addTriangle(scene, "mesh"), start, end));

    EXPECT_EQ(start, 3.0f);
    EXPECT_EQ(end, 4.0f);
}

TEST(AnimationFrameRange, IsThatOfAllMayaCachesTogetherHoweverDeepTheyAre) {
    const support::TemporaryFolder folder;
    TestScene scene;
    fbxsdk::FbxNode* top = addCached(scene, folder, "first", 2, 3);
    fbxsdk::FbxNode* middle = addCached(scene, folder, "widest", 1, 8, scene.addNode("between", top));
    addCached(scene, folder, "last", 4, 5, middle);
    float start = 0.0f, end = 0.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_FLOAT_EQ(start, 1.0f / 24.0f);
    EXPECT_FLOAT_EQ(end, 8.0f / 24.0f);
}

TEST(AnimationFrameRange, TakesTheStartFromOneMayaCacheAndTheEndFromAnother) {
    const support::TemporaryFolder folder;
    TestScene scene;
    addCached(scene, folder, "late", 2, 8);
    addCached(scene, folder, "early", 1, 3, scene.addNode("parent"));
    float start = 0.0f, end = 0.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRange(start, end));

    EXPECT_FLOAT_EQ(start, 1.0f / 24.0f);
    EXPECT_FLOAT_EQ(end, 8.0f / 24.0f);
}

TEST(AnimationFrameRange, KeepsWhatWasFoundBeforeAMayaCacheThatIsNotOpen) {
    const support::TemporaryFolder folder;
    TestScene scene;
    FbxCache* cache = cacheOf(*addCached(scene, folder, "open", 2, 3));
    addCached(scene, folder, "closed", 1, 8);
    ASSERT_TRUE(cache->OpenFileForRead());
    float start = 1.0f, end = 0.0f;

    EXPECT_TRUE(scene.sdk.getAnimationFrameRangeRecursive(scene.scene->GetRootNode(), start, end));

    EXPECT_FLOAT_EQ(start, 2.0f / 24.0f);
    EXPECT_FLOAT_EQ(end, 3.0f / 24.0f);
    EXPECT_TRUE(cache->CloseFile());
}

} // namespace
} // namespace Tarnell::Fbx
