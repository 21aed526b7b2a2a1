// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Building a scene: the fixed global settings, the one stack, and which objects become nodes in which order.
#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace Tarnell::Fbx {
namespace {

using test::polygonMesh;
using test::writeInfo;
using test::WrittenObjects;
using test::WrittenScene;
using testing::ElementsAre;
using testing::IsEmpty;
using Names = std::vector<std::string>;
using Time = fbxsdk::FbxTime;

template <class Object>
Object named(const char* name) {
    Object object;
    object.setName(name);
    return object;
}

/// One object of each kind, two of them with a null pointer in between.
struct OneOfEachKind {
    OneOfEachKind() : mesh(polygonMesh("mesh")) {
        objects.cameras = {&camera};
        objects.lights = {&light};
        objects.transforms = {&transform};
        objects.nulls = {&null};
        objects.meshes = {mesh.get()};
    }
    TnFbxCamera camera = named<TnFbxCamera>("camera");
    TnFbxLight light = named<TnFbxLight>("light");
    TnFbxTransform transform = named<TnFbxTransform>("transform");
    TnFbxNull null = named<TnFbxNull>("null");
    std::unique_ptr<TnFbxMesh> mesh;
    WrittenObjects objects;
};

// ---- Nodes ----

TEST(SceneConstruction, OfNothingHasSettingsAStackAndNoNodes) {
    WrittenScene scene;
    const WrittenObjects nothing;

    EXPECT_TRUE(scene.create(nothing));

    EXPECT_THAT(scene.childNames(), IsEmpty());
    Names stacks;
    EXPECT_TRUE(scene.sdk.getAnimationStackNames(stacks));
    EXPECT_THAT(stacks, ElementsAre("Take 001"));
    EXPECT_TRUE(scene.scene->GlobalLightSettings().GetFogEnable());
    EXPECT_EQ(scene.scene->GetGlobalSettings().GetTimeMode(), Time::eFrames24);
}

TEST(SceneConstruction, AddsTheKindsInAFixedOrder) {
    WrittenScene scene;
    OneOfEachKind one;

    EXPECT_TRUE(scene.create(one.objects));

    EXPECT_THAT(scene.childNames(), ElementsAre("camera", "light", "transform", "null", "mesh"));
    EXPECT_NE(scene.child(0)->GetCamera(), nullptr);
    EXPECT_NE(scene.child(1)->GetLight(), nullptr);
    EXPECT_NE(scene.child(2)->GetNull(), nullptr);
    EXPECT_NE(scene.child(3)->GetNull(), nullptr);
    EXPECT_NE(scene.child(4)->GetMesh(), nullptr);
}

TEST(SceneConstruction, KeepsTheOrderOfTheListsAndSkipsNullPointers) {
    WrittenScene scene;
    TnFbxNull first = named<TnFbxNull>("b"), second = named<TnFbxNull>("a"), third = named<TnFbxNull>("b");
    WrittenObjects objects;
    objects.cameras = {nullptr};
    objects.lights = {nullptr};
    objects.transforms = {nullptr};
    objects.nulls = {&first, nullptr, &second, &third, nullptr};
    objects.meshes = {nullptr};

    EXPECT_TRUE(scene.create(objects));

    EXPECT_THAT(scene.childNames(), ElementsAre("b", "a", "b"));
}

TEST(SceneConstruction, WritesOnlyTheRequestedKinds) {
    using Setter = bool (TnFbxWriteInfo::*)(bool);
    const std::pair<Setter, const char*> flags[] = {{&TnFbxWriteInfo::setWriteCameras, "camera"},
                                                    {&TnFbxWriteInfo::setWriteLights, "light"},
                                                    {&TnFbxWriteInfo::setWriteTransforms, "transform"},
                                                    {&TnFbxWriteInfo::setWriteNulls, "null"},
                                                    {&TnFbxWriteInfo::setWriteMeshes, "mesh"}};
    OneOfEachKind one;
    for (const auto& [wanted, name] : flags) {
        TnFbxWriteInfo info = writeInfo();
        for (const auto& flag : flags)
            (info.*flag.first)(flag.first == wanted);
        WrittenScene scene;
        EXPECT_TRUE(scene.create(one.objects, info));
        EXPECT_THAT(scene.childNames(), ElementsAre(name));
    }
}

TEST(SceneConstruction, WritesNothingWithAllKindsOff) {
    WrittenScene scene;
    OneOfEachKind one;
    TnFbxWriteInfo info = writeInfo();
    info.setWriteCameras(false);
    info.setWriteLights(false);
    info.setWriteTransforms(false);
    info.setWriteNulls(false);
    info.setWriteMeshes(false);

    EXPECT_TRUE(scene.create(one.objects, info));

    EXPECT_THAT(scene.childNames(), IsEmpty());
}

TEST(SceneConstruction, LeavesMeshesWithoutGeometryOut) {
    WrittenScene scene;
    TnFbxMesh empty = named<TnFbxMesh>("empty");
    const auto mesh = polygonMesh("mesh");
    WrittenObjects objects;
    objects.meshes = {&empty, mesh.get()};

    EXPECT_TRUE(scene.create(objects));

    EXPECT_THAT(scene.childNames(), ElementsAre("mesh"));
}

TEST(SceneConstruction, WritesATransformAsANullOfDefaultLookAndSize) {
    WrittenScene scene;
    TnFbxTransform transform = named<TnFbxTransform>("transform");
    WrittenObjects objects;
    objects.transforms = {&transform};

    EXPECT_TRUE(scene.create(objects));

    fbxsdk::FbxNull* null = scene.child()->GetNull();
    ASSERT_NE(null, nullptr);
    EXPECT_EQ(null->Size.Get(), 100.0);
    EXPECT_EQ(null->Look.Get(), fbxsdk::FbxNull::eCross);
}

TEST(SceneConstruction, WritesNoTransformOfAMesh) {
    WrittenScene scene;
    const auto mesh = polygonMesh("mesh");
    mesh->setTransformValue(TnFbxTransform::kFbxTransformPositionX, 5.0f);
    mesh->setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderYXZ);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};

    EXPECT_TRUE(scene.create(objects));

    EXPECT_EQ(scene.child()->LclTranslation.Get()[0], 0.0);
    EXPECT_EQ(scene.curve(scene.child()->LclTranslation, "X"), nullptr);
    fbxsdk::FbxEuler::EOrder order = fbxsdk::FbxEuler::eOrderZYX;
    scene.child()->GetRotationOrder(fbxsdk::FbxNode::eSourcePivot, order);
    EXPECT_EQ(order, fbxsdk::FbxEuler::eOrderXYZ);
}

