// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The context: its manager and scene, loading and normalisation, animation stacks and the range of frames to read.
#include "support/SceneBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <limits>
#include <string>

namespace Tarnell::Fbx {
namespace {

using test::TestScene;
using test::timeOfFrame;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using Names = std::vector<std::string>;

constexpr int kMeshes = 0x4, kNurbs = 0x8, kPatches = 0x10;

/// Row by row, as surfaces have their control points.
const fbxsdk::FbxVector4 kUnitSquare[] = {{0.0, 0.0, 0.0}, {1.0, 0.0, 0.0}, {0.0, 1.0, 0.0}, {1.0, 1.0, 0.0}};

std::string dataFile(const char* name) { return std::string(TARNELL_TEST_DATA "/sdk/") + name; }

/// A context with a file of the tests' data in it.
struct LoadedFile {
    explicit LoadedFile(const char* name, bool convertGeometry = true) {
        EXPECT_TRUE(sdk.initFbxSdkManager());
        EXPECT_TRUE(sdk.loadScene(dataFile(name), convertGeometry)) << lastError();
    }

    TnFbxTransform transform(const char* name, bool global) {
        TnFbxReadInfo info = test::readNamed(name, global);
        TnFbxTransform transform;
        EXPECT_TRUE(sdk.getTransforms(info, &transform, 1)) << lastError();
        EXPECT_EQ(transform.getName(), name);
        return transform;
    }

