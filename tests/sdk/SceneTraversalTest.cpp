// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Counting, naming and listing nodes.
#include "support/SceneBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace Tarnell::Fbx {
namespace {

using test::TestScene;
using testing::ElementsAre;
using testing::IsEmpty;
using Names = std::vector<std::string>;
using Transform = TnFbxTransform;

constexpr int kMeshes = 4, kCameras = 32, kLights = 64, kMarkers = 1, kNulls = 0x4000, kTransforms = 0x4005;

Names namesOf(TestScene& scene, long mask) {
    Names names = {"to be removed"};
    EXPECT_TRUE(scene.sdk.getNodeNames(mask, names));
    return names;
}

template <class Object>
Names namesOf(const std::vector<Object>& objects) {
    Names names;
    for (const Object& object : objects)
        names.push_back(object.getName());
    return names;
}

/// A node with an attribute of a class that the platform does not implement.
template <class Attribute>
void addOfEveryKind(TestScene& scene, const char* name) {
    scene.add<Attribute>(name);
}

void addOpticalMarker(TestScene& scene, const char* name) {
    scene.add<fbxsdk::FbxMarker>(name)->GetMarker()->SetType(fbxsdk::FbxMarker::eOptical);
}

/// a (null), a/b (camera), a/b/c (light), a/d (no attribute), e (mesh), e/f (marker); and before d and f what is no
/// object of any kind: a/skeleton and e/stereo.
void buildTree(TestScene& scene) {
    fbxsdk::FbxNode* a = scene.add<fbxsdk::FbxNull>("a");
    fbxsdk::FbxNode* b = scene.add<fbxsdk::FbxCamera>("b", a);
    scene.add<fbxsdk::FbxLight>("c", b);
    scene.add<fbxsdk::FbxSkeleton>("skeleton", a);
    scene.addNode("d", a);
    fbxsdk::FbxNode* e = addTriangle(scene, "e");
    scene.add<fbxsdk::FbxCameraStereo>("stereo", e);
    scene.add<fbxsdk::FbxMarker>("f", e);
}

// ---- Counting ----

TEST(NodeCounts, FollowTheMasksOfTheKinds) {
    TestScene scene;
    buildTree(scene);

    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kMeshes), 1);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kCameras), 1);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kLights), 1);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kMarkers), 1);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kNulls), 2);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kTransforms), 4);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(0), 0);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(-1), 7); // the skeleton too, the stereo camera never

    EXPECT_EQ(scene.sdk.getNumberOfMeshes(), 1);
    EXPECT_EQ(scene.sdk.getNumberOfCameras(), 8);
    EXPECT_EQ(scene.sdk.getNumberOfLights(), 1);
    EXPECT_EQ(scene.sdk.getNumberOfMarkers(), 1);
    EXPECT_EQ(scene.sdk.getNumberOfNulls(), 2);
    EXPECT_EQ(scene.sdk.getNumberOfTransforms(), 4);
}

TEST(NodeCounts, SelectEveryAttributeTypeByItsBit) {
    struct Row {
        int bit;
        void (*add)(TestScene&, const char*);
    };
    const Row rows[] = {
        {0x1, addOfEveryKind<fbxsdk::FbxMarker>},
        {0x1, addOpticalMarker}, // and not 0x100: its attribute is a marker's, like that of every type of marker
        {0x2, addOfEveryKind<fbxsdk::FbxSkeleton>},
        {0x4, addOfEveryKind<fbxsdk::FbxMesh>},
        {0x8, addOfEveryKind<fbxsdk::FbxNurbs>},
        {0x10, addOfEveryKind<fbxsdk::FbxPatch>},
        {0x20, addOfEveryKind<fbxsdk::FbxCamera>},
        {0x40, addOfEveryKind<fbxsdk::FbxLight>},
        {0x80, addOfEveryKind<fbxsdk::FbxOpticalReference>},
        {0x200, addOfEveryKind<fbxsdk::FbxCameraSwitcher>},
        {0x800, addOfEveryKind<fbxsdk::FbxNurbsCurve>},
        {0x1000, addOfEveryKind<fbxsdk::FbxTrimNurbsSurface>},
        {0x2000, addOfEveryKind<fbxsdk::FbxBoundary>},
        {0x4000, addOfEveryKind<fbxsdk::FbxNull>},
        {0x4000, addOfEveryKind<fbxsdk::FbxNurbsSurface>},
        {0, addOfEveryKind<fbxsdk::FbxCameraStereo>},
        {0, addOfEveryKind<fbxsdk::FbxSubDiv>},
    };
    for (const Row& row : rows) {
        TestScene scene;
        row.add(scene, "node");
        for (int bit = 1; bit <= 0x8000; bit *= 2)
            EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(bit), bit == row.bit ? 1 : 0) << std::hex << bit << ' ' << row.bit;
    }
}

