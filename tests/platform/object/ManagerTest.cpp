// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Managers: they own everything, share nothing, and can be destroyed in any state.
#include <string>
#include <vector>

#include <fbxsdk.h>
#include <gtest/gtest.h>

namespace {

using namespace fbxsdk;

TEST(FbxManagerTest, GivesWhatItHas) {
    FbxManager* manager = FbxManager::Create();

    ASSERT_NE(manager, nullptr);
    EXPECT_NE(manager->GetIOPluginRegistry(), nullptr);
    EXPECT_EQ(manager->GetIOSettings(), nullptr);
    EXPECT_STRNE(FbxManager::GetVersion(), "");
    manager->Destroy();
}

TEST(FbxManagerTest, KeepsTheSettingsItIsGivenUntilTheyAreDestroyed) {
    FbxManager* manager = FbxManager::Create();
    FbxIOSettings* settings = FbxIOSettings::Create(manager, IOSROOT);
    manager->SetIOSettings(settings);
    EXPECT_EQ(manager->GetIOSettings(), settings);

    settings->Destroy();

    EXPECT_EQ(manager->GetIOSettings(), nullptr);
    manager->Destroy();
}

TEST(FbxManagerTest, LivesBesideOthers) {
    FbxManager* first = FbxManager::Create();
    FbxManager* second = FbxManager::Create();
    FbxScene* scene = FbxScene::Create(second, "second");

    EXPECT_NE(first->GetIOPluginRegistry(), second->GetIOPluginRegistry());
    FbxScene::Create(first, "first");
    first->Destroy();

    EXPECT_STREQ(scene->GetName(), "second");
    EXPECT_EQ(scene->GetNodeCount(), 1);
    second->Destroy();
}

TEST(FbxManagerTest, DestroysObjectsInEveryState) {
    FbxManager* manager = FbxManager::Create();
    FbxScene* scene = FbxScene::Create(manager, "scene");
    FbxScene* other = FbxScene::Create(manager, "other");
    FbxImporter::Create(manager, "")->Initialize("/nowhere/at/all.fbx");
    FbxExporter::Create(manager, "");
    FbxNode* loose = FbxNode::Create(manager, "loose");
    FbxNode* node = FbxNode::Create(scene, "node");
    node->LclTranslation.ConnectSrcProperty(loose->LclTranslation);
    other->ConnectSrcObject(node);
    scene->GlobalCameraSettings().CreateProducerCameras();
    FbxAnimStack* stack = FbxAnimStack::Create(scene, "");
    scene->SetCurrentAnimationStack(stack);
    node->EvaluateGlobalTransform(FbxTime(1));
    FbxObject* a = FbxObject::Create(manager, "a");
    FbxObject* b = FbxObject::Create(manager, "b");
    a->ConnectSrcObject(b);
    b->ConnectSrcObject(a);

    manager->Destroy();

    SUCCEED(); // a sanitizer would report it
}

TEST(FbxManagerTest, DestroysTenThousandConnectedObjects) {
    FbxManager* manager = FbxManager::Create();
    FbxScene* scene = FbxScene::Create(manager, "scene");
    FbxNode* parent = scene->GetRootNode();
    std::vector<FbxNode*> nodes;
    for (int i = 0; i < 10'000; ++i) {
        FbxNode* node = FbxNode::Create(i % 2 ? manager : scene->GetFbxManager(), std::to_string(i).c_str());
        parent->AddChild(node);
        if (i % 3 == 0)
            parent = node;
        if (i > 0)
            node->LclScaling.ConnectSrcProperty(nodes[static_cast<std::size_t>(i) / 2]->LclTranslation);
        nodes.push_back(node);
    }
    EXPECT_EQ(scene->GetNodeCount(), 10'001);
    nodes.back()->EvaluateGlobalTransform();

    manager->Destroy();
}

TEST(FbxManagerTest, OutlivesAThousandScenesMadeAndDestroyed) {
    FbxManager* manager = FbxManager::Create();
    for (int i = 0; i < 1000; ++i) {
        FbxScene* scene = FbxScene::Create(manager, "scene");
        FbxNode* node = FbxNode::Create(scene, "node");
        scene->GetRootNode()->AddChild(node);
        node->EvaluateGlobalTransform();
        scene->Destroy(i % 2 == 0);
    }
    FbxNode* survivor = FbxNode::Create(manager, "survivor");

    EXPECT_STREQ(survivor->GetName(), "survivor");
    manager->Destroy();
}

} // namespace
