// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Reading lights, markers and nulls from nodes.
#include "support/SceneBuilders.h"

#include "TnFbxError.h"

#include <gtest/gtest.h>

#include <limits>

namespace Tarnell::Fbx {
namespace {

using test::samplesOf;
using test::TestScene;
using Light = TnFbxLight;
using Marker = TnFbxMarker;
using Samples = std::vector<float>;

template <class Object>
using Reader = bool (FbxSdk::*)(TnFbxTime&, bool, bool, float, fbxsdk::FbxNode*, Object&, fbxsdk::FbxAMatrix&);

/// Reads a node's object locally over the stack's range, with key frames converted to a sample rate if there is one.
template <class Object>
bool readInto(TestScene& scene, Reader<Object> reader, fbxsdk::FbxNode* node, Object& object, bool global = false,
              float sampleRate = 0.0f) {
    TnFbxTime time = scene.time();
    fbxsdk::FbxAMatrix geometric;
    return (scene.sdk.*reader)(time, global, sampleRate > 0.0f, sampleRate, node, object, geometric);
}

Light readLight(TestScene& scene, fbxsdk::FbxNode* node) {
    Light light;
    EXPECT_TRUE(readInto(scene, &FbxSdk::getLight, node, light));
    return light;
}

Marker readMarker(TestScene& scene, fbxsdk::FbxNode* node) {
    Marker marker;
    EXPECT_TRUE(readInto(scene, &FbxSdk::getMarker, node, marker));
    return marker;
}

TnFbxNull readNull(TestScene& scene, fbxsdk::FbxNode* node) {
    TnFbxNull null;
    EXPECT_TRUE(readInto(scene, &FbxSdk::getNull, node, null));
    return null;
}

// ---- Lights ----

TEST(LightExtraction, ReadsNameTransformColourIntensityAndCone) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("key");
    node->LclTranslation.Set({1.0, 2.0, 3.0});
    fbxsdk::FbxLight* source = node->GetLight();
    source->Color.Set({0.25, 0.5, 0.75});
    source->Intensity.Set(250.0);
    source->OuterAngle.Set(33.5);
    source->InnerAngle.Set(11.0);

    const Light light = readLight(scene, node);

    EXPECT_EQ(light.getName(), "key");
    EXPECT_EQ(light.getTransformValue(TnFbxTransform::kFbxTransformPositionZ), 3.0f);
    EXPECT_EQ(light.getValue(Light::kFbxLightRed), 0.25f);
    EXPECT_EQ(light.getValue(Light::kFbxLightGreen), 0.5f);
    EXPECT_EQ(light.getValue(Light::kFbxLightBlue), 0.75f);
    EXPECT_EQ(light.getValue(Light::kFbxLightAlpha), 1.0f);
    EXPECT_EQ(light.getValue(Light::kFbxLightIntensity), 250.0f * 0.01f);
    EXPECT_EQ(light.getValue(Light::kFbxLightConeAngle), 33.5f);
    EXPECT_FALSE(light.getAnimated(Light::kFbxLightIntensity));
}

TEST(LightExtraction, MakesOneOfAnIntensityOfAHundred) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
    node->GetLight()->Intensity.Set(100.0);

    EXPECT_EQ(readLight(scene, node).getValue(Light::kFbxLightIntensity), 1.0f);
}

TEST(LightExtraction, MultipliesTheIntensityInSinglePrecision) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
    node->GetLight()->Intensity.Set(33.3);

    EXPECT_EQ(readLight(scene, node).getValue(Light::kFbxLightIntensity), static_cast<float>(33.3) * 0.01f);
}

TEST(LightExtraction, ScalesEverySampleOfTheIntensity) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
    scene.key(node->GetLight()->Intensity, nullptr, {{0, 0.0f}, {2, 200.0f}});

    const Light light = readLight(scene, node);

    EXPECT_EQ(samplesOf(light, Light::kFbxLightIntensity), Samples({0.0f, 100.0f * 0.01f, 200.0f * 0.01f}));
    test::expectRange(light.getTime(Light::kFbxLightIntensity), 0, 2, 24.0f);
}

