// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects: names, classes, connections, and which objects are destroyed together.
#include <string>
#include <vector>

#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxGlobalSettings.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMesh.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "platform/scene/SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxObjectTest : public SceneFixture {
protected:
    /// An object that is in no scene.
    FbxObject* loose(const char* name) { return FbxObject::Create(manager, name); }

    static std::vector<std::string> sourceNames(const FbxObject& object) {
        std::vector<std::string> names;
        for (int i = 0; i < object.GetSrcObjectCount(); ++i)
            names.emplace_back(object.GetSrcObject(i)->GetName());
        return names;
    }
};

using Names = std::vector<std::string>;

TEST_F(FbxObjectTest, HasTheNameItWasGiven) {
    FbxObject* object = loose("ns:Würfel");

    EXPECT_STREQ(object->GetName(), "ns:Würfel");
    object->SetName("other");
    EXPECT_STREQ(object->GetName(), "other");
}

TEST_F(FbxObjectTest, TakesANullNameForTheEmptyOne) {
    FbxObject* object = loose(nullptr);
    EXPECT_STREQ(object->GetName(), "");

    object->SetName("named");
    object->SetName(nullptr);
    EXPECT_STREQ(object->GetName(), "");
}

TEST_F(FbxObjectTest, NeedsNoUniqueName) { EXPECT_NE(make<FbxNode>("same"), make<FbxNode>("same")); }

TEST_F(FbxObjectTest, IsNotMadeWithoutManagerOrContainer) {
    EXPECT_EQ(FbxNode::Create(static_cast<FbxManager*>(nullptr), "x"), nullptr);
    EXPECT_EQ(FbxNode::Create(static_cast<FbxObject*>(nullptr), "x"), nullptr);
}

TEST_F(FbxObjectTest, OfAManagerIsInNoScene) {
    FbxObject* object = loose("x");

    EXPECT_EQ(object->GetFbxManager(), manager);
    EXPECT_EQ(object->GetScene(), nullptr);
    EXPECT_EQ(object->GetDocument(), nullptr);
    EXPECT_EQ(object->GetDstObjectCount(), 0);
}

TEST_F(FbxObjectTest, OfASceneIsASourceOfIt) {
    FbxNode* node = make<FbxNode>("x");

    EXPECT_EQ(node->GetFbxManager(), manager);
    EXPECT_EQ(node->GetScene(), scene);
    EXPECT_EQ(node->GetDocument(), scene);
    EXPECT_TRUE(scene->IsConnectedSrcObject(node));
    EXPECT_EQ(node->GetDstObject<FbxScene>(), scene);
}

TEST_F(FbxObjectTest, OfAnotherContainerIsASourceOfThatAndOfItsScene) {
    FbxNode* node = make<FbxNode>("node");
    FbxObject* part = FbxObject::Create(node, "part");

    EXPECT_TRUE(node->IsConnectedSrcObject(part));
    EXPECT_EQ(part->GetScene(), scene);
    EXPECT_TRUE(scene->IsConnectedSrcObject(part));
}

TEST_F(FbxObjectTest, KnowsItsClassAndThoseItDerivesFrom) {
    FbxMesh* mesh = make<FbxMesh>();

    EXPECT_TRUE(mesh->Is<FbxMesh>());
    EXPECT_TRUE(mesh->Is<FbxNodeAttribute>());
    EXPECT_TRUE(mesh->Is<FbxObject>());
    EXPECT_FALSE(mesh->Is<FbxNode>());
    EXPECT_EQ(mesh->GetClassId(), FbxMesh::ClassId);
}

TEST_F(FbxObjectTest, CastsToWhatItIsAndToNothingElse) {
    FbxObject* camera = make<FbxCamera>();

    EXPECT_EQ(FbxCast<FbxCamera>(camera), camera);
    EXPECT_EQ(FbxCast<FbxNodeAttribute>(camera), camera);
    EXPECT_EQ(FbxCast<FbxLight>(camera), nullptr);
    EXPECT_EQ(FbxCast<FbxLight>(static_cast<FbxObject*>(nullptr)), nullptr);
    EXPECT_EQ(FbxCast<FbxCamera>(static_cast<const FbxObject*>(camera)), camera);
}

// Connections.

TEST_F(FbxObjectTest, ListsSourcesInOrderOfConnection) {
    FbxObject* target = loose("target");
    for (const char* name : {"c", "a", "b"})
        EXPECT_TRUE(target->ConnectSrcObject(loose(name)));

    EXPECT_EQ(sourceNames(*target), (Names{"c", "a", "b"}));
}

