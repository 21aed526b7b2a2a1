// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Stacks, layers, curve nodes and curves in files of every version.
#include <cstdint>
#include <string>
#include <vector>

#include <fbxsdk/FbxAnimLayer.h>
#include <fbxsdk/FbxAnimStack.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxSurfaceMaterial.h>

#include "ExportFixture.h"
#include "animation/CurveEvaluation.h"
#include "platform/scene/Animate.h"

namespace {

using namespace fbxsdk;
using animate::keys;
using animate::seconds;

class AnimationWriting : public exporting::EveryLayout {
protected:
    AnimationWriting() : layer(animate::addStack(*scene, "Take 001")) {}

    [[nodiscard]] FbxAnimStack* stack() const { return scene->GetSrcObject<FbxAnimStack>(0); }
    static FbxAnimLayer* layerOf(FbxScene* copy) {
        auto* back = copy->GetSrcObject<FbxAnimStack>(0);
        return back ? back->GetMember<FbxAnimLayer>(0) : nullptr;
    }
    static FbxNode* nodeOf(FbxScene* copy) { return copy->GetRootNode()->GetChild(0); }

    FbxAnimLayer* layer;
};

INSTANTIATE_TEST_SUITE_P(Versions, AnimationWriting, testing::ValuesIn(exporting::allLayouts()));

void expectSameCurve(FbxAnimCurve* expected, FbxAnimCurve* actual) {
    ASSERT_NE(actual, nullptr);
    ASSERT_EQ(actual->KeyGetCount(), expected->KeyGetCount());
    for (int i = 0; i < expected->KeyGetCount(); ++i) {
        EXPECT_EQ(actual->KeyGetTime(i), expected->KeyGetTime(i)) << i;
        EXPECT_EQ(actual->KeyGetValue(i), expected->KeyGetValue(i)) << i;
        EXPECT_EQ(actual->KeyGetInterpolation(i), expected->KeyGetInterpolation(i)) << i;
    }
    for (int i = 0; i < 200; ++i) {
        const FbxTime time = seconds(-1.0 + 0.05 * i);
        EXPECT_NEAR(actual->Evaluate(time), expected->Evaluate(time), 1e-4) << i;
    }
}

TEST_P(AnimationWriting, KeepsLinearKeysOfATransform) {
    FbxNode* node = addNode("node");
    FbxAnimCurve* x = keys(node->LclTranslation, layer, "X", {{0, 1}, {0.5, -2.25}, {2, 1e6}});
    FbxAnimCurve* z = keys(node->LclRotation, layer, "Z", {{1, 90}, {3, 450}});
    FbxAnimCurve* y = keys(node->LclScaling, layer, "Y", {{0, 1}});

    FbxScene* copy = writeAndRead();

    FbxAnimLayer* back = layerOf(copy);
    ASSERT_NE(back, nullptr);
    expectSameCurve(x, nodeOf(copy)->LclTranslation.GetCurve(back, "X"));
    expectSameCurve(z, nodeOf(copy)->LclRotation.GetCurve(back, "Z"));
    expectSameCurve(y, nodeOf(copy)->LclScaling.GetCurve(back, "Y"));
    EXPECT_EQ(nodeOf(copy)->LclTranslation.GetCurve(back, "Y"), nullptr);
}

TEST_P(AnimationWriting, KeepsEveryInterpolationAndTangent) {
    FbxNode* node = addNode("node");
    FbxAnimCurve* curve = keys(node->LclTranslation, layer, "X",
                               {{0, 0}, {0.5, 3}, {1, 1}, {1.5, 5}, {2, 2}, {2.5, 7}, {3, 1}, {3.5, 4}, {4, 0}});
    using Def = FbxAnimCurveDef;
    const auto set = [&](int key, Def::EInterpolationType interpolation, Def::ETangentMode tangent, float a = 0,
                         float b = 0, Def::EWeightedMode weighted = Def::eWeightedNone, float wa = 1.0F / 3,
                         float wb = 1.0F / 3) {
        curve->KeySet(key, curve->KeyGetTime(key), curve->KeyGetValue(key), interpolation, tangent, a, b, weighted, wa,
                      wb);
    };
    set(0, Def::eInterpolationConstant, Def::eTangentAuto);
    curve->KeySetConstantMode(0, Def::eConstantNext);
    set(1, Def::eInterpolationLinear, Def::eTangentAuto);
    set(2, Def::eInterpolationCubic, Def::eTangentUser, 4.0F, -2.0F);
    set(3, Def::eInterpolationCubic, Def::eTangentAuto);
    set(4, Def::eInterpolationCubic, Def::eTangentBreak, 1.5F, 2.5F);
    // Weights that files hold exactly: they are stored in steps of 1/9999.
    set(5, Def::eInterpolationCubic, Def::eTangentUser, 1.0F, 1.0F, Def::eWeightedAll, 6000 / 9999.0F, 2000 / 9999.0F);
    set(6, Def::eInterpolationCubic, Def::eTangentTCB, 0.25F, -0.5F);
    set(7, Def::eInterpolationCubic, Def::eTangentAuto);
    set(8, Def::eInterpolationConstant, Def::eTangentAuto);

    FbxScene* copy = writeAndRead();

    expectSameCurve(curve, nodeOf(copy)->LclTranslation.GetCurve(layerOf(copy), "X"));
}

TEST_P(AnimationWriting, KeepsTheShapeOfClampedAndBiasedTangents) {
    FbxNode* node = addNode("node");
    FbxAnimCurve* curve =
        keys(node->LclTranslation, layer, "X", {{0, 0}, {0.5, 3}, {0.75, 3}, {1.5, 5}, {2, 2}, {4, 0}});
    namespace KeyFlag = detail::KeyFlag;
    constexpr std::uint32_t kFlags[] = {KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericClamp,
                                        KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericClampProgressive,
                                        KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericClampProgressive |
                                            KeyFlag::genericTimeIndependent,
                                        KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericBreak,
                                        KeyFlag::cubic | KeyFlag::tangentAuto,
                                        KeyFlag::cubic | KeyFlag::tangentAuto};
    detail::CurveKeys& edited = curve->editKeys();
    for (std::size_t i = 0; i < std::size(kFlags); ++i) {
        detail::KeyAttributes attributes;
        attributes.flags = kFlags[i];
        if (i == 4)
            attributes.data[detail::KeyData::rightSlope] = 50.0F;
        edited.setAttributes(i, attributes);
    }

    FbxScene* copy = writeAndRead();

    FbxAnimCurve* back = nodeOf(copy)->LclTranslation.GetCurve(layerOf(copy), "X");
    ASSERT_NE(back, nullptr);
    for (int i = 0; i < 100; ++i) {
        const FbxTime time = seconds(0.04 * i);
        EXPECT_NEAR(back->Evaluate(time), curve->Evaluate(time), 1e-4) << i;
    }
}

/// Keys with a kind of attributes each, chosen by the seed so that all kinds occur next to each other.
void addMixedKeys(FbxAnimCurve* curve, std::uint32_t seed) {
    namespace KeyFlag = detail::KeyFlag;
    // Weights that files hold exactly: they are stored in steps of 1/9999.
    constexpr float kThird = 3333 / 9999.0F;
    const detail::KeyAttributes kKinds[] = {
        {.flags = KeyFlag::linear},
        {.flags = KeyFlag::linear | KeyFlag::tangentAuto},
        {.flags = KeyFlag::constant},
        {.flags = KeyFlag::cubic | KeyFlag::tangentAuto},
        {.flags = KeyFlag::cubic | KeyFlag::tangentAuto | KeyFlag::genericClampProgressive},
        {.flags = KeyFlag::cubic | KeyFlag::tangentUser, .data = {1.5F, -2.0F, kThird, kThird, 0.0F, 0.0F}},
        {.flags = KeyFlag::cubic | KeyFlag::tangentUser | KeyFlag::genericBreak | KeyFlag::weightedRight |
                  KeyFlag::weightedNextLeft,
         .data = {-3.0F, 0.5F, 6000 / 9999.0F, 2000 / 9999.0F, 0.0F, 0.0F}},
        {.flags = KeyFlag::cubic | KeyFlag::tangentTcb, .data = {0.25F, -0.5F, 0.5F, kThird, 0.0F, 0.0F}}};
    for (int i = 0; i < 40; ++i) {
        seed = seed * 1664525U + 1013904223U;
        const int key = curve->KeyAdd(seconds(0.2 * i));
        curve->KeySetValue(key, static_cast<float>(seed >> 24) / 64.0F);
        curve->editKeys().setAttributes(static_cast<std::size_t>(key), kKinds[(seed >> 16) % std::size(kKinds)]);
    }
}

TEST_P(AnimationWriting, KeepsTheShapeBetweenKeysOfDifferentKinds) {
    FbxNode* node = addNode("node");
    FbxProperty properties[] = {node->LclTranslation, node->LclRotation, node->LclScaling};
    std::uint32_t seed = 0;
    for (FbxProperty& property : properties)
        for (const char* component : {"X", "Y", "Z"})
            addMixedKeys(property.GetCurve(layer, component, /*pCreate=*/true), ++seed);

    FbxScene* copy = writeAndRead();

    FbxProperty copies[] = {nodeOf(copy)->LclTranslation, nodeOf(copy)->LclRotation, nodeOf(copy)->LclScaling};
    for (std::size_t i = 0; i < std::size(properties); ++i) {
        for (const char* component : {"X", "Y", "Z"}) {
            SCOPED_TRACE(properties[i].GetNameAsCStr() + std::string(component));
            expectSameCurve(properties[i].GetCurve(layer, component), copies[i].GetCurve(layerOf(copy), component));
        }
    }
}

TEST_P(AnimationWriting, KeepsExtrapolation) {
    FbxNode* node = addNode("node");
    FbxAnimCurve* curve = keys(node->LclTranslation, layer, "X", {{0, 1}, {1, 3}});
    curve->SetPreExtrapolation(FbxAnimCurveBase::eMirrorRepetition);
    curve->SetPreExtrapolationCount(3);
    curve->SetPostExtrapolation(FbxAnimCurveBase::eKeepSlope);

    FbxScene* copy = writeAndRead();

    FbxAnimCurve* back = nodeOf(copy)->LclTranslation.GetCurve(layerOf(copy), "X");
    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->GetPreExtrapolation(), FbxAnimCurveBase::eMirrorRepetition);
    EXPECT_EQ(back->GetPreExtrapolationCount(), 3U);
    EXPECT_EQ(back->GetPostExtrapolation(), FbxAnimCurveBase::eKeepSlope);
}