TEST(NodeCounts, AddUpForAMaskOfSeveralBits) {
    TestScene scene;
    buildTree(scene);

    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kCameras | kLights | kMeshes), 3);
}

TEST(NodeCounts, OfANodeWithoutAttributeAreThoseOfANull) {
    TestScene scene;
    scene.addNode("bare");

    EXPECT_EQ(scene.sdk.getNumberOfNulls(), 1);
    EXPECT_EQ(scene.sdk.getNumberOfTransforms(), 1);
    EXPECT_EQ(scene.sdk.getNumberOfMeshes() + scene.sdk.getNumberOfLights() + scene.sdk.getNumberOfMarkers(), 0);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kCameras), 0);
}

TEST(NodeCounts, AreZeroInAnEmptySceneButForTheProducerCameras) {
    TestScene scene;

    EXPECT_EQ(scene.sdk.getNumberOfMeshes(), 0);
    EXPECT_EQ(scene.sdk.getNumberOfLights(), 0);
    EXPECT_EQ(scene.sdk.getNumberOfMarkers(), 0);
    EXPECT_EQ(scene.sdk.getNumberOfNulls(), 0);
    EXPECT_EQ(scene.sdk.getNumberOfTransforms(), 0);
    EXPECT_EQ(scene.sdk.getNumberOfCameras(), 7);
    EXPECT_NE(scene.scene->GlobalCameraSettings().GetCameraProducerTop(), nullptr);
}

TEST(NodeCounts, AreZeroWithoutAContext) {
    const FbxSdk sdk;

    EXPECT_EQ(sdk.getNumberOfNodeTypes(-1), 0);
    EXPECT_EQ(sdk.getNumberOfCameras(), 0);
    EXPECT_EQ(sdk.getNumberOfMeshes(), 0);
}

TEST(NodeCounts, NeverIncludeTheRoot) {
    TestScene scene;
    scene.scene->GetRootNode()->SetNodeAttribute(fbxsdk::FbxLight::Create(scene.scene, "light"));

    EXPECT_EQ(scene.sdk.getNumberOfLights(), 0);
    EXPECT_THAT(namesOf(scene, kLights), IsEmpty());
}

TEST(NodeCounts, OfASubtreeIncludeItsTopAndAddToTheNumber) {
    TestScene scene;
    buildTree(scene);
    int count = 10;

    EXPECT_TRUE(scene.sdk.getNumberOfNodeTypesRecursive(scene.scene->GetRootNode()->GetChild(0), kTransforms, count));
    EXPECT_EQ(count, 12);
    EXPECT_TRUE(scene.sdk.getNumberOfNodeTypesRecursive(nullptr, kTransforms, count));
    EXPECT_EQ(count, 12);
}

TEST(NodeCounts, IncludeNurbsSurfacesThatTheListsDoNotFill) {
    TestScene scene;
    scene.add<fbxsdk::FbxNurbsSurface>("surface");
    scene.addNode("null");
    ASSERT_EQ(scene.sdk.getNumberOfNulls(), 2);
    ASSERT_EQ(scene.sdk.getNumberOfTransforms(), 2);
    std::vector<TnFbxNull> nulls(2);
    std::vector<Transform> transforms(2);
    TnFbxReadInfo info = test::readAll();

    EXPECT_TRUE(scene.sdk.getNulls(info, nulls.data(), 2));
    EXPECT_TRUE(scene.sdk.getTransforms(info, transforms.data(), 2));

    EXPECT_EQ(namesOf(nulls), Names({"null", ""}));
    EXPECT_EQ(namesOf(transforms), Names({"null", ""}));
}

// ---- Naming ----

