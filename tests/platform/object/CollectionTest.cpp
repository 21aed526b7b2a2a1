// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Collections: membership is a source connection.
#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxNode.h>

#include "platform/scene/SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxCollectionTest : public SceneFixture {
protected:
    FbxCollection* collection = make<FbxCollection>("collection");
};

TEST_F(FbxCollectionTest, HoldsMembersAsSourcesInOrder) {
    FbxNode* node = make<FbxNode>("node");
    FbxCamera* camera = make<FbxCamera>("camera");

    EXPECT_TRUE(collection->AddMember(node));
    EXPECT_TRUE(collection->AddMember(camera));

    EXPECT_EQ(collection->GetMemberCount(), 2);
    EXPECT_EQ(collection->GetMember(0), node);
    EXPECT_EQ(collection->GetMember(1), camera);
    EXPECT_EQ(collection->GetSrcObject(1), camera);
    EXPECT_TRUE(collection->IsMember(node));
}

TEST_F(FbxCollectionTest, AddsAMemberOnceHoweverOftenAsked) {
    FbxNode* node = make<FbxNode>("node");

    EXPECT_TRUE(collection->AddMember(node));
    EXPECT_TRUE(collection->AddMember(node));

    EXPECT_EQ(collection->GetMemberCount(), 1);
}

TEST_F(FbxCollectionTest, TakesNeitherNullNorItself) {
    EXPECT_FALSE(collection->AddMember(nullptr));
    EXPECT_FALSE(collection->AddMember(collection));
    EXPECT_FALSE(collection->IsMember(nullptr));
    EXPECT_FALSE(collection->RemoveMember(nullptr));
    EXPECT_EQ(collection->GetMemberCount(), 0);
}

TEST_F(FbxCollectionTest, LosesMembersOnceOnly) {
    FbxNode* node = make<FbxNode>("node");
    collection->AddMember(node);

    EXPECT_TRUE(collection->RemoveMember(node));
    EXPECT_FALSE(collection->RemoveMember(node));

    EXPECT_FALSE(collection->IsMember(node));
    EXPECT_EQ(node->GetScene(), scene);
}

TEST_F(FbxCollectionTest, CountsByClassAndByCriteria) {
    collection->AddMember(make<FbxNode>("a"));
    collection->AddMember(make<FbxCamera>("b"));
    collection->AddMember(make<FbxNode>("c"));

    EXPECT_EQ(collection->GetMemberCount<FbxNode>(), 2);
    EXPECT_STREQ(collection->GetMember<FbxNode>(1)->GetName(), "c");
    EXPECT_EQ(collection->GetMember<FbxNode>(2), nullptr);
    EXPECT_EQ(collection->GetMemberCount(FbxCriteria::ObjectType(FbxNodeAttribute::ClassId)), 1);
    EXPECT_STREQ(collection->GetMember(FbxCriteria::ObjectType(FbxCamera::ClassId), 0)->GetName(), "b");
    EXPECT_EQ(collection->GetMember(-1), nullptr);
}

TEST_F(FbxCollectionTest, MayHoldOneObjectInManyAndCollectionsInEachOther) {
    FbxCollection* other = make<FbxCollection>("other");
    FbxNode* node = make<FbxNode>("node");

    EXPECT_TRUE(collection->AddMember(node));
    EXPECT_TRUE(other->AddMember(node));
    EXPECT_TRUE(collection->AddMember(other));
    EXPECT_TRUE(other->AddMember(collection));

    EXPECT_TRUE(collection->IsMember(other));
    EXPECT_TRUE(other->IsMember(collection));
}

TEST_F(FbxCollectionTest, ForgetsDestroyedMembers) {
    FbxNode* node = make<FbxNode>("node");
    collection->AddMember(node);
    collection->AddMember(make<FbxCamera>("camera"));

    node->Destroy();

    EXPECT_EQ(collection->GetMemberCount(), 1);
    EXPECT_STREQ(collection->GetMember(0)->GetName(), "camera");
}

} // namespace
