// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Writing lights: colour, intensity, cone, decay and the rotation of the node, by type.
#include "support/WritingBuilders.h"

#include "TnFbxError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace Tarnell::Fbx {
namespace {

using test::timeOf;
using test::valuesOf;
using test::WrittenScene;
using testing::ElementsAre;
using testing::IsEmpty;
using Light = TnFbxLight;
using SceneLight = fbxsdk::FbxLight;

struct LightScene : WrittenScene {
    explicit LightScene(Light::EFbxLightType type) {
        prepareStack();
        light.setLightType(type);
        node = sdk.createLight(scene, type, "light");
        target = node->GetLight();
    }
    bool write() { return sdk.setLightCurveValues(node, &light); }

    Light light;
    fbxsdk::FbxNode* node;
    SceneLight* target;
};

TEST(LightWriting, SetsAndKeysTheColourWithoutAlpha) {
    LightScene scene(Light::kFbxLightPoint);
    scene.light.setValue(Light::kFbxLightRed, 0.25f);
    scene.light.setValue(Light::kFbxLightGreen, 0.5f);
    scene.light.setValue(Light::kFbxLightBlue, 0.75f);
    scene.light.setValueAt(Light::kFbxLightGreen, timeOf(1, 2), {0.1f, 0.2f});
    scene.light.setValueAt(Light::kFbxLightAlpha, timeOf(1, 2), {0.3f, 0.4f});

    EXPECT_TRUE(scene.write());

    const fbxsdk::FbxDouble3 colour = scene.target->Color.Get();
    EXPECT_EQ(colour[0], 0.25);
    EXPECT_EQ(colour[1], 0.5);
    EXPECT_EQ(colour[2], 0.75);
    EXPECT_THAT(valuesOf(scene.curve(scene.target->Color, "X")), IsEmpty());
    EXPECT_THAT(valuesOf(scene.curve(scene.target->Color, "Y")), ElementsAre(0.1f, 0.2f));
    EXPECT_THAT(valuesOf(scene.curve(scene.target->Color, "Z")), IsEmpty());
}

TEST(LightWriting, TurnsIntensityIntoPercentButNotTheDefaultOfTheCurve) {
    LightScene scene(Light::kFbxLightPoint);
    scene.light.setValue(Light::kFbxLightIntensity, 1.5f);
    scene.light.setValueAt(Light::kFbxLightIntensity, timeOf(1, 2), {0.5f, 2.0f});

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->Intensity.Get(), 150.0);
    EXPECT_THAT(valuesOf(scene.curve(scene.target->Intensity)), ElementsAre(50.0f, 200.0f));
    EXPECT_EQ(scene.curve(scene.target->Intensity)->GetValue(), 1.5f);
}

TEST(LightWriting, DividesTheIntensityInSinglePrecision) {
    LightScene scene(Light::kFbxLightPoint);
    scene.light.setValue(Light::kFbxLightIntensity, 0.09f); // 0.09 · 100 is 9 exactly

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.target->Intensity.Get(), 9.000000953674316);
}

TEST(LightWriting, WritesTheConeOfSpotLightsOnly) {
    const double otherwise = LightScene(Light::kFbxLightPoint).target->OuterAngle.Get();
    for (const auto type : {Light::kFbxLightPoint, Light::kFbxLightDirectional, Light::kFbxLightSpot}) {
        LightScene scene(type);
        scene.light.setValue(Light::kFbxLightConeAngle, 33.0f);
        scene.light.setValueAt(Light::kFbxLightConeAngle, timeOf(1, 2), {10.0f, 20.0f});

        EXPECT_TRUE(scene.write());

        const bool spot = type == Light::kFbxLightSpot;
        EXPECT_EQ(scene.target->OuterAngle.Get(), spot ? 33.0 : otherwise);
        EXPECT_EQ(valuesOf(scene.curve(scene.target->OuterAngle)),
                  spot ? (std::vector<float>{10.0f, 20.0f}) : std::vector<float>());
    }
}

SceneLight::EDecayType decayFor(Light::EFbxLightType type, int decay) {
    LightScene scene(type);
    scene.light.setDecayType(static_cast<Light::EFbxLightDecayType>(decay));
    EXPECT_TRUE(scene.write());
    return scene.target->DecayType.Get();
}

TEST(LightWriting, WritesTheDecayOfPointAndSpotLights) {
    for (const auto type : {Light::kFbxLightPoint, Light::kFbxLightSpot}) {
        EXPECT_EQ(decayFor(type, Light::kFbxLightDecayNone), SceneLight::eNone);
        EXPECT_EQ(decayFor(type, Light::kFbxLightDecayLinear), SceneLight::eLinear);
        EXPECT_EQ(decayFor(type, Light::kFbxLightDecayQuadratic), SceneLight::eQuadratic);
        EXPECT_EQ(decayFor(type, Light::kFbxLightDecayCubic), SceneLight::eCubic);
    }
}

TEST(LightWriting, LeavesTheDecayOfDirectionalLightsAndWhatIsNoDecay) {
    const SceneLight::EDecayType otherwise = LightScene(Light::kFbxLightPoint).target->DecayType.Get();

    EXPECT_EQ(decayFor(Light::kFbxLightDirectional, Light::kFbxLightDecayCubic), otherwise);
    EXPECT_EQ(decayFor(Light::kFbxLightSpot, 4), otherwise);
    EXPECT_EQ(decayFor(static_cast<Light::EFbxLightType>(3), Light::kFbxLightDecayCubic), otherwise);
}

TEST(LightWriting, TurnsDirectionalAndSpotLightsAboutX) {
    constexpr auto kNoType = static_cast<Light::EFbxLightType>(3);
    for (const auto type : {Light::kFbxLightPoint, Light::kFbxLightDirectional, Light::kFbxLightSpot, kNoType}) {
        LightScene scene(type);
        EXPECT_TRUE(scene.write());

        const fbxsdk::FbxVector4 turn = scene.node->GetPostRotation(fbxsdk::FbxNode::eSourcePivot);
        const bool turned = type == Light::kFbxLightDirectional || type == Light::kFbxLightSpot;
        EXPECT_EQ(turn[0], turned ? -90.0 : 0.0);
        EXPECT_EQ(turn[1], 0.0);
        EXPECT_EQ(turn[2], 0.0);
        EXPECT_EQ(scene.node->GetRotationActive(), turned);
    }
}

TEST(LightWriting, WritesTheTransformToo) {
    LightScene scene(Light::kFbxLightPoint);
    scene.light.setTransformValue(TnFbxTransform::kFbxTransformPositionY, 3.0f);

    EXPECT_TRUE(scene.write());

    EXPECT_EQ(scene.node->LclTranslation.Get()[1], 3.0);
}

TEST(LightWriting, NeedsANodeWithALight) {
    LightScene scene(Light::kFbxLightPoint);
    scene.light.setTransformValue(TnFbxTransform::kFbxTransformPositionY, 3.0f);
    fbxsdk::FbxNode* null = scene.sdk.createNull(scene.manager, "null");

    EXPECT_FALSE(scene.sdk.setLightCurveValues(nullptr, &scene.light));
    EXPECT_FALSE(scene.sdk.setLightCurveValues(scene.node, nullptr));
    EXPECT_FALSE(scene.sdk.setLightCurveValues(null, &scene.light));
    EXPECT_FALSE(lastError().empty());
    EXPECT_EQ(null->LclTranslation.Get()[1], 0.0) << "found out before anything is written";
}

} // namespace
} // namespace Tarnell::Fbx