TEST(NodeNames, ComeParentsBeforeChildren) {
    TestScene scene;
    buildTree(scene);

    EXPECT_THAT(namesOf(scene, kTransforms), ElementsAre("a", "d", "e", "f"));
    EXPECT_THAT(namesOf(scene, kLights | kMeshes | kNulls), ElementsAre("a", "c", "d", "e"));
}

TEST(NodeNames, KeepDuplicates) {
    TestScene scene;
    scene.addNode("same", scene.addNode("same"));

    EXPECT_THAT(namesOf(scene, kNulls), ElementsAre("same", "same"));
}

TEST(NodeNames, PutTheProducerCamerasFirstAndMakeThem) {
    TestScene scene;
    scene.add<fbxsdk::FbxCamera>("shot");

    EXPECT_THAT(namesOf(scene, kCameras),
                ElementsAre("Producer Perspective", "Producer Top", "Producer Bottom", "Producer Front",
                            "Producer Back", "Producer Right", "Producer Left", "shot"));
    EXPECT_NE(scene.scene->GlobalCameraSettings().GetCameraProducerLeft(), nullptr);
}

TEST(NodeNames, MakeNoProducerCamerasForOtherKinds) {
    TestScene scene;

    EXPECT_THAT(namesOf(scene, kLights | kNulls), IsEmpty());
    EXPECT_EQ(scene.scene->GlobalCameraSettings().GetCameraProducerTop(), nullptr);
}

TEST(NodeNames, AppendForASubtree) {
    TestScene scene;
    buildTree(scene);
    Names names = {"before"};

    EXPECT_TRUE(scene.sdk.getNodeNamesRecursive(scene.scene->GetRootNode()->GetChild(1), kTransforms, names));

    EXPECT_THAT(names, ElementsAre("before", "e", "f"));
}

TEST(NodeNames, FailWithoutAScene) {
    FbxSdk sdk;
    Names names = {"before"};

    EXPECT_FALSE(sdk.getNodeNames(kNulls, names));

    EXPECT_THAT(names, IsEmpty());
    EXPECT_FALSE(lastError().empty());
}

TEST(NodeNames, AreThoseOfTheFileByteByByte) {
    TestScene scene;
    scene.addNode("Kübel:木 \"1\"");

    EXPECT_THAT(namesOf(scene, kNulls), ElementsAre("Kübel:木 \"1\""));
}

// ---- Listing ----

TEST(Lists, FillTheArrayInTheOrderOfTheWalk) {
    TestScene scene;
    buildTree(scene);
    std::vector<Transform> transforms(4);
    TnFbxReadInfo info = test::readAll();

    EXPECT_TRUE(scene.sdk.getTransforms(info, transforms.data(), 4));

    EXPECT_EQ(namesOf(transforms), Names({"a", "d", "e", "f"}));
    EXPECT_TRUE(lastError().empty());
}

TEST(Lists, NeverReadTheRoot) {
    TestScene scene;
    scene.scene->GetRootNode()->SetNodeAttribute(fbxsdk::FbxLight::Create(scene.scene, "light"));
    TnFbxReadInfo info = test::readAll();
    TnFbxLight light;
    light.setName("untouched");

    EXPECT_TRUE(scene.sdk.getLights(info, &light, 1));

    EXPECT_EQ(light.getName(), "untouched");
}

TEST(Lists, ReadEveryKindFromItsNodes) {
    TestScene scene;
    buildTree(scene);
    TnFbxReadInfo info = test::readAll();
    TnFbxMesh mesh;
    TnFbxLight light;
    TnFbxMarker marker;
    std::vector<TnFbxNull> nulls(2);

    EXPECT_TRUE(scene.sdk.getMeshes(info, &mesh, 1));
    EXPECT_TRUE(scene.sdk.getLights(info, &light, 1));
    EXPECT_TRUE(scene.sdk.getMarkers(info, &marker, 1));
    EXPECT_TRUE(scene.sdk.getNulls(info, nulls.data(), 2));

    EXPECT_EQ(mesh.getName(), "e");
    EXPECT_EQ(mesh.getNumberOfPolygons(), 1);
    EXPECT_EQ(light.getName(), "c");
    EXPECT_EQ(marker.getName(), "f");
    EXPECT_EQ(namesOf(nulls), Names({"a", "d"}));
}