TEST_P(AnimationWriting, KeepsRelativeRepetitionWhereTheVersionHasIt) {
    FbxNode* node = addNode("node");
    keys(node->LclTranslation, layer, "X", {{0, 1}, {1, 3}})
        ->SetPostExtrapolation(FbxAnimCurveBase::eRelativeRepetition);

    FbxScene* copy = writeAndRead();

    const bool has = detail::findVersion(GetParam().version)->relativeExtrapolation;
    FbxAnimCurve* back = nodeOf(copy)->LclTranslation.GetCurve(layerOf(copy), "X");
    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->GetPostExtrapolation(), has ? FbxAnimCurveBase::eRelativeRepetition : FbxAnimCurveBase::eConstant);
}

TEST_P(AnimationWriting, WritesAComponentWithoutKeysAsAValue) {
    FbxNode* node = addNode("node");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    keys(node->LclTranslation, layer, "X", {{0, 10}});
    ASSERT_NE(node->LclTranslation.GetCurve(layer, "Y", /*pCreate=*/true), nullptr);

    FbxScene* copy = writeAndRead();

    FbxNode* back = nodeOf(copy);
    EXPECT_EQ(copy->GetSrcObjectCount<FbxAnimCurve>(), 1);
    EXPECT_EQ(back->LclTranslation.GetCurve(layerOf(copy), "Y"), nullptr);
    const auto value = back->LclTranslation.EvaluateValue(seconds(0));
    EXPECT_EQ(value[0], 10.0);
    EXPECT_EQ(value[1], 2.0);
    EXPECT_EQ(value[2], 3.0);
}