TEST(SceneConstruction, PutsEveryNodeAndAttributeIntoTheScene) {
    WrittenScene scene;
    OneOfEachKind one;

    EXPECT_TRUE(scene.create(one.objects));

    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(scene.child(i)->GetScene(), scene.scene) << i;
        EXPECT_EQ(scene.child(i)->GetNodeAttribute()->GetScene(), scene.scene) << i;
    }
}

TEST(SceneConstruction, WritesIntoTheOneStackWhateverItsName) {
    WrittenScene scene;
    TnFbxNull null = named<TnFbxNull>("null");
    null.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, test::timeOf(1, 2), {1.0f, 2.0f});
    WrittenObjects objects;
    objects.nulls = {&null};
    TnFbxWriteInfo info = writeInfo();
    info.setAnimationStackName("walk");

    EXPECT_TRUE(scene.create(objects, info));

    Names stacks;
    EXPECT_TRUE(scene.sdk.getAnimationStackNames(stacks));
    EXPECT_THAT(stacks, ElementsAre("Take 001"));
    EXPECT_STREQ(scene.layer()->GetName(), "Default Layer");
    EXPECT_THAT(test::valuesOf(scene.curve(scene.child()->LclTranslation, "X")), ElementsAre(1.0f, 2.0f));
    EXPECT_TRUE(lastError().empty()) << lastError();
}

TEST(SceneConstruction, SelectsAStackThatHasTheName) {
    WrittenScene scene;
    fbxsdk::FbxAnimStack::Create(scene.scene, "first");
    auto* walk = fbxsdk::FbxAnimStack::Create(scene.scene, "walk");
    auto* walkLayer = fbxsdk::FbxAnimLayer::Create(scene.scene, "walk layer");
    walk->AddMember(walkLayer);
    TnFbxNull null = named<TnFbxNull>("null");
    null.setTransformValueAt(TnFbxTransform::kFbxTransformPositionX, test::timeOf(1, 2), {1.0f, 2.0f});
    WrittenObjects objects;
    objects.nulls = {&null};
    TnFbxWriteInfo info = writeInfo();
    info.setAnimationStackName("walk");

    EXPECT_TRUE(scene.create(objects, info));

    fbxsdk::FbxProperty translation = scene.child()->LclTranslation;
    EXPECT_NE(translation.GetCurve(walkLayer, translation.GetName(), "X", false), nullptr);
    EXPECT_EQ(scene.curve(translation, "X"), nullptr) << "the first stack has no curves";
}

TEST(SceneConstruction, FailsWithoutAManager) {
    FbxSdk sdk;

    EXPECT_FALSE(sdk.createScene(writeInfo(), {}, {}, {}, {}, {}));

    EXPECT_FALSE(lastError().empty());
}