TEST(Lists, OfCamerasBeginWithTheProducers) {
    TestScene scene;
    buildTree(scene);
    std::vector<TnFbxCamera> cameras(8);
    TnFbxReadInfo info = test::readAll();

    EXPECT_TRUE(scene.sdk.getCameras(info, cameras.data(), 8));

    EXPECT_EQ(namesOf(cameras), Names({"Producer Perspective", "Producer Top", "Producer Bottom", "Producer Front",
                                       "Producer Back", "Producer Right", "Producer Left", "b"}));
}

TEST(Lists, SucceedWithNothingToRead) {
    TestScene scene;
    TnFbxLight light;
    TnFbxReadInfo info = test::readAll();

    EXPECT_TRUE(scene.sdk.getLights(info, &light, 1));

    EXPECT_EQ(light.getName(), "");
}

TEST(Lists, FailForANullArrayAndACountBelowOne) {
    TestScene scene;
    TnFbxReadInfo info = test::readAll();
    TnFbxLight light;

    EXPECT_FALSE(scene.sdk.getLights(info, nullptr, 1));
    EXPECT_FALSE(scene.sdk.getLights(info, &light, 0));
    EXPECT_FALSE(scene.sdk.getLights(info, &light, -1));
    EXPECT_FALSE(lastError().empty());
}

TEST(Lists, FailWithoutAContext) {
    FbxSdk sdk;
    TnFbxReadInfo info = test::readAll();
    TnFbxCamera camera;
    TnFbxMesh mesh;

    EXPECT_FALSE(sdk.getCameras(info, &camera, 1));
    EXPECT_FALSE(sdk.getMeshes(info, &mesh, 1));
    EXPECT_EQ(lastError(), "no scene is loaded");
}

TEST(Lists, StopWithAFailureWhenTheArrayIsFullAndKeepWhatTheyRead) {
    TestScene scene;
    buildTree(scene);
    std::vector<Transform> transforms(3);
    TnFbxReadInfo info = test::readAll();

    EXPECT_FALSE(scene.sdk.getTransforms(info, transforms.data(), 2));

    EXPECT_EQ(namesOf(transforms), Names({"a", "d", ""}));
    EXPECT_THAT(lastError(), testing::HasSubstr("\"e\""));
}

TEST(Lists, OfCamerasNeverWriteBeyondAnArrayShorterThanTheProducers) {
    TestScene scene;
    std::vector<TnFbxCamera> cameras(4);
    TnFbxReadInfo info = test::readAll();

    EXPECT_FALSE(scene.sdk.getCameras(info, cameras.data(), 3));

    EXPECT_EQ(namesOf(cameras), Names({"Producer Perspective", "Producer Top", "Producer Bottom", ""}));
}

TEST(NamedLists, ReadTheFirstNodeOfTheNameIntoTheFirstElement) {
    TestScene scene;
    fbxsdk::FbxNode* other = scene.add<fbxsdk::FbxLight>("other");
    fbxsdk::FbxNode* first = scene.add<fbxsdk::FbxLight>("key", other);
    fbxsdk::FbxNode* second = scene.add<fbxsdk::FbxLight>("key");
    first->LclTranslation.Set({1.0, 0.0, 0.0});
    second->LclTranslation.Set({2.0, 0.0, 0.0});
    std::vector<TnFbxLight> lights(3);
    TnFbxReadInfo info = test::readNamed("key");

    EXPECT_TRUE(scene.sdk.getLights(info, lights.data(), 3));

    EXPECT_EQ(namesOf(lights), Names({"key", "", ""}));
    EXPECT_EQ(lights[0].getTransformValue(Transform::kFbxTransformPositionX), 1.0f);
}

TEST(NamedLists, CompareEveryByteOfTheName) {
    TestScene scene;
    scene.add<fbxsdk::FbxLight>("Key");
    scene.add<fbxsdk::FbxLight>("key ");
    TnFbxLight light;
    TnFbxReadInfo info = test::readNamed("key");

    EXPECT_TRUE(scene.sdk.getLights(info, &light, 1));

    EXPECT_EQ(light.getName(), "");
}