TEST(LightExtraction, SamplesColourAndConeButNotTheAlpha) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
    fbxsdk::FbxLight* source = node->GetLight();
    scene.key(source->Color, "X", {{0, 0.0f}, {1, 1.0f}});
    scene.key(source->Color, "Y", {{0, 0.25f}, {1, 0.5f}});
    scene.key(source->Color, "Z", {{0, 1.0f}, {1, 0.0f}});
    scene.key(source->OuterAngle, nullptr, {{0, 30.0f}, {1, 60.0f}});
    Light light;
    light.setValue(Light::kFbxLightAlpha, 0.5f);

    EXPECT_TRUE(readInto(scene, &FbxSdk::getLight, node, light));

    EXPECT_EQ(samplesOf(light, Light::kFbxLightRed), Samples({0.0f, 1.0f}));
    EXPECT_EQ(samplesOf(light, Light::kFbxLightGreen), Samples({0.25f, 0.5f}));
    EXPECT_EQ(samplesOf(light, Light::kFbxLightBlue), Samples({1.0f, 0.0f}));
    EXPECT_EQ(samplesOf(light, Light::kFbxLightConeAngle), Samples({30.0f, 60.0f}));
    EXPECT_FALSE(light.getAnimated(Light::kFbxLightAlpha));
    EXPECT_EQ(light.getValue(Light::kFbxLightAlpha), 1.0f);
}

TEST(LightExtraction, MapsTypesAndReadsAreasAndVolumesAsPoints) {
    struct Row {
        int fbx;
        Light::EFbxLightType type;
    };
    const Row rows[] = {{0, Light::kFbxLightPoint}, {1, Light::kFbxLightDirectional}, {2, Light::kFbxLightSpot},
                        {3, Light::kFbxLightPoint}, {4, Light::kFbxLightPoint},       {99, Light::kFbxLightPoint},
                        {-1, Light::kFbxLightPoint}};
    for (const Row& row : rows) {
        TestScene scene;
        fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
        static_cast<fbxsdk::FbxProperty&>(node->GetLight()->LightType).Set(row.fbx);
        EXPECT_EQ(readLight(scene, node).getLightType(), row.type) << row.fbx;
    }
}

TEST(LightExtraction, MapsDecays) {
    struct Row {
        int fbx;
        Light::EFbxLightDecayType type;
    };
    const Row rows[] = {{0, Light::kFbxLightDecayNone},      {1, Light::kFbxLightDecayLinear},
                        {2, Light::kFbxLightDecayQuadratic}, {3, Light::kFbxLightDecayCubic},
                        {4, Light::kFbxLightDecayNone},      {-1, Light::kFbxLightDecayNone}};
    for (const Row& row : rows) {
        TestScene scene;
        fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
        static_cast<fbxsdk::FbxProperty&>(node->GetLight()->DecayType).Set(row.fbx);
        EXPECT_EQ(readLight(scene, node).getDecayType(), row.type) << row.fbx;
    }
}

TEST(LightExtraction, MakesInfinityOfAnIntensityBeyondTheFloats) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxLight>("light");
    node->GetLight()->Intensity.Set(1e300);

    EXPECT_EQ(readLight(scene, node).getValue(Light::kFbxLightIntensity), std::numeric_limits<float>::infinity());
}

TEST(LightExtraction, FailsWithoutANodeOrALight) {
    TestScene scene;
    Light light;

    EXPECT_FALSE(readInto(scene, &FbxSdk::getLight, nullptr, light));
    EXPECT_FALSE(readInto(scene, &FbxSdk::getLight, scene.addNode("bare"), light));
    EXPECT_FALSE(readInto(scene, &FbxSdk::getLight, scene.add<fbxsdk::FbxCamera>("camera"), light));
    EXPECT_EQ(light.getName(), "");
    EXPECT_FALSE(lastError().empty());
}

// ---- Markers ----

TEST(MarkerExtraction, ReadsNameColourAndSize) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMarker>("marker");
    node->GetNodeAttribute()->Color.Set({0.25, 0.5, 0.75});
    node->GetMarker()->Size.Set(12.5);

    const Marker marker = readMarker(scene, node);

    EXPECT_EQ(marker.getName(), "marker");
    EXPECT_EQ(marker.getValue(Marker::kFbxMarkerRed), 0.25f);
    EXPECT_EQ(marker.getValue(Marker::kFbxMarkerGreen), 0.5f);
    EXPECT_EQ(marker.getValue(Marker::kFbxMarkerBlue), 0.75f);
    EXPECT_EQ(marker.getValue(Marker::kFbxMarkerAlpha), 1.0f);
    EXPECT_EQ(marker.getMarkerSize(), 12.5f);
}