TEST_F(FbxObjectTest, ListsDestinationsInOrderOfConnection) {
    FbxObject* source = loose("source");
    FbxObject* first = loose("first");
    FbxObject* second = loose("second");
    EXPECT_TRUE(source->ConnectDstObject(second));
    EXPECT_TRUE(first->ConnectSrcObject(source));

    EXPECT_EQ(source->GetDstObjectCount(), 2);
    EXPECT_EQ(source->GetDstObject(0), second);
    EXPECT_EQ(source->GetDstObject(1), first);
    EXPECT_TRUE(source->IsConnectedDstObject(first));
}

TEST_F(FbxObjectTest, GivesNullForAnIndexOutOfRange) {
    FbxObject* target = loose("target");
    target->ConnectSrcObject(loose("a"));

    for (const int index : {-1, 1, 1000}) {
        EXPECT_EQ(target->GetSrcObject(index), nullptr) << index;
        EXPECT_EQ(target->GetDstObject(index), nullptr) << index;
        EXPECT_EQ(target->GetSrcObject<FbxObject>(index), nullptr) << index;
        EXPECT_FALSE(target->GetSrcProperty(index).IsValid()) << index;
        EXPECT_FALSE(target->GetDstProperty(index).IsValid()) << index;
    }
}

TEST_F(FbxObjectTest, ConnectsTwoObjectsOnceOnly) {
    FbxObject* target = loose("target");
    FbxObject* source = loose("source");

    EXPECT_TRUE(target->ConnectSrcObject(source));
    EXPECT_FALSE(target->ConnectSrcObject(source));
    EXPECT_FALSE(source->ConnectDstObject(target));
    EXPECT_EQ(target->GetSrcObjectCount(), 1);
    EXPECT_EQ(source->GetDstObjectCount(), 1);
}

TEST_F(FbxObjectTest, ConnectsNeitherWithNullNorWithItself) {
    FbxObject* object = loose("x");

    EXPECT_FALSE(object->ConnectSrcObject(nullptr));
    EXPECT_FALSE(object->ConnectDstObject(nullptr));
    EXPECT_FALSE(object->ConnectSrcObject(object));
    EXPECT_FALSE(object->ConnectSrcProperty(FbxProperty()));
    EXPECT_FALSE(object->IsConnectedSrcObject(nullptr));
    EXPECT_FALSE(object->DisconnectSrcObject(nullptr));
    EXPECT_EQ(object->GetSrcObjectCount(), 0);
}

TEST_F(FbxObjectTest, MayFeedWhatFeedsIt) {
    FbxObject* a = loose("a");
    FbxObject* b = loose("b");

    EXPECT_TRUE(a->ConnectSrcObject(b));
    EXPECT_TRUE(b->ConnectSrcObject(a));
    EXPECT_EQ(a->GetSrcObject(), b);
    EXPECT_EQ(b->GetSrcObject(), a);
}

TEST_F(FbxObjectTest, DoesNotConnectAcrossManagers) {
    FbxManager* other = FbxManager::Create();
    FbxObject* foreign = FbxObject::Create(other, "foreign");
    FbxObject* own = loose("own");

    EXPECT_FALSE(own->ConnectSrcObject(foreign));
    EXPECT_FALSE(own->ConnectDstObject(foreign));
    other->Destroy();
    EXPECT_EQ(own->GetSrcObjectCount(), 0);
}

TEST_F(FbxObjectTest, IsDisconnectedAtBothEnds) {
    FbxObject* target = loose("target");
    FbxObject* source = loose("source");
    target->ConnectSrcObject(source);

    EXPECT_TRUE(source->DisconnectDstObject(target));
    EXPECT_FALSE(target->DisconnectSrcObject(source));
    EXPECT_FALSE(target->IsConnectedSrcObject(source));
    EXPECT_EQ(target->GetSrcObjectCount(), 0);
    EXPECT_EQ(source->GetDstObjectCount(), 0);
}

TEST_F(FbxObjectTest, ListsObjectsAndPropertiesApart) {
    FbxObject* target = loose("target");
    FbxNode* source = FbxNode::Create(manager, "source");
    target->ConnectSrcObject(source);
    EXPECT_TRUE(target->ConnectSrcProperty(source->LclTranslation));
    EXPECT_TRUE(target->ConnectSrcProperty(source->LclScaling));

    EXPECT_EQ(target->GetSrcObjectCount(), 1);
    EXPECT_EQ(target->GetSrcPropertyCount(), 2);
    EXPECT_EQ(target->GetSrcProperty(0), source->LclTranslation);
    EXPECT_EQ(target->GetSrcProperty(1), source->LclScaling);
    EXPECT_EQ(source->LclTranslation.GetDstObject(), target);
}

