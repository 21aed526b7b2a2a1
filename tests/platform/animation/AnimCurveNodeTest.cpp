// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curve nodes and their channels, and how properties find and create their curves.
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLight.h>

#include "AnimationFixture.h"

namespace {

using namespace fbxsdk;

class FbxAnimCurveNodeTest : public AnimationFixture {
protected:
    FbxAnimCurveNode* typed(FbxProperty property) { return FbxAnimCurveNode::CreateTypedCurveNode(property, scene); }
    FbxProperty dynamic(const FbxDataType& type, const char* name) {
        FbxProperty property = FbxProperty::Create(node, type, name);
        property.ModifyFlag(FbxPropertyFlags::eAnimatable, true);
        return property;
    }
};

TEST_F(FbxAnimCurveNodeTest, HasAChannelForEachNumberOfTheProperty) {
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    FbxAnimCurveNode* made = typed(node->LclTranslation);

    ASSERT_EQ(made->GetChannelsCount(), 3U);
    EXPECT_STREQ(made->GetChannelName(0).Buffer(), "X");
    EXPECT_STREQ(made->GetChannelName(1).Buffer(), "Y");
    EXPECT_STREQ(made->GetChannelName(2).Buffer(), "Z");
    EXPECT_EQ(made->GetChannelIndex("Z"), 2);
    EXPECT_EQ(made->GetChannelValue(1U, 0.0), 2.0);
    EXPECT_EQ(made->GetChannelValue(2U, 0.0F), 3.0F);
}

TEST_F(FbxAnimCurveNodeTest, CallsTheOnlyChannelByTheProperty) {
    FbxLight* light = FbxLight::Create(scene, "light");
    light->Intensity.Set(55.0);
    FbxAnimCurveNode* made = typed(light->Intensity);

    ASSERT_EQ(made->GetChannelsCount(), 1U);
    EXPECT_STREQ(made->GetChannelName(0).Buffer(), "Intensity");
    EXPECT_STREQ(made->GetName(), "Intensity");
    EXPECT_EQ(made->GetChannelValue(0U, 0.0), 55.0);
}

TEST_F(FbxAnimCurveNodeTest, IsNamedAsFilesNameTheTransform) {
    EXPECT_STREQ(typed(node->LclTranslation)->GetName(), "T");
    EXPECT_STREQ(typed(node->LclRotation)->GetName(), "R");
    EXPECT_STREQ(typed(node->LclScaling)->GetName(), "S");
    EXPECT_STREQ(typed(FbxLight::Create(scene, "")->Color)->GetName(), "Color");
}

TEST_F(FbxAnimCurveNodeTest, HasTwoOrFourChannelsWhereThePropertyHas) {
    EXPECT_EQ(typed(dynamic(FbxDouble2DT, "two"))->GetChannelsCount(), 2U);
    EXPECT_EQ(typed(dynamic(FbxDouble4DT, "four"))->GetChannelsCount(), 4U);
    EXPECT_STREQ(typed(dynamic(FbxDouble4DT, "four"))->GetChannelName(3).Buffer(), "W");
    EXPECT_EQ(typed(dynamic(FbxBoolDT, "bool"))->GetChannelsCount(), 1U);
    EXPECT_EQ(typed(dynamic(FbxEnumDT, "enum"))->GetChannelsCount(), 1U);
}

TEST_F(FbxAnimCurveNodeTest, IsNotMadeForWhatHoldsNoNumber) {
    EXPECT_EQ(typed(dynamic(FbxStringDT, "string")), nullptr);
    EXPECT_EQ(typed(dynamic(FbxReferenceDT, "reference")), nullptr);
    EXPECT_EQ(typed(dynamic(FbxCompoundDT, "compound")), nullptr);
    EXPECT_EQ(typed(FbxProperty()), nullptr);
    EXPECT_EQ(typed(node->RootProperty), nullptr);
    EXPECT_EQ(layer->GetMemberCount(), 0);
}

TEST_F(FbxAnimCurveNodeTest, GivesNothingForChannelsThatAreNotThere) {
    FbxAnimCurveNode* made = typed(node->LclTranslation);
    FbxAnimCurve* curve = FbxAnimCurve::Create(scene, "");

    EXPECT_EQ(made->GetChannelIndex("x"), -1);
    EXPECT_EQ(made->GetChannelIndex(nullptr), -1);
    EXPECT_STREQ(made->GetChannelName(3).Buffer(), "");
    EXPECT_STREQ(made->GetChannelName(-1).Buffer(), "");
    EXPECT_EQ(made->GetChannelValue(3U, 7.5), 7.5);
    made->SetChannelValue(3U, 1.0);
    EXPECT_EQ(made->GetCurveCount(3U), 0);
    EXPECT_EQ(made->GetCurve(3U), nullptr);
    EXPECT_EQ(made->CreateCurve("", 3U), nullptr);
    EXPECT_EQ(made->CreateCurve("", "W"), nullptr);
    EXPECT_FALSE(made->ConnectToChannel(curve, 3U));
    EXPECT_FALSE(made->ConnectToChannel(curve, "W"));
    EXPECT_FALSE(made->ConnectToChannel(nullptr, 0U));
    EXPECT_FALSE(made->DisconnectFromChannel(curve, 0U));
    EXPECT_FALSE(made->DisconnectFromChannel(curve, 3U));
}

TEST_F(FbxAnimCurveNodeTest, HoldsSeveralCurvesPerChannelInOrder) {
    FbxAnimCurveNode* made = typed(node->LclTranslation);
    FbxAnimCurve* first = made->CreateCurve("a", "X");
    FbxAnimCurve* second = made->CreateCurve("b", "X");
    FbxAnimCurve* front = FbxAnimCurve::Create(scene, "c");
    EXPECT_TRUE(made->ConnectToChannel(front, 0U, /*pInFront=*/true));
    EXPECT_FALSE(made->ConnectToChannel(front, 0U));

    ASSERT_EQ(made->GetCurveCount(0U), 3);
    EXPECT_EQ(made->GetCurve(0U, 0U), front);
    EXPECT_EQ(made->GetCurve(0U, 1U), first);
    EXPECT_EQ(made->GetCurve(0U, 2U), second);
    EXPECT_EQ(made->GetCurve(0U, 3U), nullptr);
    EXPECT_EQ(made->GetCurveCount(0U, "T"), 3);
    EXPECT_EQ(made->GetCurveCount(0U, "R"), 0);
}

TEST_F(FbxAnimCurveNodeTest, LetsGoOfACurveChannelByChannel) {
    FbxAnimCurveNode* made = typed(node->LclTranslation);
    FbxAnimCurve* curve = made->CreateCurve("", "X");
    made->ConnectToChannel(curve, "Y");

    EXPECT_TRUE(made->DisconnectFromChannel(curve, 0U));
    EXPECT_EQ(made->GetCurve(0U), nullptr);
    EXPECT_EQ(made->GetCurve(1U), curve);
    EXPECT_TRUE(made->IsConnectedSrcObject(curve));
    EXPECT_TRUE(made->DisconnectFromChannel(curve, 1U));
    EXPECT_FALSE(made->IsConnectedSrcObject(curve));
}

TEST_F(FbxAnimCurveNodeTest, ForgetsADestroyedCurve) {
    FbxAnimCurveNode* made = typed(node->LclTranslation);
    FbxAnimCurve* curve = made->CreateCurve("", "X");
    made->ConnectToChannel(curve, "Y");

    curve->Destroy();

    EXPECT_EQ(made->GetCurveCount(0U), 0);
    EXPECT_EQ(made->GetCurveCount(1U), 0);
}

TEST_F(FbxAnimCurveNodeTest, IsAnimatedOnceACurveHasAKey) {
    FbxAnimCurveNode* made = typed(node->LclTranslation);
    EXPECT_FALSE(made->IsAnimated());
    FbxAnimCurve* curve = made->CreateCurve("", "Z");
    EXPECT_FALSE(made->IsAnimated());
    curve->KeyAdd(FbxTime(0));
    EXPECT_TRUE(made->IsAnimated());
}

TEST_F(FbxAnimCurveNodeTest, SpansTheKeysOfAllItsCurves) {
    FbxAnimCurveNode* made = typed(node->LclTranslation);
    FbxTimeSpan span(FbxTime(5), FbxTime(6));
    EXPECT_FALSE(made->GetAnimationInterval(span));
    EXPECT_EQ(span.GetStart(), FbxTime(5));

    made->CreateCurve("", "X")->KeyAdd(FbxTime(100));
    made->CreateCurve("", "Y");
    made->CreateCurve("", "Z")->KeyAdd(FbxTime(-7));
    EXPECT_TRUE(made->GetAnimationInterval(span));
    EXPECT_EQ(span.GetStart(), FbxTime(-7));
    EXPECT_EQ(span.GetStop(), FbxTime(100));
}

TEST_F(FbxAnimCurveNodeTest, PutsChannelsOfFilesIntoTheOrderOfComponents) {
    FbxAnimCurveNode* made = FbxAnimCurveNode::Create(scene, "T");
    made->addChannel("extra", 9.0);
    made->addChannel("Z", 3.0);
    made->addChannel("X", 1.0);
    FbxAnimCurve* curve = made->CreateCurve("", "Z");

    made->arrangeChannels({10, 20, 30});

    ASSERT_EQ(made->GetChannelsCount(), 4U);
    EXPECT_EQ(made->GetChannelIndex("X"), 0);
    EXPECT_EQ(made->GetChannelIndex("Y"), 1);
    EXPECT_EQ(made->GetChannelIndex("Z"), 2);
    EXPECT_EQ(made->GetChannelIndex("extra"), 3);
    EXPECT_EQ(made->GetChannelValue(0U, 0.0), 1.0);
    EXPECT_EQ(made->GetChannelValue(1U, 0.0), 20.0);
    EXPECT_EQ(made->GetCurve(2U), curve);
}

TEST_F(FbxAnimCurveNodeTest, TakesLettersOfColoursForComponents) {
    FbxAnimCurveNode* made = FbxAnimCurveNode::Create(scene, "Color");
    made->addChannel("B", 3.0);
    made->addChannel("G", 2.0);

    made->arrangeChannels({10, 20, 30});

    ASSERT_EQ(made->GetChannelsCount(), 3U);
    EXPECT_EQ(made->GetChannelIndex("X"), 0);
    EXPECT_EQ(made->GetChannelIndex("G"), 1);
    EXPECT_EQ(made->GetChannelIndex("B"), 2);
}

// How properties find their curves.

TEST_F(FbxAnimCurveNodeTest, OfAPropertyIsMadeOnceForEachLayer) {
    FbxAnimLayer* second = addLayer();
    FbxAnimCurveNode* first = node->LclTranslation.CreateCurveNode(layer);

    EXPECT_EQ(node->LclTranslation.GetCurveNode(layer, true), first);
    EXPECT_EQ(layer->CreateCurveNode(node->LclTranslation), first);
    EXPECT_EQ(node->LclTranslation.GetCurveNode(second), nullptr);
    EXPECT_NE(node->LclTranslation.GetCurveNode(second, true), first);
    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount<FbxAnimCurveNode>(), 2);
    EXPECT_EQ(layer->GetMemberCount<FbxAnimCurveNode>(), 1);
    EXPECT_EQ(first->GetScene(), scene);
}