    FbxSdk sdk;
};

void expectPosition(const TnFbxTransform& transform, float x, float y, float z) {
    EXPECT_FLOAT_EQ(transform.getTransformValue(TnFbxTransform::kFbxTransformPositionX), x);
    EXPECT_FLOAT_EQ(transform.getTransformValue(TnFbxTransform::kFbxTransformPositionY), y);
    EXPECT_FLOAT_EQ(transform.getTransformValue(TnFbxTransform::kFbxTransformPositionZ), z);
}

/// A flat patch of two by two control points on the unit square.
fbxsdk::FbxNode* addPatch(TestScene& scene, const char* name, fbxsdk::FbxNode* parent) {
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxPatch>(name, parent);
    fbxsdk::FbxPatch& patch = *fbxsdk::FbxCast<fbxsdk::FbxPatch>(node->GetNodeAttribute());
    patch.InitControlPoints(2, fbxsdk::FbxPatch::eLinear, 2, fbxsdk::FbxPatch::eLinear);
    for (int i = 0; i < 4; ++i)
        patch.SetControlPointAt(kUnitSquare[i], i);
    return node;
}

/// The same square as a NURBS surface, of the newer of the two classes.
fbxsdk::FbxNode* addNurbsSurface(TestScene& scene, const char* name) {
    using Surface = fbxsdk::FbxNurbsSurface;
    fbxsdk::FbxNode* node = scene.add<Surface>(name);
    Surface& surface = *fbxsdk::FbxCast<Surface>(node->GetNodeAttribute());
    surface.SetOrder(2, 2);
    surface.InitControlPoints(2, Surface::eOpen, 2, Surface::eOpen);
    const double knots[] = {0.0, 0.0, 1.0, 1.0};
    std::copy(std::begin(knots), std::end(knots), surface.GetUKnotVector());
    std::copy(std::begin(knots), std::end(knots), surface.GetVKnotVector());
    for (int i = 0; i < 4; ++i)
        surface.SetControlPointAt(kUnitSquare[i], i);
    return node;
}

void expectTime(const TnFbxTime& time, float frame, int startFrame, int endFrame, float rate) {
    EXPECT_EQ(time.getFrame(), frame);
    test::expectRange(time, startFrame, endFrame, rate);
}

// ---- Manager and scene ----

TEST(SdkContext, NamesTheCachesAndTheStack) {
    EXPECT_EQ(FbxSdk::kMayaVertexCacheFileExtension, ".xml");
    EXPECT_EQ(FbxSdk::kMaxVertexCacheFileExtension, ".pc2");
    EXPECT_EQ(FbxSdk::kDefaultAnimationStackName, "Take 001");
}

TEST(SdkContext, StartsWithoutAScene) {
    const FbxSdk sdk;

    EXPECT_EQ(sdk.getScene(), nullptr);
}

TEST(SdkContext, MakesAnEmptySceneOnce) {
    FbxSdk sdk;
    EXPECT_TRUE(sdk.initFbxSdkManager());
    fbxsdk::FbxScene* scene = sdk.getScene();
    ASSERT_NE(scene, nullptr);
    EXPECT_STREQ(scene->GetName(), "");
    EXPECT_EQ(scene->GetRootNode()->GetChildCount(), 0);

    EXPECT_TRUE(sdk.initFbxSdkManager());
    EXPECT_EQ(sdk.getScene(), scene);
}

TEST(SdkContext, DestroysItsManagerOnce) {
    FbxSdk sdk;
    EXPECT_FALSE(sdk.destroyFbxSdkManager());
    EXPECT_FALSE(lastError().empty());
    EXPECT_TRUE(sdk.initFbxSdkManager());
    EXPECT_TRUE(sdk.destroyFbxSdkManager());
    EXPECT_FALSE(sdk.destroyFbxSdkManager());
}

TEST(SdkContext, CanBeInitialisedAgain) {
    TestScene first;
    first.addNode("node");

    EXPECT_TRUE(first.sdk.destroyFbxSdkManager());
    EXPECT_EQ(first.sdk.getNumberOfNulls(), 0);
    EXPECT_TRUE(first.sdk.initFbxSdkManager());

    EXPECT_EQ(first.sdk.getNumberOfNulls(), 0);
    TnFbxTime time;
    EXPECT_FALSE(first.sdk.getGlobalAnimationStackTime(time, 0.0f, false, 0.0f)) << "the stack died with the manager";
}

TEST(SdkContext, AssignmentMakesASceneOfItsOwnAndCopiesNothing) {
    TestScene source;
    source.addNode("node");
    FbxSdk target;

    EXPECT_EQ(&(target = source.sdk), &target);

    ASSERT_NE(target.getScene(), nullptr);
    EXPECT_NE(target.getScene(), source.scene);
    EXPECT_EQ(target.getNumberOfNulls(), 0);
}

TEST(SdkContext, AssignmentToAnInitialisedContextOrItselfChangesNothing) {
    TestScene source, target;
    target.addNode("node");
    fbxsdk::FbxScene* scene = target.scene;
    FbxSdk fresh;
    FbxSdk& same = fresh;

    target.sdk = source.sdk;
    fresh = same;

    EXPECT_EQ(target.sdk.getScene(), scene);
    EXPECT_EQ(target.sdk.getNumberOfNulls(), 1);
    EXPECT_EQ(fresh.getScene(), nullptr);
}

TEST(SdkObjects, BelongToTheCaller) {
    FbxSdk sdk;
    fbxsdk::FbxManager* manager = nullptr;
    fbxsdk::FbxScene* scene = nullptr;

    EXPECT_TRUE(sdk.initializeSdkObjects(&manager, &scene));

    ASSERT_NE(manager, nullptr);
    ASSERT_NE(scene, nullptr);
    EXPECT_EQ(scene->GetFbxManager(), manager);
    EXPECT_EQ(sdk.getScene(), nullptr);
    EXPECT_TRUE(sdk.destroySdkObjects(&manager));
    EXPECT_EQ(manager, nullptr);
    EXPECT_TRUE(sdk.destroySdkObjects(&manager));
    EXPECT_TRUE(sdk.destroySdkObjects(nullptr));
    EXPECT_FALSE(sdk.initializeSdkObjects(nullptr, nullptr));
}

// ---- Loading ----

TEST(Loading, FailsOnAContextThatIsNotInitialised) {
    FbxSdk sdk;

    EXPECT_FALSE(sdk.loadScene(dataFile("camera_7400_ascii.fbx"), true));

    EXPECT_THAT(lastError(), HasSubstr("camera_7400_ascii.fbx"));
}

TEST(Loading, FailsForAMissingFileAndSaysWhich) {
    FbxSdk sdk;
    ASSERT_TRUE(sdk.initFbxSdkManager());

    EXPECT_FALSE(sdk.loadScene(dataFile("there is no such file.fbx"), true));

    EXPECT_THAT(lastError(), HasSubstr("there is no such file.fbx"));
}

TEST(Loading, FailsForAFileThatIsNoFbxAndForAnEmptyName) {
    FbxSdk sdk;
    ASSERT_TRUE(sdk.initFbxSdkManager());

    EXPECT_FALSE(sdk.loadScene(dataFile("README.md"), true));
    EXPECT_THAT(lastError(), HasSubstr("README.md"));
    EXPECT_FALSE(sdk.loadScene(std::string(), true));
    EXPECT_FALSE(lastError().empty());
}

TEST(Loading, FailsWithoutAManagerOrAScene) {
    TestScene scene;

    EXPECT_FALSE(scene.sdk.loadScene(nullptr, scene.scene, dataFile("camera_7400_ascii.fbx")));
    EXPECT_FALSE(scene.sdk.loadScene(scene.scene->GetFbxManager(), nullptr, dataFile("camera_7400_ascii.fbx")));
}

TEST(Loading, ClearsTheLastErrorAfterASuccess) {
    FbxSdk sdk;
    ASSERT_TRUE(sdk.initFbxSdkManager());
    EXPECT_FALSE(sdk.loadScene("no file", true));
    ASSERT_FALSE(lastError().empty());

    EXPECT_TRUE(sdk.loadScene(dataFile("camera_7400_ascii.fbx"), true));

    EXPECT_TRUE(lastError().empty());
}

TEST(Loading, LeavesAFileInCentimetresWithYUpAsItIs) {
    LoadedFile file("nulls_7400_ascii.fbx");

    expectPosition(file.transform("parent", true), 1.0f, 2.0f, 3.0f);
    expectPosition(file.transform("child", false), 10.0f, 0.0f, 0.0f);
    expectPosition(file.transform("child", true), 11.0f, 2.0f, 3.0f);
}

TEST(Loading, ScalesAFileInMetresToCentimetres) {
    LoadedFile file("nulls_metres_7400_ascii.fbx");

    expectPosition(file.transform("parent", true), 100.0f, 200.0f, 300.0f);
    expectPosition(file.transform("child", false), 10.0f, 0.0f, 0.0f);
    expectPosition(file.transform("child", true), 1100.0f, 200.0f, 300.0f);
    EXPECT_EQ(file.sdk.getScene()->GetGlobalSettings().GetSystemUnit().GetScaleFactor(), 1.0);
}

TEST(Loading, TurnsAFileWithZUpToYUp) {
    LoadedFile file("nulls_z_up_7400_ascii.fbx");

    expectPosition(file.transform("parent", true), 1.0f, 3.0f, -2.0f);
    expectPosition(file.transform("child", false), 10.0f, 0.0f, 0.0f);
    expectPosition(file.transform("child", true), 11.0f, 3.0f, -2.0f);
}

TEST(Loading, ImportsAsItIsAtTheLowLevel) {
    FbxSdk sdk;
    fbxsdk::FbxManager* manager = nullptr;
    fbxsdk::FbxScene* scene = nullptr;
    ASSERT_TRUE(sdk.initializeSdkObjects(&manager, &scene));

    EXPECT_TRUE(sdk.loadScene(manager, scene, dataFile("nulls_metres_7400_ascii.fbx"))) << lastError();

    EXPECT_EQ(scene->GetGlobalSettings().GetSystemUnit().GetScaleFactor(), 100.0);
    EXPECT_EQ(scene->GetRootNode()->GetChildCount(), 1);
    EXPECT_EQ(manager->GetIOSettings(), nullptr); // the import settings are not attached to anything
    EXPECT_TRUE(sdk.destroySdkObjects(&manager));
}

TEST(Loading, AddsASecondFileToTheSameScene) {
    LoadedFile file("nulls_7400_ascii.fbx");

    EXPECT_TRUE(file.sdk.loadScene(dataFile("nulls_7400_ascii.fbx"), true));

    EXPECT_EQ(file.sdk.getNumberOfNulls(), 4);
}

TEST(Loading, GivesAFileWithoutAStackOneWithALayer) {
    LoadedFile file("nulls_7400_ascii.fbx");
    Names names;

    EXPECT_TRUE(file.sdk.getAnimationStackNames(names));

    EXPECT_THAT(names, ElementsAre("Take 001"));
    auto* stack = file.sdk.getScene()->GetSrcObject<fbxsdk::FbxAnimStack>(0);
    ASSERT_EQ(stack->GetSrcObjectCount<fbxsdk::FbxAnimLayer>(), 1);
    EXPECT_STREQ(stack->GetSrcObject<fbxsdk::FbxAnimLayer>(0)->GetName(), "Default Layer");
}

TEST(Loading, MakesMeshesOfNurbsOnlyWhenAsked) {
    EXPECT_EQ(LoadedFile("nurbs_7400_ascii.fbx", /*convertGeometry*/ true).sdk.getNumberOfMeshes(), 1);

    LoadedFile asItIs("nurbs_7400_ascii.fbx", /*convertGeometry*/ false);
    EXPECT_EQ(asItIs.sdk.getNumberOfMeshes(), 0);
    EXPECT_EQ(asItIs.sdk.getNumberOfNodeTypes(kNurbs), 1);
    EXPECT_TRUE(asItIs.sdk.convertNurbsAndPatch(asItIs.sdk.getScene()->GetFbxManager(), asItIs.sdk.getScene()));
    EXPECT_EQ(asItIs.sdk.getNumberOfMeshes(), 1);
}

TEST(Loading, MakesMeshesOfPatchesOnlyWhenAsked) {
    TestScene scene;
    addPatch(scene, "patch", scene.addNode("parent"));

    EXPECT_TRUE(scene.sdk.loadScene(dataFile("nulls_7400_ascii.fbx"), /*convertGeometry*/ false)) << lastError();
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kPatches), 1);
    EXPECT_EQ(scene.sdk.getNumberOfMeshes(), 0);

