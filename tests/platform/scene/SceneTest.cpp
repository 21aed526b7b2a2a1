// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Scenes: their initial content, the list of nodes, the current stack, and their destruction.
#include <string>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCache.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxSurfaceMaterial.h>
#include <fbxsdk/FbxVertexCacheDeformer.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

using FbxSceneTest = SceneFixture;

TEST_F(FbxSceneTest, HasARootAndSettingsFromTheStart) {
    ASSERT_NE(scene->GetRootNode(), nullptr);
    EXPECT_STREQ(scene->GetRootNode()->GetName(), "RootNode");
    EXPECT_EQ(scene->GetRootNode()->GetNodeAttribute(), nullptr);
    EXPECT_EQ(scene->GetRootNode()->GetScene(), scene);
    EXPECT_EQ(&scene->GetGlobalSettings(), &static_cast<const FbxScene*>(scene)->GetGlobalSettings());
    EXPECT_EQ(scene->GetGlobalSettings().GetScene(), scene);
    EXPECT_EQ(scene->GetCurrentAnimationStack(), nullptr);
    EXPECT_STREQ(scene->ActiveAnimStackName.Get().Buffer(), "");
    EXPECT_EQ(scene->GetScene(), scene);
}

TEST_F(FbxSceneTest, ListsItsNodesInOrderOfEntryTheRootFirst) {
    FbxNode* loose = make<FbxNode>("hangs nowhere");
    FbxNode* child = FbxNode::Create(manager, "child");
    EXPECT_EQ(scene->GetNodeCount(), 2);
    scene->GetRootNode()->AddChild(child);

    ASSERT_EQ(scene->GetNodeCount(), 3);
    EXPECT_EQ(scene->GetNode(0), scene->GetRootNode());
    EXPECT_EQ(scene->GetNode(1), loose);
    EXPECT_EQ(scene->GetNode(2), child);
    EXPECT_EQ(scene->GetNode(3), nullptr);
    EXPECT_EQ(scene->GetNode(-1), nullptr);
}

TEST_F(FbxSceneTest, TakesInAllThatANodeBrings) {
    FbxNode* node = FbxNode::Create(manager, "node");
    FbxMesh* mesh = FbxMesh::Create(manager, "mesh");
    FbxVertexCacheDeformer* deformer = FbxVertexCacheDeformer::Create(manager, "deformer");
    FbxCache* cache = FbxCache::Create(manager, "cache");
    FbxSurfacePhong* material = FbxSurfacePhong::Create(manager, "material");
    node->SetNodeAttribute(mesh);
    mesh->AddDeformer(deformer);
    deformer->SetCache(cache);
    node->AddMaterial(material);

    scene->GetRootNode()->AddChild(node);

    for (const FbxObject* each :
         {static_cast<FbxObject*>(node), static_cast<FbxObject*>(mesh), static_cast<FbxObject*>(deformer),
          static_cast<FbxObject*>(cache), static_cast<FbxObject*>(material)})
        EXPECT_EQ(each->GetScene(), scene) << each->GetName();
}

TEST_F(FbxSceneTest, KeepsItsRootAndSettings) {
    EXPECT_FALSE(scene->DisconnectSrcObject(scene->GetRootNode()));
    EXPECT_FALSE(scene->DisconnectSrcObject(&scene->GetGlobalSettings()));
    EXPECT_FALSE(scene->RemoveMember(scene->GetRootNode()));

    EXPECT_EQ(scene->GetRootNode()->GetScene(), scene);
    EXPECT_EQ(scene->GetNode(0), scene->GetRootNode());
}

TEST_F(FbxSceneTest, TakesItsFirstStackForTheCurrentOne) {
    FbxAnimStack* first = make<FbxAnimStack>("first");
    FbxAnimStack* second = make<FbxAnimStack>("second");
    EXPECT_EQ(scene->GetCurrentAnimationStack(), first);

    scene->SetCurrentAnimationStack(second);
    EXPECT_EQ(scene->GetCurrentAnimationStack(), second);
    EXPECT_STREQ(scene->ActiveAnimStackName.Get().Buffer(), "second");

    scene->SetCurrentAnimationStack(nullptr);
    EXPECT_EQ(scene->GetCurrentAnimationStack(), first);
}