TEST_F(FbxAnimCurveNodeTest, OfAPropertyIsFoundByStackOrAlone) {
    FbxAnimCurveNode* made = node->LclTranslation.GetCurveNode(stack, true);

    EXPECT_TRUE(layer->IsMember(made));
    EXPECT_EQ(node->LclTranslation.GetCurveNode(), made);
    EXPECT_EQ(node->LclTranslation.GetCurveNode(static_cast<FbxAnimStack*>(nullptr), true), nullptr);
    EXPECT_EQ(node->LclTranslation.GetCurveNode(FbxAnimStack::Create(scene, "no layers"), true), nullptr);
}

TEST_F(FbxAnimCurveNodeTest, GivesTheCurveOfAComponentAndMakesItOnDemand) {
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "X"), nullptr);
    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount(), 0); // a look-up creates nothing

    FbxAnimCurve* made = node->LclTranslation.GetCurve(layer, "Lcl Translation", "Y", true);

    ASSERT_NE(made, nullptr);
    EXPECT_EQ(made->GetScene(), scene);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "Y"), made);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "Y", true), made);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "X"), nullptr);
    EXPECT_EQ(node->LclTranslation.GetCurveNode(layer)->GetCurve(1U), made);
}

TEST_F(FbxAnimCurveNodeTest, TakesTheFirstChannelWhereNoneIsNamed) {
    FbxAnimCurve* x = node->LclTranslation.GetCurve(layer, "X", true);
    FbxLight* light = FbxLight::Create(scene, "");

    EXPECT_EQ(node->LclTranslation.GetCurve(layer), x);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, nullptr, nullptr, false), x);
    FbxAnimCurve* intensity = light->Intensity.GetCurve(layer, true);
    EXPECT_EQ(light->Intensity.GetCurve(layer, "Intensity"), intensity);
    EXPECT_NE(intensity, nullptr);
}