    EXPECT_TRUE(scene.sdk.loadScene(dataFile("nulls_7400_ascii.fbx"), /*convertGeometry*/ true)) << lastError();
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kPatches), 0);
    EXPECT_EQ(scene.sdk.getNumberOfMeshes(), 1);
}

TEST(NurbsConversion, MakesAMeshOfAPatchBelowAnotherNode) {
    TestScene scene;
    fbxsdk::FbxNode* parent = addTriangle(scene, "parent");
    fbxsdk::FbxNode* node = addPatch(scene, "patch", parent);
    ASSERT_EQ(scene.sdk.getNumberOfNodeTypes(kPatches), 1);
    ASSERT_EQ(scene.sdk.getNumberOfNodeTypes(kMeshes), 1);

    EXPECT_TRUE(scene.sdk.convertNurbsAndPatch(scene.scene->GetFbxManager(), scene.scene));

    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kPatches), 0);
    EXPECT_EQ(scene.sdk.getNumberOfNodeTypes(kMeshes), 2);
    ASSERT_NE(node->GetMesh(), nullptr);
    EXPECT_TRUE(node->GetMesh()->IsTriangleMesh());
    EXPECT_GT(node->GetMesh()->GetPolygonCount(), 0);
}

TEST(NurbsConversion, LeavesMeshesAndNurbsSurfacesAsTheyAre) {
    TestScene scene;
    fbxsdk::FbxNode* quad = scene.add<fbxsdk::FbxMesh>("quad");
    test::fillMesh(*quad->GetMesh(), {std::begin(kUnitSquare), std::end(kUnitSquare)}, {{0, 1, 3, 2}});
    fbxsdk::FbxNode* surface = addNurbsSurface(scene, "surface");
    fbxsdk::FbxNodeAttribute* attributes[] = {quad->GetNodeAttribute(), surface->GetNodeAttribute()};
    for (fbxsdk::FbxNodeAttribute* attribute : attributes) {
        fbxsdk::FbxGeometryConverter converter(scene.scene->GetFbxManager());
        ASSERT_NE(converter.Triangulate(attribute, /*pReplace*/ false), nullptr) << "it could be made triangles";
    }

    EXPECT_TRUE(scene.sdk.convertNurbsAndPatch(scene.scene->GetFbxManager(), scene.scene));

    EXPECT_EQ(quad->GetNodeAttribute(), attributes[0]);
    EXPECT_EQ(quad->GetMesh()->GetPolygonSize(0), 4);
    EXPECT_EQ(surface->GetNodeAttribute(), attributes[1]);
}