TEST_F(FbxObjectTest, FeedsPropertiesOfOthersAndItsOwn) {
    FbxObject* source = loose("source");
    FbxNode* node = FbxNode::Create(manager, "node");

    EXPECT_TRUE(source->ConnectDstProperty(node->LclRotation));
    EXPECT_FALSE(source->ConnectDstProperty(node->LclRotation));
    EXPECT_TRUE(node->ConnectDstProperty(node->LclScaling));
    EXPECT_EQ(source->GetDstPropertyCount(), 1);
    EXPECT_EQ(source->GetDstProperty(), node->LclRotation);
    EXPECT_EQ(node->LclScaling.GetSrcObject(), node);
}

TEST_F(FbxObjectTest, CountsByClassAndDerivedClasses) {
    FbxObject* target = loose("target");
    FbxCamera* camera = FbxCamera::Create(manager, "camera");
    FbxNull* null = FbxNull::Create(manager, "null");
    target->ConnectSrcObject(FbxNode::Create(manager, "node"));
    target->ConnectSrcObject(camera);
    target->ConnectSrcObject(null);

    EXPECT_EQ(target->GetSrcObjectCount<FbxObject>(), 3);
    EXPECT_EQ(target->GetSrcObjectCount<FbxNodeAttribute>(), 2);
    EXPECT_EQ(target->GetSrcObject<FbxNodeAttribute>(0), camera);
    EXPECT_EQ(target->GetSrcObject<FbxNodeAttribute>(1), null);
    EXPECT_EQ(target->GetSrcObjectCount(FbxCriteria::ObjectType(FbxNull::ClassId)), 1);
    EXPECT_EQ(target->GetSrcObject(FbxCriteria::ObjectType(FbxNull::ClassId)), null);
    EXPECT_EQ(target->GetSrcObjectCount<FbxLight>(), 0);
}

// Membership.

TEST_F(FbxObjectTest, JoinsTheSceneOfWhatItFeedsWithAllThatFeedsIt) {
    FbxNode* node = FbxNode::Create(manager, "node");
    FbxMesh* mesh = FbxMesh::Create(manager, "mesh");
    FbxObject* deep = loose("deep");
    node->SetNodeAttribute(mesh);
    mesh->ConnectSrcObject(deep);
    ASSERT_EQ(deep->GetScene(), nullptr);

    scene->GetRootNode()->AddChild(node);

    for (FbxObject* each : std::vector<FbxObject*>{node, mesh, deep}) {
        EXPECT_EQ(each->GetScene(), scene) << each->GetName();
        EXPECT_TRUE(scene->IsConnectedSrcObject(each)) << each->GetName();
    }
}

TEST_F(FbxObjectTest, JoinsWhenItFeedsAPropertyOfAMember) {
    FbxNode* node = make<FbxNode>("node");
    FbxObject* target = loose("target");
    FbxObject* behind = loose("behind");
    FbxNode* between = FbxNode::Create(manager, "between");
    between->LclTranslation.ConnectSrcObject(behind);

    node->FindProperty("LookAtProperty").ConnectSrcObject(target);
    node->LclRotation.ConnectSrcProperty(between->LclTranslation);

    EXPECT_EQ(target->GetScene(), scene);
    EXPECT_EQ(between->GetScene(), scene);
    EXPECT_EQ(behind->GetScene(), scene);
}

TEST_F(FbxObjectTest, JoinsInCyclesToo) {
    FbxObject* a = loose("a");
    FbxObject* b = loose("b");
    a->ConnectSrcObject(b);
    b->ConnectSrcObject(a);

    scene->ConnectSrcObject(a);

    EXPECT_EQ(a->GetScene(), scene);
    EXPECT_EQ(b->GetScene(), scene);
}

TEST_F(FbxObjectTest, DoesNotPullWhatItFeedsIntoTheScene) {
    FbxObject* target = loose("target");
    FbxObject* source = loose("source");
    target->ConnectSrcObject(source);

    scene->ConnectSrcObject(source);

    EXPECT_EQ(source->GetScene(), scene);
    EXPECT_EQ(target->GetScene(), nullptr);
}

TEST_F(FbxObjectTest, StaysInItsFirstScene) {
    FbxScene* other = FbxScene::Create(manager, "other");
    FbxNode* node = make<FbxNode>("node");

    EXPECT_TRUE(other->ConnectSrcObject(node));

    EXPECT_EQ(node->GetScene(), scene);
    EXPECT_EQ(other->GetNodeCount(), 1);
}