TEST_P(AnimationWriting, LeavesOutWhatWasMadeAndNeverKeyed) {
    auto* light = make<FbxLight>("light");
    addNode("node", light);
    light->Intensity.Set(100.0);
    FbxAnimCurve* curve = light->Intensity.GetCurve(layer, /*pCreate=*/true);
    ASSERT_NE(curve, nullptr);
    curve->SetValue(1.0F); // not the property's value: it is not requested

    const std::string file = write();
    FbxScene* copy = read();

    EXPECT_EQ(copy->GetSrcObjectCount<FbxAnimCurveNode>(), 0);
    FbxLight* back = nodeOf(copy)->GetLight();
    EXPECT_EQ(back->Intensity.Get(), 100.0);
    EXPECT_EQ(back->Intensity.EvaluateValue(seconds(0)), 100.0);
    EXPECT_FALSE(back->Intensity.GetFlag(FbxPropertyFlags::eAnimated));
    EXPECT_EQ(scene->GetSrcObjectCount<FbxAnimCurveNode>(), 1) << "the scene itself keeps it";
}

TEST_P(AnimationWriting, LeavesOutACurveNodeThatSaysWhatItsPropertySays) {
    FbxNode* node = addNode("node");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    animate::constants(node->LclTranslation, layer, 1, 2, 3);
    node->LclScaling.Set(FbxDouble3(1, 2, 3));
    animate::constants(node->LclScaling, layer, 4, 2, 3); // this one is the value that is used

    FbxScene* copy = writeAndRead();

    EXPECT_EQ(copy->GetSrcObjectCount<FbxAnimCurveNode>(), 1);
    EXPECT_EQ(nodeOf(copy)->LclTranslation.EvaluateValue(seconds(0)), FbxDouble3(1, 2, 3));
    EXPECT_EQ(nodeOf(copy)->LclScaling.EvaluateValue(seconds(0)), FbxDouble3(4, 2, 3));
}