TEST(NurbsConversion, FindsNothingInNoSceneAndBelowNoNode) {
    TestScene scene;

    EXPECT_TRUE(scene.sdk.convertNurbsAndPatch(scene.scene->GetFbxManager(), nullptr));
    EXPECT_TRUE(scene.sdk.convertNurbsAndPatchRecursive(scene.scene->GetFbxManager(), nullptr));
}

// ---- Animation stacks ----

TEST(AnimationStacks, FirstOneIsSelectedAndGetsALayer) {
    FbxSdk sdk;
    ASSERT_TRUE(sdk.initFbxSdkManager());
    fbxsdk::FbxAnimStack* first = fbxsdk::FbxAnimStack::Create(sdk.getScene(), "first");
    fbxsdk::FbxAnimStack* second = fbxsdk::FbxAnimStack::Create(sdk.getScene(), "second");
    first->SetLocalTimeSpan(fbxsdk::FbxTimeSpan(timeOfFrame(0), timeOfFrame(24)));

    sdk.initCreateAnimationStack();

    Names names;
    EXPECT_TRUE(sdk.getAnimationStackNames(names));
    EXPECT_THAT(names, ElementsAre("first", "second"));
    EXPECT_EQ(first->GetSrcObjectCount<fbxsdk::FbxAnimLayer>(), 1);
    EXPECT_STREQ(first->GetSrcObject<fbxsdk::FbxAnimLayer>(0)->GetName(), "Default Layer");
    EXPECT_EQ(second->GetSrcObjectCount<fbxsdk::FbxAnimLayer>(), 0);
}