TEST(SceneConstruction, AllowsEmptyAndLongAndForeignNames) {
    WrittenScene scene;
    const std::string endless(100000, 'n');
    TnFbxNull unnamed, longNamed = named<TnFbxNull>(endless.c_str()), foreign = named<TnFbxNull>("Würfel ☃ \"quoted\"");
    WrittenObjects objects;
    objects.nulls = {&unnamed, &longNamed, &foreign};

    EXPECT_TRUE(scene.create(objects));

    EXPECT_THAT(scene.childNames(), ElementsAre("", endless, "Würfel ☃ \"quoted\""));
}

TEST(SceneConstruction, WritesTheSameObjectTwiceWhenItIsListedTwice) {
    WrittenScene scene;
    TnFbxNull null = named<TnFbxNull>("null");
    WrittenObjects objects;
    objects.nulls = {&null, &null};

    EXPECT_TRUE(scene.create(objects));

    EXPECT_THAT(scene.childNames(), ElementsAre("null", "null"));
}

// ---- Settings ----

TEST(EmptySceneConstruction, AppliesTheSettingsAndMakesNeitherStackNorNodes) {
    WrittenScene scene;

    EXPECT_TRUE(scene.sdk.createScene(scene.manager, scene.scene, 25.0f, "walk"));

    EXPECT_EQ(scene.scene->GetGlobalSettings().GetTimeMode(), Time::ePAL);
    EXPECT_TRUE(scene.scene->GlobalLightSettings().GetFogEnable());
    EXPECT_NE(scene.scene->GlobalCameraSettings().GetCameraProducerTop(), nullptr);
    EXPECT_EQ(scene.scene->GetSrcObjectCount<fbxsdk::FbxAnimStack>(), 0);
    EXPECT_THAT(scene.childNames(), IsEmpty());
    EXPECT_TRUE(lastError().empty());
}

TEST(EmptySceneConstruction, SelectsTheStack) {
    WrittenScene scene;
    scene.prepareStack();
    auto* walk = fbxsdk::FbxAnimStack::Create(scene.scene, "walk");
    walk->SetLocalTimeSpan(fbxsdk::FbxTimeSpan(Time(0), Time(2 * fbxsdk::FBXSDK_TC_SECOND)));

    EXPECT_TRUE(scene.sdk.createScene(scene.manager, scene.scene, 24.0f, "walk"));

    TnFbxTime time;
    EXPECT_TRUE(scene.sdk.getGlobalAnimationStackTime(time, 0.0f, false, 0.0f));
    EXPECT_EQ(time.getEndFrame(), 48);
}

TEST(EmptySceneConstruction, FailsWithoutAManagerOrAScene) {
    WrittenScene scene;

    EXPECT_FALSE(scene.sdk.createScene(nullptr, scene.scene, 24.0f, "Take 001"));
    EXPECT_FALSE(scene.sdk.createScene(scene.manager, nullptr, 24.0f, "Take 001"));
    EXPECT_FALSE(lastError().empty());
}

void expectColour(const fbxsdk::FbxColor& colour, double red, double green, double blue, double alpha) {
    EXPECT_EQ(colour.mRed, red);
    EXPECT_EQ(colour.mGreen, green);
    EXPECT_EQ(colour.mBlue, blue);
    EXPECT_EQ(colour.mAlpha, alpha);
}

TEST(GlobalLightSettings, AreAnOrangeAmbientAndAMagentaFog) {
    WrittenScene scene;

    EXPECT_TRUE(scene.sdk.setGlobalLightSettings(scene.scene));

    const fbxsdk::FbxGlobalLightSettings& settings = scene.scene->GlobalLightSettings();
    expectColour(settings.GetAmbientColor(), 1.0, 0.5, 0.2, 1.0);
    EXPECT_TRUE(settings.GetFogEnable());
    EXPECT_EQ(settings.GetFogMode(), fbxsdk::FbxGlobalLightSettings::eLinear);
    EXPECT_EQ(settings.GetFogDensity(), 0.002);
    EXPECT_EQ(settings.GetFogStart(), 0.0);
    EXPECT_EQ(settings.GetFogEnd(), 1000.0);
    expectColour(settings.GetFogColor(), 1.0, 0.0, 1.0, 1.0);
}