TEST_F(FbxSceneTest, TakesNoForeignStack) {
    FbxAnimStack* own = make<FbxAnimStack>("own");
    FbxAnimStack* loose = FbxAnimStack::Create(manager, "loose");
    FbxAnimStack* foreign = FbxAnimStack::Create(FbxScene::Create(manager, "other"), "foreign");

    scene->SetCurrentAnimationStack(loose);
    scene->SetCurrentAnimationStack(foreign);

    EXPECT_EQ(scene->GetCurrentAnimationStack(), own);
}

TEST_F(FbxSceneTest, FallsBackToTheFirstStackWhenTheCurrentOneGoes) {
    FbxAnimStack* first = make<FbxAnimStack>("first");
    FbxAnimStack* second = make<FbxAnimStack>("second");
    FbxAnimStack* third = make<FbxAnimStack>("third");
    scene->SetCurrentAnimationStack(second);

    second->Destroy();
    EXPECT_EQ(scene->GetCurrentAnimationStack(), first);
    scene->SetCurrentAnimationStack(third);
    scene->DisconnectSrcObject(third);
    EXPECT_EQ(scene->GetCurrentAnimationStack(), first);
    first->Destroy();
    EXPECT_EQ(scene->GetCurrentAnimationStack(), nullptr);
}

TEST_F(FbxSceneTest, DestroysItsMembersWhenDestroyed) {
    FbxNode* outside = FbxNode::Create(manager, "outside");
    FbxScene* doomed = FbxScene::Create(manager, "doomed");
    FbxNode* node = FbxNode::Create(doomed, "node");
    doomed->GetRootNode()->AddChild(node);
    doomed->GlobalCameraSettings().CreateProducerCameras();
    outside->LclTranslation.ConnectSrcObject(node);
    outside->LclRotation.ConnectSrcProperty(node->LclRotation);

    doomed->Destroy();

    EXPECT_EQ(outside->LclTranslation.GetSrcObjectCount(), 0);
    EXPECT_EQ(outside->LclRotation.GetSrcPropertyCount(), 0);
}

TEST_F(FbxSceneTest, KeepsMembersOfOtherScenesWhenDestroyed) {
    FbxNode* node = make<FbxNode>("node");
    FbxScene* doomed = FbxScene::Create(manager, "doomed");
    doomed->ConnectSrcObject(node);

    doomed->Destroy();

    EXPECT_EQ(node->GetScene(), scene);
    EXPECT_EQ(node->GetDstObjectCount(), 1);
}

TEST_F(FbxSceneTest, HasSettingsOfItsOwn) {
    FbxScene* other = FbxScene::Create(manager, "other");

    scene->GetGlobalSettings().SetSystemUnit(FbxSystemUnit::m);

    EXPECT_EQ(other->GetGlobalSettings().GetSystemUnit(), FbxSystemUnit::cm);
}

TEST_F(FbxSceneTest, EntersAndLeavesAHundredThousandNodes) {
    FbxNode* root = scene->GetRootNode();
    for (int i = 0; i < 100'000; ++i)
        root->AddChild(FbxNode::Create(manager, ""));
    EXPECT_EQ(scene->GetNodeCount(), 100'001);

    for (int i = root->GetChildCount(); i-- > 0;)
        root->GetChild(i)->Destroy();

    EXPECT_EQ(scene->GetNodeCount(), 1);
    EXPECT_EQ(root->GetChildCount(), 0);
}

TEST_F(FbxSceneTest, KeepsTheChildrenOfARootThatIsToBeDestroyed) {
    FbxNode* node = make<FbxNode>("node");
    scene->GetRootNode()->AddChild(node);

    scene->GetRootNode()->Destroy(true);

    EXPECT_EQ(scene->GetRootNode()->GetChild(0), node);
}

} // namespace