TEST_F(FbxObjectTest, LeavesTheSceneWhenItIsCutOff) {
    FbxNode* node = make<FbxNode>("node");
    ASSERT_EQ(scene->GetNodeCount(), 2);

    EXPECT_TRUE(scene->DisconnectSrcObject(node));

    EXPECT_EQ(node->GetScene(), nullptr);
    EXPECT_EQ(scene->GetNodeCount(), 1);
}

// Destruction.

TEST_F(FbxObjectTest, IsDisconnectedFromEverythingWhenDestroyed) {
    FbxObject* target = loose("target");
    FbxNode* node = make<FbxNode>("node");
    FbxObject* doomed = loose("doomed");
    FbxObject* source = loose("source");
    target->ConnectSrcObject(doomed);
    node->LclTranslation.ConnectSrcObject(doomed);
    doomed->ConnectSrcObject(source);

    doomed->Destroy();

    EXPECT_EQ(target->GetSrcObjectCount(), 0);
    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount(), 0);
    EXPECT_EQ(source->GetDstObject(), scene); // joined through the doomed object, and stays
    EXPECT_EQ(source->GetDstObjectCount(), 1);
}

TEST_F(FbxObjectTest, RemovesTheConnectionsOfItsPropertiesWhenDestroyed) {
    FbxNode* doomed = FbxNode::Create(manager, "doomed");
    FbxNode* other = FbxNode::Create(manager, "other");
    other->LclTranslation.ConnectSrcProperty(doomed->LclTranslation);
    doomed->LclScaling.ConnectSrcObject(other);

    doomed->Destroy();

    EXPECT_EQ(other->LclTranslation.GetSrcPropertyCount(), 0);
    EXPECT_EQ(other->GetDstPropertyCount(), 0);
}

TEST_F(FbxObjectTest, KeepsItsSourcesByDefault) {
    FbxObject* target = loose("target");
    FbxObject* source = loose("source");
    target->ConnectSrcObject(source);

    target->Destroy(false);

    EXPECT_STREQ(source->GetName(), "source");
    EXPECT_EQ(source->GetDstObjectCount(), 0);
}

TEST_F(FbxObjectTest, DestroysItsSourcesAndTheirsOnRequest) {
    FbxNode* parent = make<FbxNode>("parent");
    FbxNode* child = make<FbxNode>("child");
    FbxNode* bystander = make<FbxNode>("bystander");
    parent->AddChild(child);
    child->SetNodeAttribute(make<FbxNull>("null"));
    bystander->AddMaterial(make<FbxSurfacePhong>("phong"));
    const int before = scene->GetSrcObjectCount();

    parent->Destroy(true);

    EXPECT_EQ(scene->GetSrcObjectCount(), before - 3);
    EXPECT_EQ(scene->GetNodeCount(), 2);
    EXPECT_EQ(bystander->GetMaterialCount(), 1);
}

TEST_F(FbxObjectTest, IsDestroyedOnceWhenItIsItsOwnSource) {
    FbxObject* a = loose("a");
    FbxObject* b = loose("b");
    a->ConnectSrcObject(b);
    b->ConnectSrcObject(a);
    b->ConnectSrcObject(loose("c"));

    a->Destroy(true);

    EXPECT_EQ(scene->GetNodeCount(), 1);
}

TEST_F(FbxObjectTest, DestroysAChainOfAHundredThousandSources) {
    FbxObject* top = loose("top");
    FbxObject* last = top;
    for (int i = 0; i < 100'000; ++i) {
        FbxObject* next = loose("");
        last->ConnectSrcObject(next);
        last = next;
    }

    top->Destroy(true);

    SUCCEED(); // neither a stack overflow nor a sanitizer report
}

TEST_F(FbxObjectTest, DestroysAWholeSceneThatIsASource) {
    FbxObject* owner = loose("owner");
    FbxScene* owned = FbxScene::Create(manager, "owned");
    FbxNode* node = FbxNode::Create(owned, "node");
    owned->GetRootNode()->AddChild(node);
    owner->ConnectSrcObject(owned);

    owner->Destroy(true);

    manager->Destroy(); // leftover data of the scene would now access the freed scene
    manager = FbxManager::Create();
    scene = nullptr;
}

TEST_F(FbxObjectTest, SurvivesThatAFixedPartOfTheSceneIsDestroyed) {
    scene->GetRootNode()->Destroy();
    scene->GetGlobalSettings().Destroy(true);

    EXPECT_STREQ(scene->GetRootNode()->GetName(), "RootNode");
    EXPECT_EQ(scene->GetGlobalSettings().GetSystemUnit().GetScaleFactor(), 1.0);
}

} // namespace