TEST_P(AnimationWriting, KeepsACurveNodeWithoutKeysThatAddsToTheBase) {
    if (!GetParam().hasIds())
        return; // older files have one layer
    FbxNode* node = addNode("node");
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    animate::constants(node->LclTranslation, animate::addLayer(*stack()), 1, 2, 3);

    FbxScene* copy = writeAndRead();

    EXPECT_EQ(nodeOf(copy)->LclTranslation.EvaluateValue(seconds(0)), FbxDouble3(2, 4, 6));
}

TEST_P(AnimationWriting, KeepsKeysOfAttributesAndMaterials) {
    FbxCamera* camera = make<FbxCamera>("camera");
    FbxNode* node = addNode("node", camera);
    FbxSurfaceLambert* material = make<FbxSurfaceLambert>("material");
    node->AddMaterial(material);
    FbxAnimCurve* focal = keys(camera->FocalLength, layer, nullptr, {{0, 35}, {1, 70}});
    FbxAnimCurve* visibility = keys(node->Visibility, layer, nullptr, {{0, 1}, {1, 0}});
    FbxAnimCurve* green = keys(material->Diffuse, layer, "Y", {{0, 0.25}, {1, 0.75}});

    FbxScene* copy = writeAndRead();

    auto* backCamera = FbxCast<FbxCamera>(nodeOf(copy)->GetNodeAttribute());
    auto* backMaterial = FbxCast<FbxSurfaceLambert>(nodeOf(copy)->GetMaterial(0));
    ASSERT_NE(backCamera, nullptr);
    ASSERT_NE(backMaterial, nullptr);
    expectSameCurve(focal, backCamera->FocalLength.GetCurve(layerOf(copy)));
    expectSameCurve(visibility, nodeOf(copy)->Visibility.GetCurve(layerOf(copy)));
    expectSameCurve(green, backMaterial->Diffuse.GetCurve(layerOf(copy), "Y"));
}

