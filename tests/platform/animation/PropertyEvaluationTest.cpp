// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Values of properties over the layers of a stack, against closed forms.
#include <cmath>
#include <cstring>
#include <vector>

#include <fbxsdk/FbxLight.h>
#include <fbxsdk/extensions/PropertySamples.h>

#include "AnimationFixture.h"

namespace {

using namespace fbxsdk;

/// Rotations pass through quaternions and angles.
constexpr double kAngleTolerance = 1e-9;

class PropertyEvaluationTest : public AnimationFixture {
protected:
    FbxDouble3 translation(double time = 0) { return node->LclTranslation.EvaluateValue(seconds(time)); }
    FbxDouble3 scaling(double time = 0) { return node->LclScaling.EvaluateValue(seconds(time)); }
    FbxDouble3 rotation(double time = 0) { return node->LclRotation.EvaluateValue(seconds(time)); }

    static void expectNear(const FbxDouble3& actual, const FbxDouble3& expected) {
        for (int i = 0; i < 3; ++i)
            EXPECT_NEAR(actual[i], expected[i], kAngleTolerance) << i;
    }

    FbxAnimLayer* second = addLayer();
};

TEST_F(PropertyEvaluationTest, GivesTheSameBitsForManyTimesTogether) {
    second->BlendMode.Set(FbxAnimLayer::eBlendOverridePassthrough);
    second->Weight.Set(30.0);
    second->RotationAccumulationMode.Set(FbxAnimLayer::eRotationByLayer);
    node->SetRotationActive(true);
    node->SetRotationOrder(FbxNode::eSourcePivot, FbxEuler::eOrderZYX);
    for (FbxAnimLayer* each : {layer, second}) {
        addKeys(node->LclRotation.GetCurve(each, "X", true), {{0, 10}, {1, -170}, {2, 300}});
        addKeys(node->LclScaling.GetCurve(each, "Z", true), {{0, 1}, {3, -2}});
    }
    std::vector<FbxTime> times = {FBXSDK_TIME_INFINITE, FbxTime(INT64_MIN), FbxTime(INT64_MAX)};
    for (int frame = -30; frame < 120; ++frame)
        times.push_back(seconds(frame / 24.0));

    for (auto property : {&FbxNode::LclTranslation, &FbxNode::LclRotation, &FbxNode::LclScaling}) {
        std::vector<FbxDouble3> together(times.size());
        extensions::evaluate(node->*property, times.data(), static_cast<int>(times.size()), together.data());
        for (std::size_t i = 0; i < times.size(); ++i) {
            const FbxDouble3 alone = (node->*property).EvaluateValue(times[i]);
            ASSERT_EQ(std::memcmp(&together[i], &alone, sizeof alone), 0) << i;
        }
    }
    FbxPropertyT<FbxDouble3> none;
    extensions::evaluate(none, times.data(), 0, nullptr);
}

// One layer.

TEST_F(PropertyEvaluationTest, GivesTheStaticValueWhereNothingAnimates) {
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));

    EXPECT_EQ(translation(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(node->LclTranslation.EvaluateValue(), FbxDouble3(1, 2, 3));
}

TEST_F(PropertyEvaluationTest, GivesTheStaticValueAtInfinity) {
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    set(node->LclTranslation, layer, 7, 8, 9);

    EXPECT_EQ(node->LclTranslation.EvaluateValue(FBXSDK_TIME_INFINITE), FbxDouble3(1, 2, 3));
    EXPECT_EQ(node->LclTranslation.Get(), FbxDouble3(1, 2, 3));
}

TEST_F(PropertyEvaluationTest, ReplacesTheStaticValueOnTheBaseLayer) {
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    set(node->LclTranslation, layer, 7, 8, 9);

    EXPECT_EQ(translation(), FbxDouble3(7, 8, 9));
}

TEST_F(PropertyEvaluationTest, TakesTheChannelsValueWhereAComponentHasNoKeys) {
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    addKeys(node->LclTranslation.GetCurve(layer, "Y", true), {{0, 10}, {2, 20}});
    node->LclTranslation.GetCurve(layer, "Z", true); // without keys

    EXPECT_EQ(translation(1), FbxDouble3(1, 15, 3));
    node->LclTranslation.GetCurveNode(layer)->SetChannelValue(0, 50.0);
    EXPECT_EQ(translation(1), FbxDouble3(50, 15, 3));
}

TEST_F(PropertyEvaluationTest, IgnoresTheBaseLayersBlendModeAndWeight) {
    set(node->LclTranslation, layer, 7, 8, 9);
    layer->Weight.Set(10.0);
    for (const FbxEnum mode : {0, 1, 2}) {
        layer->BlendMode.Set(mode);
        EXPECT_EQ(translation(), FbxDouble3(7, 8, 9)) << mode;
    }
}

TEST_F(PropertyEvaluationTest, EvaluatesScalarsAndConvertsThem) {
    FbxLight* light = FbxLight::Create(scene, "light");
    addKeys(light->Intensity.GetCurve(layer, true), {{0, 10}, {1, 20}});

    EXPECT_EQ(light->Intensity.EvaluateValue(seconds(0.5)), 15.0);
    EXPECT_EQ(light->FindProperty("Intensity").EvaluateValue<FbxInt>(seconds(0.5)), 15);
    EXPECT_EQ(light->FindProperty("Intensity").EvaluateValue<FbxDouble3>(seconds(0.5)), FbxDouble3(15, 0, 0));
}

TEST_F(PropertyEvaluationTest, OfAnObjectInNoSceneIsTheStaticValue) {
    FbxNode* loose = FbxNode::Create(manager, "loose");
    loose->LclTranslation.Set(FbxDouble3(1, 2, 3));

    EXPECT_EQ(loose->LclTranslation.EvaluateValue(seconds(1)), FbxDouble3(1, 2, 3));
}

TEST_F(PropertyEvaluationTest, KnowsOnlyTheCurrentStack) {
    FbxAnimStack* other = FbxAnimStack::Create(scene, "other");
    FbxAnimLayer* foreign = FbxAnimLayer::Create(scene, "foreign");
    other->AddMember(foreign);
    set(node->LclTranslation, layer, 1);
    set(node->LclTranslation, foreign, 2);

    EXPECT_EQ(translation()[0], 1.0);
    scene->SetCurrentAnimationStack(other);
    EXPECT_EQ(translation()[0], 2.0);
}

// Two layers.

TEST_F(PropertyEvaluationTest, AddsAFurtherLayerByItsWeight) {
    set(node->LclTranslation, layer, 10, 20, 30);
    set(node->LclTranslation, second, 4, 8, 16);

    EXPECT_EQ(translation(), FbxDouble3(14, 28, 46));
    second->Weight.Set(25.0);
    EXPECT_EQ(translation(), FbxDouble3(11, 22, 34));
    second->Weight.Set(0.0);
    EXPECT_EQ(translation(), FbxDouble3(10, 20, 30));
}

TEST_F(PropertyEvaluationTest, AddsToTheStaticValueWhereTheBaseLayerHasNoCurve) {
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    set(node->LclTranslation, second, 10, 20, 30);

    EXPECT_EQ(translation(), FbxDouble3(11, 22, 33));
}

TEST_F(PropertyEvaluationTest, HoldsWeightsBetweenNothingAndAll) {
    set(node->LclTranslation, layer, 10);
    set(node->LclTranslation, second, 4);
    for (const auto& [weight, expected] : {std::pair(-50.0, 10.0), {1e9, 14.0}, {static_cast<double>(NAN), 10.0}}) {
        second->Weight.Set(weight);
        EXPECT_EQ(translation()[0], expected) << weight;
    }
}

TEST_F(PropertyEvaluationTest, FollowsAnAnimatedWeight) {
    set(node->LclTranslation, layer, 10);
    set(node->LclTranslation, second, 4);
    addKeys(second->Weight.GetCurve(layer, true), {{0, 0}, {1, 100}});

    EXPECT_EQ(translation(0)[0], 10.0);
    EXPECT_EQ(translation(0.5)[0], 12.0);
    EXPECT_EQ(translation(1)[0], 14.0);
}

TEST_F(PropertyEvaluationTest, OverridesWhatIsBelowWhateverTheWeight) {
    set(node->LclTranslation, layer, 10, 20, 30);
    set(node->LclTranslation, second, 4, 8, 16);
    second->BlendMode.Set(FbxAnimLayer::eBlendOverride);

    EXPECT_EQ(translation(), FbxDouble3(4, 8, 16));
    second->Weight.Set(25.0);
    EXPECT_EQ(translation(), FbxDouble3(4, 8, 16));
}

TEST_F(PropertyEvaluationTest, LetsThroughWhatTheWeightLeaves) {
    set(node->LclTranslation, layer, 10, 20, 30);
    set(node->LclTranslation, second, 4, 8, 16);
    second->BlendMode.Set(FbxAnimLayer::eBlendOverridePassthrough);

    EXPECT_EQ(translation(), FbxDouble3(4, 8, 16));
    second->Weight.Set(75.0);
    EXPECT_EQ(translation(), FbxDouble3(5.5, 11, 19.5));
    second->Weight.Set(0.0);
    EXPECT_EQ(translation(), FbxDouble3(10, 20, 30));
}

TEST_F(PropertyEvaluationTest, StacksManyLayersInOrder) {
    FbxAnimLayer* third = addLayer();
    FbxAnimLayer* fourth = addLayer();
    set(node->LclTranslation, layer, 1);
    set(node->LclTranslation, second, 2);
    set(node->LclTranslation, third, 10);
    set(node->LclTranslation, fourth, 5);
    third->BlendMode.Set(FbxAnimLayer::eBlendOverride);
    fourth->Weight.Set(50.0);

    EXPECT_EQ(translation()[0], 12.5);
}

TEST_F(PropertyEvaluationTest, LeavesMutedLayersOut) {
    node->LclTranslation.Set(FbxDouble3(1, 0, 0));
    set(node->LclTranslation, layer, 10);
    set(node->LclTranslation, second, 4);

    second->Mute.Set(true);
    EXPECT_EQ(translation()[0], 10.0);
    layer->Mute.Set(true);
    EXPECT_EQ(translation()[0], 1.0);
    second->Mute.Set(false);
    EXPECT_EQ(translation()[0], 5.0); // on top of the static value
}

TEST_F(PropertyEvaluationTest, LeavesAllButSoloLayersOut) {
    node->LclTranslation.Set(FbxDouble3(1, 0, 0));
    FbxAnimLayer* third = addLayer();
    set(node->LclTranslation, layer, 10);
    set(node->LclTranslation, second, 4);
    set(node->LclTranslation, third, 100);

    second->Solo.Set(true);
    EXPECT_EQ(translation()[0], 5.0);
    third->Solo.Set(true);
    EXPECT_EQ(translation()[0], 105.0);
    third->Mute.Set(true);
    EXPECT_EQ(translation()[0], 5.0);
}

TEST_F(PropertyEvaluationTest, OverridesWhereBlendingIsBypassed) {
    set(node->LclTranslation, layer, 10, 20, 30);
    set(node->LclTranslation, second, 4, 8, 16);

    second->SetBlendModeBypass(eFbxDouble, true);
    EXPECT_EQ(translation(), FbxDouble3(14, 28, 46));
    second->SetBlendModeBypass(eFbxDouble3, true);
    EXPECT_EQ(translation(), FbxDouble3(4, 8, 16));
    second->SetBlendModeBypass(eFbxDouble3, false);
    EXPECT_EQ(translation(), FbxDouble3(14, 28, 46));
}

TEST_F(PropertyEvaluationTest, OverridesBooleansAndEnumerationsAlways) {
    for (const FbxDataType& type : {FbxBoolDT, FbxEnumDT}) {
        FbxProperty property = FbxProperty::Create(node, type, type.GetName());
        property.ModifyFlag(FbxPropertyFlags::eAnimatable, true);
        set(property, layer, 1);
        set(property, second, 1);
        second->Weight.Set(50.0);
        EXPECT_EQ(property.EvaluateValue<FbxInt>(seconds(0)), 1) << type.GetName();
    }
}

// Scaling.

TEST_F(PropertyEvaluationTest, MultipliesScalesByTheFactorToThePowerOfTheWeight) {
    set(node->LclScaling, layer, 2, 3, 4);
    set(node->LclScaling, second, 4, 9, 16);

    EXPECT_EQ(scaling(), FbxDouble3(8, 27, 64));
    second->Weight.Set(50.0);
    expectNear(scaling(), FbxDouble3(4, 9, 16));
    second->Weight.Set(0.0);
    EXPECT_EQ(scaling(), FbxDouble3(2, 3, 4));
}

TEST_F(PropertyEvaluationTest, AddsScalesWhereTheLayerSaysSo) {
    set(node->LclScaling, layer, 2, 3, 4);
    set(node->LclScaling, second, 4, 9, 16);
    second->ScaleAccumulationMode.Set(FbxAnimLayer::eScaleAdditive);
    second->Weight.Set(50.0);

    EXPECT_EQ(scaling(), FbxDouble3(4, 7.5, 12));
}

TEST_F(PropertyEvaluationTest, KeepsTheSignOfAScaleAtEveryWeight) {
    set(node->LclScaling, layer, 2, 2, 2);
    set(node->LclScaling, second, -4, 0, 4);
    second->Weight.Set(50.0);

    expectNear(scaling(), FbxDouble3(-4, 0, 4));
}

TEST_F(PropertyEvaluationTest, BlendsScalesGeometricallyOrPlainly) {
    set(node->LclScaling, layer, 1, 4, 2);
    set(node->LclScaling, second, 4, 9, 2);
    second->BlendMode.Set(FbxAnimLayer::eBlendOverridePassthrough);
    second->Weight.Set(50.0);

    expectNear(scaling(), FbxDouble3(2, 6, 2));
    second->ScaleAccumulationMode.Set(FbxAnimLayer::eScaleAdditive);
    EXPECT_EQ(scaling(), FbxDouble3(2.5, 6.5, 2));
}

// Rotation.

TEST_F(PropertyEvaluationTest, AddsAnglesOfOneAxisEitherWay) {
    set(node->LclRotation, layer, 0, 0, 30);
    set(node->LclRotation, second, 0, 0, 40);
    second->Weight.Set(50.0);

    expectNear(rotation(), FbxDouble3(0, 0, 50));
    second->RotationAccumulationMode.Set(FbxAnimLayer::eRotationByChannel);
    expectNear(rotation(), FbxDouble3(0, 0, 50));
}

TEST_F(PropertyEvaluationTest, ComposesRotationsByLayer) {
    // A quarter turn about Y on top of one about X: the two make a turn that no sum of angles is.
    set(node->LclRotation, layer, 90, 0, 0);
    set(node->LclRotation, second, 0, 90, 0);

    const FbxDouble3 angles = rotation();
    FbxAMatrix actual, first, other;
    actual.SetR(FbxVector4(angles[0], angles[1], angles[2]));
    first.SetR(FbxVector4(90, 0, 0));
    other.SetR(FbxVector4(0, 90, 0));
    const FbxAMatrix expected = first * other;
    for (int row = 0; row < 3; ++row)
        for (int column = 0; column < 3; ++column)
            EXPECT_NEAR(actual.Get(row, column), expected.Get(row, column), kAngleTolerance);
}

TEST_F(PropertyEvaluationTest, AddsAnglesByChannel) {
    set(node->LclRotation, layer, 90, 10, 0);
    set(node->LclRotation, second, 20, 90, 400);
    second->RotationAccumulationMode.Set(FbxAnimLayer::eRotationByChannel);

    EXPECT_EQ(rotation(), FbxDouble3(110, 100, 400));
}

TEST_F(PropertyEvaluationTest, BlendsRotationsAlongTheShortestWayByLayer) {
    set(node->LclRotation, layer, 0, 0, 10);
    set(node->LclRotation, second, 0, 0, 350);
    second->BlendMode.Set(FbxAnimLayer::eBlendOverridePassthrough);
    second->Weight.Set(50.0);

    expectNear(rotation(), FbxDouble3(0, 0, 0));
    second->RotationAccumulationMode.Set(FbxAnimLayer::eRotationByChannel);
    expectNear(rotation(), FbxDouble3(0, 0, 180));
}

TEST_F(PropertyEvaluationTest, KeepsTheAnglesOfTheBaseLayerAsTheyAre) {
    set(node->LclRotation, layer, 720, -400, 1000);

    EXPECT_EQ(rotation(), FbxDouble3(720, -400, 1000));
}

TEST_F(PropertyEvaluationTest, ComposesRotationsInTheOrderThatTheNodeHasInForce) {
    node->SetRotationActive(true);
    node->SetRotationOrder(FbxNode::eSourcePivot, FbxEuler::eOrderZYX);
    set(node->LclRotation, layer, 30, 40, 50);
    set(node->LclRotation, second, 10, 20, 30);

    const auto matrix = [](double x, double y, double z) {
        FbxAMatrix mx, my, mz;
        mx.SetR(FbxVector4(x, 0, 0));
        my.SetR(FbxVector4(0, y, 0));
        mz.SetR(FbxVector4(0, 0, z));
        return mx * my * mz; // Z first
    };
    const FbxAMatrix expected = matrix(30, 40, 50) * matrix(10, 20, 30);
    const FbxDouble3 angles = rotation();
    const FbxAMatrix property = matrix(angles[0], angles[1], angles[2]);
    const FbxAMatrix local = node->EvaluateLocalTransform(seconds(0));
    for (int row = 0; row < 3; ++row) {
        for (int column = 0; column < 3; ++column) {
            EXPECT_NEAR(local.Get(row, column), expected.Get(row, column), kAngleTolerance);
            EXPECT_NEAR(property.Get(row, column), expected.Get(row, column), kAngleTolerance);
        }
    }
}

} // namespace