TEST(NamedLists, PassOverNodesOfAnotherKind) {
    TestScene scene;
    scene.addNode("key");
    scene.add<fbxsdk::FbxLight>("key");
    TnFbxLight light;
    TnFbxReadInfo info = test::readNamed("key");

    EXPECT_TRUE(scene.sdk.getLights(info, &light, 1));

    EXPECT_EQ(light.getName(), "key");
}

TEST(NamedLists, FindNeitherSkeletonsNorStereoCameras) {
    TestScene scene;
    buildTree(scene);
    TnFbxReadInfo skeletonInfo = test::readNamed("skeleton"), stereoInfo = test::readNamed("stereo");
    Transform transform;
    TnFbxCamera camera;

    EXPECT_TRUE(scene.sdk.getTransforms(skeletonInfo, &transform, 1));
    EXPECT_TRUE(scene.sdk.getTransforms(stereoInfo, &transform, 1));
    EXPECT_TRUE(scene.sdk.getCameras(stereoInfo, &camera, 1));

    EXPECT_EQ(transform.getName(), "");
    EXPECT_EQ(camera.getName(), "");
}

TEST(NamedLists, ReadAProducerCamera) {
    TestScene scene;
    TnFbxCamera camera;
    TnFbxReadInfo info = test::readNamed("Producer Top");

    EXPECT_TRUE(scene.sdk.getCameras(info, &camera, 1));

    EXPECT_EQ(camera.getName(), "Producer Top");
    EXPECT_EQ(camera.getTransformValue(Transform::kFbxTransformPositionY), 4000.0f);
}

TEST(NamedLists, LetACameraOfTheSceneOverwriteAProducerOfItsName) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxCamera>("Producer Top");
    node->LclTranslation.Set({5.0, 6.0, 7.0});
    TnFbxCamera camera;
    TnFbxReadInfo info = test::readNamed("Producer Top");

    EXPECT_TRUE(scene.sdk.getCameras(info, &camera, 1));

    EXPECT_EQ(camera.getName(), "Producer Top");
    EXPECT_EQ(camera.getTransformValue(Transform::kFbxTransformPositionY), 6.0f);
}

TEST(Lists, TakeTheTimeFromTheStackAndTheOptions) {
    TestScene scene(2, 4);
    fbxsdk::FbxNode* node = scene.addNode("node");
    scene.key(node->LclTranslation, "X", {{3, 1.0f}});
    Transform transform;
    TnFbxReadInfo info = test::readAll();

    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));
    test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionX), 2, 4, 24.0f);

    info.setUseSampleFPS(true);
    info.setSampleFPS(48.0f);
    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));
    test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionX), 4, 8, 24.0f);
}

TEST(Lists, ReadInTheWorldOrLocallyAsTheOptionsSay) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.add<fbxsdk::FbxLight>("parent");
    parent->LclTranslation.Set({10.0, 0.0, 0.0});
    scene.addNode("node", parent)->LclTranslation.Set({1.0, 0.0, 0.0});
    Transform transform;

    TnFbxReadInfo info = test::readAll(/*global*/ false);
    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionX), 1.0f);

    info.setGlobalTransform(true);
    EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionX), 11.0f);
}

TEST(Lists, OfCamerasTurnThemToTheirInterestPositionAsTheOptionsSay) {
    TestScene scene;
    scene.add<fbxsdk::FbxCamera>("camera")->GetCamera()->InterestPosition.Set({9.0, 0.0, 0.0});
    TnFbxReadInfo info = test::readNamed("camera");
    for (const bool compute : {false, true}) {
        info.setComputeCameraRotation(compute);
        TnFbxCamera camera;

        EXPECT_TRUE(scene.sdk.getCameras(info, &camera, 1));

        EXPECT_EQ(camera.getName(), "camera");
        EXPECT_EQ(camera.getValue(TnFbxCamera::kFbxCameraLookAtPositionX), compute ? 9.0f : 0.0f);
        EXPECT_EQ(camera.getTransformRotationOrder(),
                  compute ? Transform::kFbxRotationOrderZXY : Transform::kFbxRotationOrderXYZ);
    }
}