TEST_F(FbxAnimCurveNodeTest, GivesNoCurveForAnUnknownChannelOrAnotherName) {
    node->LclTranslation.GetCurve(layer, "X", true);

    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "W", true), nullptr);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "x", true), nullptr);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "", true), nullptr);
    EXPECT_EQ(node->LclTranslation.GetCurve(layer, "Lcl Rotation", "X", true), nullptr);
    EXPECT_EQ(node->LclTranslation.GetCurve(nullptr, "X", true), nullptr);
    EXPECT_EQ(FbxProperty().GetCurve(layer, "X", true), nullptr);
}

TEST_F(FbxAnimCurveNodeTest, GivesTheChannelsOfColoursByComponent) {
    FbxLight* light = FbxLight::Create(scene, "");
    FbxAnimCurve* green = light->Color.GetCurve(layer, "Color", "Y", true);

    ASSERT_NE(green, nullptr);
    EXPECT_EQ(light->Color.GetCurveNode(layer)->GetCurve(1U), green);

    FbxLight* other = FbxLight::Create(scene, "");
    FbxAnimCurveNode* file = FbxAnimCurveNode::Create(scene, "Color");
    for (const char* letter : {"R", "G", "B"})
        file->addChannel(letter, 0.0);
    layer->AddMember(file);
    other->Color.ConnectSrcObject(file);
    FbxAnimCurve* fileGreen = other->Color.GetCurve(layer, "Y", true);
    EXPECT_EQ(file->GetCurve(1U), fileGreen);
    EXPECT_NE(fileGreen, nullptr);
}