TEST(AnimationStacks, KeepTheLayersTheyHave) {
    TestScene scene;
    scene.addLayer();

    scene.sdk.initCreateAnimationStack();

    EXPECT_EQ(scene.stack->GetSrcObjectCount<fbxsdk::FbxAnimLayer>(), 2);
}

TEST(AnimationStacks, AreSelectedByTheirExactName) {
    TestScene scene(0, 10);
    fbxsdk::FbxAnimStack* other = fbxsdk::FbxAnimStack::Create(scene.scene, "other");
    other->SetLocalTimeSpan(fbxsdk::FbxTimeSpan(timeOfFrame(3), timeOfFrame(4)));

    EXPECT_TRUE(scene.sdk.setCurrentAnimationStack("other"));
    expectTime(scene.time(), 0.0f, 3, 4, 24.0f);
    EXPECT_TRUE(scene.sdk.setCurrentAnimationStack("Take 001"));
    expectTime(scene.time(), 0.0f, 0, 10, 24.0f);
}

TEST(AnimationStacks, StaySelectedWhenTheNameIsUnknown) {
    TestScene scene(0, 10);

    EXPECT_FALSE(scene.sdk.setCurrentAnimationStack("take 001"));
    EXPECT_THAT(lastError(), HasSubstr("take 001"));
    EXPECT_FALSE(scene.sdk.setCurrentAnimationStack(""));

    expectTime(scene.time(), 0.0f, 0, 10, 24.0f);
}

TEST(AnimationStacks, AreNoneInASceneWithoutAny) {
    FbxSdk sdk;
    Names names = {"to be removed"};
    EXPECT_FALSE(sdk.getAnimationStackNames(names));
    EXPECT_THAT(names, IsEmpty());
    EXPECT_FALSE(sdk.setCurrentAnimationStack("Take 001"));

    ASSERT_TRUE(sdk.initFbxSdkManager());
    names = {"to be removed"};
    EXPECT_TRUE(sdk.getAnimationStackNames(names));
    EXPECT_THAT(names, IsEmpty());
    EXPECT_FALSE(sdk.setCurrentAnimationStack("Take 001"));
}