TEST_P(AnimationWriting, KeepsKeysOfTheFilmAndThePlanesOfACamera) {
    FbxCamera* camera = make<FbxCamera>("camera");
    addNode("node", camera);
    FbxAnimCurve* width = keys(camera->FilmWidth, layer, nullptr, {{0, 1}, {1, 1.5}});
    FbxAnimCurve* height = keys(camera->FilmHeight, layer, nullptr, {{0, 0.5}, {2, 0.75}});
    FbxAnimCurve* nearPlane = keys(camera->NearPlane, layer, nullptr, {{0, 10}, {1, 20}});
    FbxAnimCurve* farPlane = keys(camera->FarPlane, layer, nullptr, {{0, 1000}, {3, 4000}});

    FbxScene* copy = writeAndRead();

    auto* back = FbxCast<FbxCamera>(nodeOf(copy)->GetNodeAttribute());
    ASSERT_NE(back, nullptr);
    expectSameCurve(width, back->FilmWidth.GetCurve(layerOf(copy)));
    expectSameCurve(height, back->FilmHeight.GetCurve(layerOf(copy)));
    expectSameCurve(nearPlane, back->NearPlane.GetCurve(layerOf(copy)));
    expectSameCurve(farPlane, back->FarPlane.GetCurve(layerOf(copy)));
}

TEST_P(AnimationWriting, KeepsKeysOfALightUnderItsOldNames) {
    FbxLight* light = make<FbxLight>("light");
    addNode("node", light);
    FbxAnimCurve* inner = keys(light->InnerAngle, layer, nullptr, {{0, 10}, {1, 20}});
    FbxAnimCurve* outer = keys(light->OuterAngle, layer, nullptr, {{0, 30}, {1, 40}});
    FbxAnimCurve* blue = keys(light->Color, layer, "Z", {{0, 0}, {1, 1}});

    FbxScene* copy = writeAndRead();

    auto* back = FbxCast<FbxLight>(nodeOf(copy)->GetNodeAttribute());
    ASSERT_NE(back, nullptr);
    expectSameCurve(inner, back->InnerAngle.GetCurve(layerOf(copy)));
    expectSameCurve(outer, back->OuterAngle.GetCurve(layerOf(copy)));
    expectSameCurve(blue, back->Color.GetCurve(layerOf(copy), "Z"));
}

TEST_P(AnimationWriting, MakesAnimatedPropertiesAnimatable) {
    FbxCamera* camera = make<FbxCamera>("camera");
    addNode("node", camera);
    camera->FilmWidth.ModifyFlag(FbxPropertyFlags::eAnimatable, true);
    FbxAnimCurve* width = keys(camera->FilmWidth, layer, nullptr, {{0, 0.5}, {1, 1.5}});

    const std::string bytes = write();
    FbxScene* copy = read();

    auto* back = FbxCast<FbxCamera>(nodeOf(copy)->GetNodeAttribute());
    ASSERT_NE(back, nullptr);
    expectSameCurve(width, back->FilmWidth.GetCurve(layerOf(copy)));
    if (GetParam().format == 1) {
        EXPECT_NE(bytes.find(GetParam().hasIds() ? "\"FilmWidth\", \"Number\", \"\", \"A+\",0.816"
                                                 : "\"FilmWidth\", \"Number\", \"A+N\",0.816"),
                  std::string::npos);
    }
}