TEST(MarkerExtraction, SamplesTheColourAndNeitherAlphaNorSize) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMarker>("marker");
    scene.key(node->GetNodeAttribute()->Color, "Y", {{0, 0.5f}, {1, 1.0f}});
    scene.key(node->GetMarker()->Size, nullptr, {{0, 5.0f}, {1, 6.0f}});
    node->GetMarker()->Size.Set(4.0);
    Marker marker;
    marker.setValue(Marker::kFbxMarkerAlpha, 0.5f);

    EXPECT_TRUE(readInto(scene, &FbxSdk::getMarker, node, marker));

    EXPECT_EQ(samplesOf(marker, Marker::kFbxMarkerGreen), Samples({0.5f, 1.0f}));
    EXPECT_FALSE(marker.getAnimated(Marker::kFbxMarkerRed));
    EXPECT_FALSE(marker.getAnimated(Marker::kFbxMarkerAlpha));
    EXPECT_EQ(marker.getValue(Marker::kFbxMarkerAlpha), 1.0f);
    EXPECT_EQ(marker.getMarkerSize(), 4.0f);
}

TEST(MarkerExtraction, MapsLooksAndReadsCapsulesAndTheRestAsCubes) {
    const Marker::EFbxMarkerLookType looks[] = {Marker::kFbxMarkerLookCube, Marker::kFbxMarkerLookHardCross,
                                                Marker::kFbxMarkerLookLightCross, Marker::kFbxMarkerLookSphere};
    for (int look = -1; look < 12; ++look) {
        TestScene scene;
        fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxMarker>("marker");
        static_cast<fbxsdk::FbxProperty&>(node->GetMarker()->Look).Set(look);
        EXPECT_EQ(readMarker(scene, node).getMarkerLookType(),
                  look >= 0 && look < 4 ? looks[look] : Marker::kFbxMarkerLookCube)
            << look;
    }
}

TEST(MarkerExtraction, FailsWithoutANodeOrAMarker) {
    TestScene scene;
    Marker marker;

    EXPECT_FALSE(readInto(scene, &FbxSdk::getMarker, nullptr, marker));
    EXPECT_FALSE(readInto(scene, &FbxSdk::getMarker, scene.addNode("bare"), marker));
    EXPECT_FALSE(readInto(scene, &FbxSdk::getMarker, scene.add<fbxsdk::FbxNull>("null"), marker));
}

// ---- Nulls ----

TEST(NullExtraction, ReadsNameTransformSizeAndLook) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxNull>("locator");
    node->LclScaling.Set({2.0, 3.0, 4.0});
    node->GetNull()->Size.Set(7.5);
    node->GetNull()->Look.Set(fbxsdk::FbxNull::eNone);

    const TnFbxNull null = readNull(scene, node);

    EXPECT_EQ(null.getName(), "locator");
    EXPECT_EQ(null.getTransformValue(TnFbxTransform::kFbxTransformScaleY), 3.0f);
    EXPECT_EQ(null.getNullSize(), 7.5f);
    EXPECT_EQ(null.getNullLookType(), TnFbxNull::kFbxNullLookNone);
}

TEST(NullExtraction, ReadsEveryLookButNoneAsACross) {
    for (const int look : {1, 2, -1}) {
        TestScene scene;
        fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxNull>("locator");
        static_cast<fbxsdk::FbxProperty&>(node->GetNull()->Look).Set(look);
        EXPECT_EQ(readNull(scene, node).getNullLookType(), TnFbxNull::kFbxNullLookCross) << look;
    }
}

TEST(NullExtraction, GivesANodeWithoutAttributeTheDefaultSizeAndACross) {
    TestScene scene;
    fbxsdk::FbxNode* node = scene.addNode("bare");
    TnFbxNull null;
    null.setNullSize(9.0f);
    null.setNullLookType(TnFbxNull::kFbxNullLookNone);

    EXPECT_TRUE(readInto(scene, &FbxSdk::getNull, node, null));

    EXPECT_EQ(null.getName(), "bare");
    EXPECT_EQ(null.getNullSize(), 1.0f);
    EXPECT_EQ(null.getNullLookType(), TnFbxNull::kFbxNullLookCross);
}

TEST(NullExtraction, SamplesNothingOfItsOwn) {
    TestScene scene(0, 1);
    fbxsdk::FbxNode* node = scene.add<fbxsdk::FbxNull>("locator");
    node->GetNull()->Size.Set(7.0);
    scene.key(node->GetNull()->Size, nullptr, {{0, 5.0f}, {1, 6.0f}});

    EXPECT_EQ(readNull(scene, node).getNullSize(), 7.0f);
}