TEST(AnimationStacks, AreNotMadeWithoutAScene) {
    FbxSdk sdk;
    sdk.initCreateAnimationStack();
    EXPECT_EQ(sdk.getScene(), nullptr);
}

// ---- The range of frames ----

TEST(StackTime, IsTheSpanOfTheStackAtTheRateOfTheScene) {
    TestScene scene(0, 10);
    TnFbxTime time;

    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 2.5f, false, 48.0f));
    expectTime(time, 2.5f, 0, 10, 24.0f);
    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 2.5f, true, 0.0f));
    expectTime(time, 2.5f, 0, 10, 24.0f);
    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 2.5f, true, std::numeric_limits<float>::quiet_NaN()));
    expectTime(time, 2.5f, 0, 10, 24.0f);
}

TEST(StackTime, IsConvertedToTheSampleRate) {
    TestScene scene(0, 10);
    TnFbxTime time;

    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 0.0f, true, 48.0f));

    expectTime(time, 0.0f, 0, 20, 48.0f);
}

TEST(StackTime, IsConvertedInSinglePrecisionAndTruncated) {
    TestScene scene(1, 7);
    TnFbxTime time;

    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 0.0f, true, 25.0f));
    expectTime(time, 0.0f, 1, 7, 25.0f);

    scene.setSpan(-7, -1);
    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 0.0f, true, 25.0f));
    expectTime(time, 0.0f, -7, -1, 25.0f);
}

TEST(StackTime, IsDividedByTheRateOfTheSceneBeforeItIsMultiplied) {
    TestScene scene;
    fbxsdk::FbxTime first, last;
    first.SetFrame(63, fbxsdk::FbxTime::eFrames30);
    last.SetFrame(123, fbxsdk::FbxTime::eFrames30);
    scene.scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames30);
    scene.stack->SetLocalTimeSpan(fbxsdk::FbxTimeSpan(first, last));
    TnFbxTime time;

    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 0.0f, true, 60.0f));

    expectTime(time, 0.0f, 125, 246, 60.0f);
}

TEST(StackTime, SurvivesASpanOfAllTimes) {
    TestScene scene;
    const fbxsdk::FbxTimeSpan span(fbxsdk::FBXSDK_TIME_MINUS_INFINITE, fbxsdk::FBXSDK_TIME_INFINITE);
    scene.stack->SetLocalTimeSpan(span);
    scene.addNode("node");
    TnFbxTime time;

    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 0.0f, false, 0.0f));
    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 0.0f, true, 1e30f));
    for (const bool global : {false, true}) {
        TnFbxReadInfo info = test::readAll(global);
        TnFbxTransform transform;
        EXPECT_TRUE(scene.sdk.getTransforms(info, &transform, 1));
        EXPECT_TRUE(transform.getTransformChannel(TnFbxTransform::kFbxTransformPositionX)->isConstant());
    }
}

TEST(StackTime, IsANewRecordWithoutAContextOrAStack) {
    FbxSdk sdk;
    TnFbxTime time;
    time.setTime(1.0f, 2, 3, 4.0f);
    EXPECT_FALSE(sdk.getGlobalAnimationStackTime(time, 9.0f, false, 0.0f));
    expectTime(time, 0.0f, 0, 0, 24.0f);

    ASSERT_TRUE(sdk.initFbxSdkManager());
    EXPECT_FALSE(sdk.getGlobalAnimationStackTime(time, 9.0f, false, 0.0f));
    expectTime(time, 0.0f, 0, 0, 24.0f);
}

TEST(StackTime, FollowsTheTimeModeOfTheScene) {
    TestScene scene(0, 24);
    scene.scene->GetGlobalSettings().SetTimeMode(fbxsdk::FbxTime::eFrames60);

    expectTime(scene.time(), 0.0f, 0, 60, 60.0f);
}

} // namespace
} // namespace Tarnell::Fbx