TEST_P(AnimationWriting, KeepsSeveralStacksInOrder) {
    FbxNode* node = addNode("node");
    FbxAnimLayer* second = animate::addStack(*scene, "run \"fast\"");
    keys(node->LclTranslation, layer, "X", {{0, 1}, {1, 2}});
    keys(node->LclTranslation, second, "X", {{0, 3}, {1, 4}});

    FbxScene* copy = writeAndRead();

    ASSERT_EQ(copy->GetSrcObjectCount<FbxAnimStack>(), 2);
    auto* first = copy->GetSrcObject<FbxAnimStack>(0);
    auto* other = copy->GetSrcObject<FbxAnimStack>(1);
    EXPECT_STREQ(first->GetName(), "Take 001");
    EXPECT_STREQ(other->GetName(), "run \"fast\"");
    FbxAnimCurve* curve = nodeOf(copy)->LclTranslation.GetCurve(other->GetMember<FbxAnimLayer>(0), "X");
    ASSERT_NE(curve, nullptr);
    EXPECT_EQ(curve->KeyGetValue(0), 3.0F);
}

TEST_P(AnimationWriting, KeepsAllLayersWhereFilesHaveThem) {
    FbxNode* node = addNode("node");
    FbxAnimLayer* second = animate::addLayer(*stack(), "second");
    second->Weight.Set(25.0);
    second->BlendMode.Set(FbxAnimLayer::eBlendOverridePassthrough);
    keys(node->LclTranslation, layer, "X", {{0, 1}, {1, 2}});
    FbxAnimCurve* upper = keys(node->LclTranslation, second, "X", {{0, 10}, {1, 20}});

    FbxScene* copy = writeAndRead();

    auto* back = copy->GetSrcObject<FbxAnimStack>(0);
    ASSERT_NE(back, nullptr);
    if (!GetParam().hasIds()) {
        EXPECT_EQ(back->GetMemberCount<FbxAnimLayer>(), 1);
        return;
    }
    ASSERT_EQ(back->GetMemberCount<FbxAnimLayer>(), 2);
    auto* backSecond = back->GetMember<FbxAnimLayer>(1);
    EXPECT_STREQ(backSecond->GetName(), "second");
    EXPECT_EQ(backSecond->Weight.Get(), 25.0);
    EXPECT_EQ(backSecond->BlendMode.Get(), FbxAnimLayer::eBlendOverridePassthrough);
    expectSameCurve(upper, nodeOf(copy)->LclTranslation.GetCurve(backSecond, "X"));
}

TEST_P(AnimationWriting, StatesTheSpanOfTheKeysForAStackWithoutOne) {
    FbxNode* node = addNode("node");
    keys(node->LclTranslation, layer, "X", {{0.5, 1}, {2, 2}});
    keys(node->LclRotation, layer, "Y", {{1, 1}, {4, 2}});

    FbxScene* copy = writeAndRead();

    const FbxTimeSpan span = copy->GetSrcObject<FbxAnimStack>(0)->GetLocalTimeSpan();
    EXPECT_EQ(span.GetStart(), seconds(0.5));
    EXPECT_EQ(span.GetStop(), seconds(4));
    EXPECT_EQ(copy->GetSrcObject<FbxAnimStack>(0)->GetReferenceTimeSpan().GetStop(), seconds(4));
    EXPECT_EQ(stack()->GetLocalTimeSpan().GetStop().Get(), 0) << "the scene itself stays as it is";
}

TEST_P(AnimationWriting, StatesOneSecondForAStackWithoutKeys) {
    FbxScene* copy = writeAndRead();

    const FbxTimeSpan span = copy->GetSrcObject<FbxAnimStack>(0)->GetLocalTimeSpan();
    EXPECT_EQ(span.GetStart().Get(), 0);
    EXPECT_EQ(span.GetStop(), seconds(1));
}