TEST(GlobalLightSettings, ReplaceThoseThatTheSceneHad) {
    WrittenScene scene;
    fbxsdk::FbxGlobalLightSettings& settings = scene.scene->GlobalLightSettings();
    settings.SetFogMode(fbxsdk::FbxGlobalLightSettings::eExponential);
    settings.SetFogDensity(0.5);
    settings.SetFogStart(10.0);
    settings.SetFogEnd(20.0);

    EXPECT_TRUE(scene.sdk.setGlobalLightSettings(scene.scene));

    EXPECT_EQ(settings.GetFogMode(), fbxsdk::FbxGlobalLightSettings::eLinear);
    EXPECT_EQ(settings.GetFogDensity(), 0.002);
    EXPECT_EQ(settings.GetFogStart(), 0.0);
    EXPECT_EQ(settings.GetFogEnd(), 1000.0);
}

TEST(GlobalCameraSettings, AreTheSwitcherAndTheProducerCameras) {
    WrittenScene scene;

    EXPECT_TRUE(scene.sdk.setGlobalCameraSettings(scene.scene));

    const fbxsdk::FbxGlobalCameraSettings& settings = scene.scene->GlobalCameraSettings();
    EXPECT_STREQ(settings.GetDefaultCamera(), "Camera Switcher");
    EXPECT_NE(settings.GetCameraProducerPerspective(), nullptr);
    EXPECT_NE(settings.GetCameraProducerTop(), nullptr);
    EXPECT_NE(settings.GetCameraProducerBottom(), nullptr);
    EXPECT_NE(settings.GetCameraProducerFront(), nullptr);
    EXPECT_NE(settings.GetCameraProducerBack(), nullptr);
    EXPECT_NE(settings.GetCameraProducerRight(), nullptr);
    EXPECT_NE(settings.GetCameraProducerLeft(), nullptr);
    EXPECT_THAT(scene.childNames(), IsEmpty());
}

TEST(GlobalSettings, NeedAScene) {
    FbxSdk sdk;

    EXPECT_FALSE(sdk.setGlobalLightSettings(nullptr));
    EXPECT_FALSE(sdk.setGlobalCameraSettings(nullptr));
    EXPECT_FALSE(sdk.setGlobalTimeSettings(nullptr, 24.0f));
    EXPECT_FALSE(lastError().empty());
}

Time::EMode timeModeFor(float framesPerSecond) {
    WrittenScene scene;
    EXPECT_TRUE(scene.sdk.setGlobalTimeSettings(scene.scene, framesPerSecond));
    return scene.scene->GetGlobalSettings().GetTimeMode();
}

TEST(GlobalTimeSettings, MapRatesToModes) {
    EXPECT_EQ(timeModeFor(23.976f), Time::eFilmFullFrame);
    EXPECT_EQ(timeModeFor(24.0f), Time::eFrames24);
    EXPECT_EQ(timeModeFor(25.0f), Time::ePAL);
    EXPECT_EQ(timeModeFor(29.9700262f), Time::eNTSCDropFrame);
    EXPECT_EQ(timeModeFor(30.0f), Time::eFrames30);
    EXPECT_EQ(timeModeFor(48.0f), Time::eFrames48);
    EXPECT_EQ(timeModeFor(50.0f), Time::eFrames50);
    EXPECT_EQ(timeModeFor(60.0f), Time::eFrames60);
    EXPECT_EQ(timeModeFor(100.0f), Time::eFrames100);
    EXPECT_EQ(timeModeFor(120.0f), Time::eFrames120);
    EXPECT_EQ(timeModeFor(1000.0f), Time::eFrames1000);
}

TEST(GlobalTimeSettings, TolerateAHundredThousandth) {
    EXPECT_EQ(timeModeFor(24.000005f), Time::eFrames24);
    EXPECT_EQ(timeModeFor(23.999995f), Time::eFrames24);
    EXPECT_EQ(timeModeFor(24.00002f), Time::eCustom);
    EXPECT_EQ(timeModeFor(23.976024f), Time::eCustom) << "24000/1001 is not 23.976";
}

TEST(GlobalTimeSettings, TakeARoundedNtscRateForACustomOneWithoutARate) {
    WrittenScene scene;
    EXPECT_TRUE(scene.sdk.setGlobalTimeSettings(scene.scene, 29.97f));

    EXPECT_EQ(scene.scene->GetGlobalSettings().GetTimeMode(), Time::eCustom);
    EXPECT_EQ(scene.scene->GetGlobalSettings().GetCustomFrameRate(), -1.0);
}

TEST(GlobalTimeSettings, TakeWhatIsNoRateForACustomOne) {
    EXPECT_EQ(timeModeFor(0.0f), Time::eCustom);
    EXPECT_EQ(timeModeFor(-24.0f), Time::eCustom);
    EXPECT_EQ(timeModeFor(std::numeric_limits<float>::quiet_NaN()), Time::eCustom);
    EXPECT_EQ(timeModeFor(std::numeric_limits<float>::infinity()), Time::eCustom);
}

} // namespace
} // namespace Tarnell::Fbx