TEST(NullExtraction, FailsForANullNodeAndForOneThatCarriesSomethingElse) {
    TestScene scene;
    TnFbxNull null;

    EXPECT_FALSE(readInto(scene, &FbxSdk::getNull, nullptr, null));
    EXPECT_FALSE(readInto(scene, &FbxSdk::getNull, scene.add<fbxsdk::FbxLight>("light"), null));
}

TEST(LightMarkerNullExtraction, ReadsTransformsInTheWorldWhenAsked) {
    TestScene scene;
    fbxsdk::FbxNode* parent = scene.addNode("parent");
    parent->LclTranslation.Set({10.0, 0.0, 0.0});
    Light light;
    Marker marker;
    TnFbxNull null;

    EXPECT_TRUE(readInto(scene, &FbxSdk::getLight, scene.add<fbxsdk::FbxLight>("light", parent), light, true));
    EXPECT_TRUE(readInto(scene, &FbxSdk::getMarker, scene.add<fbxsdk::FbxMarker>("marker", parent), marker, true));
    EXPECT_TRUE(readInto(scene, &FbxSdk::getNull, scene.add<fbxsdk::FbxNull>("null", parent), null, true));

    for (const TnFbxTransform* object : std::initializer_list<const TnFbxTransform*>{&light, &marker, &null})
        EXPECT_EQ(object->getTransformValue(TnFbxTransform::kFbxTransformPositionX), 10.0f);
}

// ---- Another rate ----

constexpr auto kPositionX = TnFbxTransform::kFbxTransformPositionX;

/// An object of a node whose X position is keyed at the frames 0 and 10, read at twice the rate of its scene.
template <class Attribute, class Object, class Keys>
Object readAtTwiceTheRate(Reader<Object> reader, Keys&& addKeys) {
    TestScene scene(0, 0);
    fbxsdk::FbxNode* node = scene.add<Attribute>("node");
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {10, 10.0f}});
    addKeys(scene, *node);
    Object object;
    EXPECT_TRUE(readInto(scene, reader, node, object, /*global*/ false, 48.0f));
    return object;
}

TEST(LightExtraction, ConvertsKeyFramesToTheSampleRate) {
    const auto light =
        readAtTwiceTheRate<fbxsdk::FbxLight, Light>(&FbxSdk::getLight, [](TestScene& scene, fbxsdk::FbxNode& node) {
            scene.key(node.GetLight()->Color, "X", {{0, 0.0f}, {10, 1.0f}});
            scene.key(node.GetLight()->Intensity, nullptr, {{0, 0.0f}, {10, 100.0f}});
            scene.key(node.GetLight()->OuterAngle, nullptr, {{0, 0.0f}, {10, 60.0f}});
        });

    test::expectRange(light.getTransformTime(kPositionX), 0, 20, 24.0f);
    for (const auto channel : {Light::kFbxLightRed, Light::kFbxLightIntensity, Light::kFbxLightConeAngle})
        test::expectRange(light.getTime(channel), 0, 20, 24.0f);
    EXPECT_EQ(light.getValueAt(Light::kFbxLightConeAngle, 5.0f), 30.0f); // the frames are still those of the scene
}

TEST(MarkerExtraction, ConvertsKeyFramesToTheSampleRate) {
    const auto marker =
        readAtTwiceTheRate<fbxsdk::FbxMarker, Marker>(&FbxSdk::getMarker, [](TestScene& scene, fbxsdk::FbxNode& node) {
            scene.key(node.GetNodeAttribute()->Color, "X", {{0, 0.0f}, {10, 1.0f}});
        });

    test::expectRange(marker.getTransformTime(kPositionX), 0, 20, 24.0f);
    test::expectRange(marker.getTime(Marker::kFbxMarkerRed), 0, 20, 24.0f);
}

TEST(NullExtraction, ConvertsKeyFramesToTheSampleRate) {
    const auto null =
        readAtTwiceTheRate<fbxsdk::FbxNull, TnFbxNull>(&FbxSdk::getNull, [](TestScene&, fbxsdk::FbxNode&) {});

    test::expectRange(null.getTransformTime(kPositionX), 0, 20, 24.0f);
}

} // namespace
} // namespace Tarnell::Fbx