TEST(Lists, WalkTreesThatAreDeeperThanTheStackOfCalls) {
    TestScene scene;
    fbxsdk::FbxNode* node = nullptr;
    constexpr int kDepth = 20000;
    for (int i = 0; i < kDepth; ++i)
        node = scene.addNode("deep", node);

    EXPECT_EQ(scene.sdk.getNumberOfNulls(), kDepth);
    EXPECT_EQ(namesOf(scene, kNulls).size(), static_cast<std::size_t>(kDepth));
}

// ---- Walkers of a subtree ----

TEST(Walkers, StartAtTheNodeItselfAndMoveTheIndexOn) {
    TestScene scene;
    buildTree(scene);
    fbxsdk::FbxNode* top = scene.scene->GetRootNode()->GetChild(0);
    TnFbxTime time = scene.time();
    std::vector<Transform> transforms(4);
    int index = 1;
    bool found = false;

    EXPECT_TRUE(
        scene.sdk.getTransformsRecursive(time, false, false, 0.0f, true, "", top, index, transforms.data(), 4, found));

    EXPECT_EQ(index, 3);
    EXPECT_FALSE(found);
    EXPECT_EQ(namesOf(transforms), Names({"", "a", "d", ""}));
}

TEST(Walkers, ReadANamedObjectIntoTheFirstElementWhateverTheIndex) {
    TestScene scene;
    buildTree(scene);
    TnFbxTime time = scene.time();
    std::vector<TnFbxNull> nulls(3);
    int index = 2;
    bool found = false;

    EXPECT_TRUE(scene.sdk.getNullsRecursive(time, false, false, 0.0f, false, "d",
                                            scene.scene->GetRootNode()->GetChild(0), index, nulls.data(), 3, found));

    EXPECT_TRUE(found);
    EXPECT_EQ(index, 2);
    EXPECT_EQ(namesOf(nulls), Names({"d", "", ""}));
}

TEST(Walkers, FailForAnIndexOutsideTheArray) {
    TestScene scene;
    buildTree(scene);
    fbxsdk::FbxNode* top = scene.scene->GetRootNode()->GetChild(0);
    TnFbxTime time = scene.time();
    TnFbxNull null;
    bool found = false;
    for (const int start : {-1, 1}) {
        int index = start;
        EXPECT_FALSE(scene.sdk.getNullsRecursive(time, false, false, 0.0f, true, "", top, index, &null, 1, found));
        EXPECT_EQ(index, start);
    }
    EXPECT_EQ(null.getName(), "");
}

TEST(Walkers, FailForAnIndexOutsideTheArrayBeforeTheyCompareNames) {
    TestScene scene;
    buildTree(scene);
    fbxsdk::FbxNode* top = scene.scene->GetRootNode()->GetChild(0);
    TnFbxTime time = scene.time();
    TnFbxNull null;
    bool found = false;
    for (const char* name : {"a", "another name"}) {
        for (const int start : {-1, 1}) {
            int index = start;
            EXPECT_FALSE(
                scene.sdk.getNullsRecursive(time, false, false, 0.0f, false, name, top, index, &null, 1, found));
            EXPECT_EQ(index, start);
        }
    }
    EXPECT_FALSE(found);
    EXPECT_EQ(null.getName(), "");
}

TEST(Walkers, NeedNoRoomForNodesOfAnotherKind) {
    TestScene scene;
    fbxsdk::FbxNode* top = scene.add<fbxsdk::FbxLight>("light");
    TnFbxTime time = scene.time();
    TnFbxNull null;
    bool found = false;
    for (const bool allObjects : {false, true}) {
        int index = 1;
        EXPECT_TRUE(
            scene.sdk.getNullsRecursive(time, false, false, 0.0f, allObjects, "light", top, index, &null, 1, found));
    }
    EXPECT_FALSE(found);
    EXPECT_EQ(null.getName(), "");
}

TEST(Walkers, FailForANullArray) {
    TestScene scene;
    TnFbxTime time = scene.time();
    fbxsdk::FbxNode* root = scene.scene->GetRootNode();
    int index = 0;
    bool found = false;
    FbxSdk& sdk = scene.sdk;

    EXPECT_FALSE(sdk.getMeshesRecursive(time, false, false, 0.0f, true, true, "", root, index, nullptr, 1, found));
    EXPECT_FALSE(sdk.getCamerasRecursive(time, false, false, 0.0f, true, true, "", root, index, nullptr, 1, found));
    EXPECT_FALSE(sdk.getLightsRecursive(time, false, false, 0.0f, true, "", root, index, nullptr, 1, found));
    EXPECT_FALSE(sdk.getMarkersRecursive(time, false, false, 0.0f, true, "", root, index, nullptr, 1, found));
    EXPECT_FALSE(sdk.getNullsRecursive(time, false, false, 0.0f, true, "", root, index, nullptr, 1, found));
    EXPECT_FALSE(sdk.getTransformsRecursive(time, false, false, 0.0f, true, "", root, index, nullptr, 1, found));
}

