// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Stacks and layers: defaults, spans, membership and the bypass of blending.
#include "AnimationFixture.h"

namespace {

using namespace fbxsdk;

using FbxAnimStackTest = AnimationFixture;
using FbxAnimLayerTest = AnimationFixture;

TEST_F(FbxAnimStackTest, StartsWithoutLayersAtTimeZero) {
    FbxAnimStack* made = FbxAnimStack::Create(scene, "new");

    EXPECT_EQ(made->GetMemberCount<FbxAnimLayer>(), 0);
    EXPECT_STREQ(made->Description.Get().Buffer(), "");
    EXPECT_EQ(made->GetLocalTimeSpan().GetStart(), FbxTime(0));
    EXPECT_EQ(made->GetLocalTimeSpan().GetStop(), FbxTime(0));
    EXPECT_EQ(made->GetReferenceTimeSpan().GetStop(), FbxTime(0));
}

TEST_F(FbxAnimStackTest, KeepsItsSpansAsFourTimes) {
    stack->SetLocalTimeSpan(FbxTimeSpan(FbxTime(10), FbxTime(20)));
    stack->SetReferenceTimeSpan(FbxTimeSpan(FbxTime(-5), FbxTime(3)));

    EXPECT_EQ(stack->LocalStart.Get(), FbxTime(10));
    EXPECT_EQ(stack->LocalStop.Get(), FbxTime(20));
    EXPECT_EQ(stack->ReferenceStart.Get(), FbxTime(-5));
    EXPECT_EQ(stack->ReferenceStop.Get(), FbxTime(3));
    stack->LocalStop.Set(FbxTime(99));
    EXPECT_EQ(stack->GetLocalTimeSpan().GetStop(), FbxTime(99));
    EXPECT_EQ(stack->GetReferenceTimeSpan().GetStart(), FbxTime(-5));
}

TEST_F(FbxAnimStackTest, HasSpansThatAreUnrelatedToKeys) {
    node->LclTranslation.GetCurve(layer, "X", true)->KeyAdd(FbxTime(1000));

    EXPECT_EQ(stack->GetLocalTimeSpan().GetStop(), FbxTime(0));
}

TEST_F(FbxAnimStackTest, HasItsDefaultsAfterAReset) {
    stack->Description.Set(FbxString("words"));
    stack->SetLocalTimeSpan(FbxTimeSpan(FbxTime(10), FbxTime(20)));
    stack->SetReferenceTimeSpan(FbxTimeSpan(FbxTime(10), FbxTime(20)));

    stack->Reset();

    EXPECT_STREQ(stack->Description.Get().Buffer(), "");
    EXPECT_EQ(stack->GetLocalTimeSpan().GetStop(), FbxTime(0));
    EXPECT_EQ(stack->GetReferenceTimeSpan().GetStart(), FbxTime(0));
}

TEST_F(FbxAnimStackTest, HoldsLayersAsSourcesInOrder) {
    FbxAnimLayer* second = addLayer();

    EXPECT_EQ(stack->GetMemberCount<FbxAnimLayer>(), 2);
    EXPECT_EQ(stack->GetSrcObject(FbxCriteria::ObjectType(FbxAnimLayer::ClassId), 0), layer);
    EXPECT_EQ(stack->GetSrcObject(FbxCriteria::ObjectType(FbxAnimLayer::ClassId), 1), second);
    EXPECT_TRUE(scene->IsConnectedSrcObject(second)); // of the scene and of the stack
    EXPECT_TRUE(stack->AddMember(second));
    EXPECT_EQ(stack->GetMemberCount<FbxAnimLayer>(), 2);
}

TEST_F(FbxAnimLayerTest, AddsAtFullWeightByDefault) {
    EXPECT_EQ(layer->Weight.Get(), 100.0);
    EXPECT_TRUE(layer->Weight.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_FALSE(layer->Mute.Get());
    EXPECT_FALSE(layer->Solo.Get());
    EXPECT_FALSE(layer->Lock.Get());
    EXPECT_EQ(layer->Color.Get(), FbxDouble3(0.8, 0.8, 0.8));
    EXPECT_EQ(layer->BlendMode.Get(), FbxAnimLayer::eBlendAdditive);
    EXPECT_EQ(layer->RotationAccumulationMode.Get(), FbxAnimLayer::eRotationByLayer);
    EXPECT_EQ(layer->ScaleAccumulationMode.Get(), FbxAnimLayer::eScaleMultiply);
}

TEST_F(FbxAnimLayerTest, KnowsTheNumbersOfFiles) {
    EXPECT_EQ(FbxAnimLayer::eBlendAdditive, 0);
    EXPECT_EQ(FbxAnimLayer::eBlendOverride, 1);
    EXPECT_EQ(FbxAnimLayer::eBlendOverridePassthrough, 2);
    EXPECT_EQ(FbxAnimLayer::eRotationByLayer, 0);
    EXPECT_EQ(FbxAnimLayer::eRotationByChannel, 1);
    EXPECT_EQ(FbxAnimLayer::eScaleMultiply, 0);
    EXPECT_EQ(FbxAnimLayer::eScaleAdditive, 1);
}

TEST_F(FbxAnimLayerTest, HasItsDefaultsAfterAReset) {
    layer->Weight.Set(3.0);
    layer->Mute.Set(true);
    layer->BlendMode.Set(FbxAnimLayer::eBlendOverride);
    layer->SetBlendModeBypass(eFbxDouble3, true);

    layer->Reset();

    EXPECT_EQ(layer->Weight.Get(), 100.0);
    EXPECT_FALSE(layer->Mute.Get());
    EXPECT_EQ(layer->BlendMode.Get(), FbxAnimLayer::eBlendAdditive);
    EXPECT_FALSE(layer->GetBlendModeBypass(eFbxDouble3));
}

TEST_F(FbxAnimLayerTest, BypassesBlendingTypeByType) {
    layer->SetBlendModeBypass(eFbxDouble3, true);
    layer->SetBlendModeBypass(eFbxBool, true);

    for (int type = 0; type < eFbxTypeCount; ++type)
        EXPECT_EQ(layer->GetBlendModeBypass(static_cast<EFbxType>(type)), type == eFbxDouble3 || type == eFbxBool);
    layer->SetBlendModeBypass(eFbxDouble3, false);
    EXPECT_FALSE(layer->GetBlendModeBypass(eFbxDouble3));
    EXPECT_TRUE(layer->GetBlendModeBypass(eFbxBool));
}

TEST_F(FbxAnimLayerTest, IgnoresTypesThatAreNone) {
    for (const int type : {-1, static_cast<int>(eFbxTypeCount), 64, 1000}) {
        layer->SetBlendModeBypass(static_cast<EFbxType>(type), true);
        EXPECT_FALSE(layer->GetBlendModeBypass(static_cast<EFbxType>(type))) << type;
    }
}

TEST_F(FbxAnimLayerTest, MakesNoCurveNodeForAnInvalidProperty) {
    FbxProperty none;

    EXPECT_EQ(layer->CreateCurveNode(none), nullptr);
    EXPECT_EQ(layer->GetMemberCount(), 0);
}

TEST_F(FbxAnimLayerTest, OutsideOfAnySceneMakesCurvesAllTheSame) {
    FbxAnimLayer* loose = FbxAnimLayer::Create(manager, "loose");
    FbxNode* other = FbxNode::Create(manager, "other");

    FbxAnimCurve* curve = other->LclTranslation.GetCurve(loose, "X", true);

    ASSERT_NE(curve, nullptr);
    EXPECT_EQ(curve->GetScene(), nullptr);
    EXPECT_EQ(other->LclTranslation.GetCurve(loose, "X"), curve);
}

} // namespace