TEST_P(AnimationWriting, KeepsAStatedSpan) {
    FbxNode* node = addNode("node");
    keys(node->LclTranslation, layer, "X", {{0, 1}, {100, 2}});
    stack()->SetLocalTimeSpan(FbxTimeSpan(seconds(-1), seconds(3)));
    stack()->SetReferenceTimeSpan(FbxTimeSpan(seconds(1), seconds(2)));

    FbxScene* copy = writeAndRead();

    auto* back = copy->GetSrcObject<FbxAnimStack>(0);
    EXPECT_EQ(back->GetLocalTimeSpan().GetStart(), seconds(-1));
    EXPECT_EQ(back->GetLocalTimeSpan().GetStop(), seconds(3));
    EXPECT_EQ(back->GetReferenceTimeSpan().GetStart(), seconds(1));
    EXPECT_EQ(back->GetReferenceTimeSpan().GetStop(), seconds(2));
}

TEST_P(AnimationWriting, KeepsTheNameOfTheActiveStack) {
    animate::addStack(*scene, "other");
    scene->SetCurrentAnimationStack(scene->GetSrcObject<FbxAnimStack>(1));

    FbxScene* copy = writeAndRead();

    EXPECT_STREQ(copy->ActiveAnimStackName.Get().Buffer(), "other");
}

TEST_P(AnimationWriting, KeepsKeysAtAnyTime) {
    FbxNode* node = addNode("node");
    FbxAnimCurve* curve = node->LclTranslation.GetCurve(layer, "X", /*pCreate=*/true);
    const std::int64_t times[] = {-(std::int64_t{1} << 62), -1, 0, 1, std::int64_t{1} << 62};
    for (const std::int64_t time : times)
        curve->KeySet(curve->KeyAdd(FbxTime(time)), FbxTime(time), 1.5F, FbxAnimCurveDef::eInterpolationLinear);

    FbxScene* copy = writeAndRead();

    FbxAnimCurve* back = nodeOf(copy)->LclTranslation.GetCurve(layerOf(copy), "X");
    ASSERT_NE(back, nullptr);
    ASSERT_EQ(back->KeyGetCount(), 5);
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(back->KeyGetTime(i).Get(), times[i]);
}

TEST_P(AnimationWriting, KeepsKeysThatWereAddedAndGivenAValueOnly) {
    FbxNode* node = addNode("node");
    FbxAnimCurve* curve = keys(node->LclTranslation, layer, "X", {{0, 0}, {2, 1}});
    for (const double added : {-1.0, 0.5, 1.0, 3.0}) {
        const int key = curve->KeyAdd(seconds(added));
        curve->KeySetValue(key, static_cast<float>(added * added));
        ASSERT_EQ(curve->KeyGetInterpolation(key), FbxAnimCurveDef::eInterpolationCubic);
    }

    FbxScene* copy = writeAndRead();

    expectSameCurve(curve, nodeOf(copy)->LclTranslation.GetCurve(layerOf(copy), "X"));
}

TEST_P(AnimationWriting, WritesTenThousandKeys) {
    FbxNode* node = addNode("node");
    FbxAnimCurve* curve = node->LclTranslation.GetCurve(layer, "X", /*pCreate=*/true);
    curve->KeyModifyBegin();
    for (int i = 0; i < 10000; ++i) {
        const FbxTime time = seconds(i / 24.0);
        curve->KeySet(curve->KeyAdd(time), time, static_cast<float>(i % 17), FbxAnimCurveDef::eInterpolationLinear);
    }
    curve->KeyModifyEnd();

    FbxScene* copy = writeAndRead();

    expectSameCurve(curve, nodeOf(copy)->LclTranslation.GetCurve(layerOf(copy), "X"));
}

} // namespace