TEST(Walkers, FindNothingBelowANullNode) {
    TestScene scene;
    TnFbxTime time = scene.time();
    Transform transform;
    int index = 0;
    bool found = false;

    EXPECT_TRUE(
        scene.sdk.getTransformsRecursive(time, false, false, 0.0f, true, "", nullptr, index, &transform, 1, found));
    EXPECT_EQ(index, 0);
}

TEST(Walkers, OfCamerasAndMeshesPassTheirOwnFlags) {
    TestScene scene;
    fbxsdk::FbxNode* camera = scene.add<fbxsdk::FbxCamera>("camera");
    camera->GetCamera()->InterestPosition.Set({9.0, 0.0, 0.0});
    fbxsdk::FbxNode* mesh = addTriangle(scene, "mesh");
    mesh->LclTranslation.Set({5.0, 0.0, 0.0});
    TnFbxTime time = scene.time();
    bool found = false;

    TnFbxCamera readCamera;
    int index = 0;
    EXPECT_TRUE(scene.sdk.getCamerasRecursive(time, false, false, 0.0f, /*computeCameraRotation*/ true, true, "",
                                              camera, index, &readCamera, 1, found));
    EXPECT_EQ(readCamera.getValue(TnFbxCamera::kFbxCameraLookAtPositionX), 9.0f);

    for (const bool transformPoints : {false, true}) {
        TnFbxMesh readMesh;
        index = 0;
        EXPECT_TRUE(scene.sdk.getMeshesRecursive(time, false, false, 0.0f, true, transformPoints, "", mesh, index,
                                                 &readMesh, 1, found));
        float x = 0.0f, y = 0.0f, z = 0.0f;
        EXPECT_TRUE(readMesh.getControlPoint(1, x, y, z));
        EXPECT_EQ(x, transformPoints ? 6.0f : 1.0f);
    }
}

TEST(ProducerIntoArray, FillsTheElementAtTheIndexOrTheFirstOneByName) {
    TestScene scene;
    scene.sdk.getNumberOfCameras(); // creates them
    fbxsdk::FbxCamera* top = scene.scene->GlobalCameraSettings().GetCameraProducerTop();
    std::vector<TnFbxCamera> cameras(3);
    TnFbxReadInfo all = test::readAll();
    int index = 1;

    EXPECT_TRUE(scene.sdk.getProducerCamera(top, all, cameras.data(), "any name", index));
    EXPECT_EQ(index, 2);
    EXPECT_EQ(namesOf(cameras), Names({"", "any name", ""}));

    TnFbxReadInfo named = test::readNamed("top");
    EXPECT_TRUE(scene.sdk.getProducerCamera(top, named, cameras.data(), "other", index));
    EXPECT_TRUE(scene.sdk.getProducerCamera(top, named, cameras.data(), "top", index));
    EXPECT_EQ(index, 2);
    EXPECT_EQ(namesOf(cameras), Names({"top", "any name", ""}));
}

TEST(ProducerIntoArray, FailsWithoutCameraArrayOrNode) {
    TestScene scene;
    fbxsdk::FbxCamera* nowhere = fbxsdk::FbxCamera::Create(scene.scene, "nowhere");
    TnFbxCamera camera;
    TnFbxReadInfo info = test::readAll();
    int index = 0;

    EXPECT_FALSE(scene.sdk.getProducerCamera(nullptr, info, &camera, "name", index));
    EXPECT_FALSE(scene.sdk.getProducerCamera(nowhere, info, nullptr, "name", index));
    EXPECT_FALSE(scene.sdk.getProducerCamera(nowhere, info, &camera, "name", index));
    EXPECT_EQ(index, 0);
}

} // namespace
} // namespace Tarnell::Fbx