TEST_F(FbxAnimCurveNodeTest, IsMadeForNumbersWhetherOrNotTheyAreMarkedAsAnimatable) {
    FbxProperty number = FbxProperty::Create(node, FbxDoubleDT, "number");
    FbxProperty text = FbxProperty::Create(node, FbxStringDT, "text");
    FbxCamera* camera = FbxCamera::Create(scene, "camera");
    ASSERT_FALSE(number.GetFlag(FbxPropertyFlags::eAnimatable));
    ASSERT_FALSE(camera->FilmWidth.GetFlag(FbxPropertyFlags::eAnimatable));

    EXPECT_NE(number.GetCurve(layer, true), nullptr);
    EXPECT_NE(number.CreateCurveNode(layer), nullptr);
    EXPECT_NE(camera->FilmWidth.GetCurve(layer, "FilmWidth", nullptr, true), nullptr);
    EXPECT_EQ(text.GetCurve(layer, true), nullptr);
    EXPECT_EQ(text.CreateCurveNode(layer), nullptr);
    EXPECT_EQ(layer->GetMemberCount<FbxAnimCurveNode>(), 2);
}

TEST_F(FbxAnimCurveNodeTest, StartsChannelsAtThePropertysValue) {
    node->LclTranslation.Set(FbxDouble3(1, 2, 3));
    FbxAnimCurve* x = node->LclTranslation.GetCurve(layer, "X", true);
    x->KeySet(x->KeyAdd(FbxTime(0)), FbxTime(0), 10.0F);

    EXPECT_EQ(node->LclTranslation.EvaluateValue(FbxTime(0)), FbxDouble3(10, 2, 3));
}

TEST_F(FbxAnimCurveNodeTest, MakesAPropertyAnimatedOnItsLayerOnly) {
    FbxAnimLayer* second = addLayer();
    EXPECT_FALSE(node->LclTranslation.IsAnimated());

    FbxAnimCurve* curve = node->LclTranslation.GetCurve(second, "X", true);
    EXPECT_FALSE(node->LclTranslation.IsAnimated(second));
    curve->KeyAdd(FbxTime(0));

    EXPECT_TRUE(node->LclTranslation.IsAnimated(second));
    EXPECT_FALSE(node->LclTranslation.IsAnimated(layer));
    EXPECT_FALSE(node->LclTranslation.IsAnimated()); // the base layer of the current stack
}

TEST_F(FbxAnimCurveNodeTest, OutlivesItsPropertyOrItsLayer) {
    FbxAnimCurveNode* made = node->LclTranslation.GetCurveNode(layer, true);
    node->Destroy();
    EXPECT_EQ(made->GetDstPropertyCount(), 0);
    layer->Destroy();
    EXPECT_EQ(made->GetDstObject<FbxAnimLayer>(), nullptr);
    EXPECT_EQ(made->GetScene(), scene);
}

} // namespace
