// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties: look-up, dynamic and compound ones, flags, labels and connections. Values by type are tested with the
// conversions.
#include <cmath>
#include <string>
#include <vector>

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxNode.h>

#include "object/ObjectData.h"
#include "platform/scene/SceneFixture.h"
#include "schema/PropertyFlags.h"

namespace {

using namespace fbxsdk;

class FbxPropertyTest : public SceneFixture {
protected:
    FbxNode* node = FbxNode::Create(manager, "node");

    FbxProperty create(const FbxDataType& type, const char* name) { return FbxProperty::Create(node, type, name); }
};

TEST_F(FbxPropertyTest, OfNothingIsInvalidAndHarmless) {
    FbxProperty none;

    EXPECT_FALSE(none.IsValid());
    EXPECT_EQ(none.GetFbxObject(), nullptr);
    EXPECT_STREQ(none.GetNameAsCStr(), "");
    EXPECT_STREQ(none.GetName().Buffer(), "");
    EXPECT_STREQ(none.GetHierarchicalName().Buffer(), "");
    EXPECT_STREQ(none.GetLabel().Buffer(), "");
    EXPECT_FALSE(none.GetPropertyDataType().Valid());
    EXPECT_EQ(none.Get<FbxDouble3>(), FbxDouble3());
    EXPECT_EQ(none.EvaluateValue<FbxDouble>(FbxTime(7)), 0.0);
    EXPECT_FALSE(none.Set(1.0));
    none.ModifyFlag(FbxPropertyFlags::eAnimatable, true);
    EXPECT_FALSE(none.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_FALSE(none.GetParent().IsValid());
    EXPECT_FALSE(none.GetChild().IsValid());
    EXPECT_FALSE(none.GetSibling().IsValid());
    EXPECT_FALSE(none.Find("x").IsValid());
    EXPECT_FALSE(none.ConnectSrcObject(node));
    EXPECT_EQ(none.GetSrcObjectCount(), 0);
    EXPECT_FALSE(none.IsAnimated());
    EXPECT_EQ(none.GetCurve(nullptr, true), nullptr);
    EXPECT_FALSE(FbxProperty::Create(none, FbxIntDT, "x").IsValid());
}

TEST_F(FbxPropertyTest, IsFoundByItsNameAsWritten) {
    EXPECT_EQ(node->FindProperty("Lcl Translation"), node->LclTranslation);
    EXPECT_FALSE(node->FindProperty("lcl translation").IsValid());
    EXPECT_FALSE(node->FindProperty("Lcl Translation ").IsValid());
    EXPECT_FALSE(node->FindProperty("").IsValid());
    EXPECT_FALSE(node->FindProperty(nullptr).IsValid());
}

TEST_F(FbxPropertyTest, IsFoundInAnyCaseOnRequest) {
    EXPECT_EQ(node->FindProperty("LCL translation", /*pCaseSensitive=*/false), node->LclTranslation);
    const FbxProperty dynamic = create(FbxIntDT, "MyÄ");
    EXPECT_EQ(node->FindProperty("mYÄ", false), dynamic);
    EXPECT_FALSE(node->FindProperty("myä", false).IsValid()); // letters of ASCII only
}

TEST_F(FbxPropertyTest, IsFoundByNameAndTypeTogether) {
    EXPECT_TRUE(node->FindProperty("Lcl Translation", FbxLocalTranslationDT).IsValid());
    EXPECT_FALSE(node->FindProperty("Lcl Translation", FbxDouble3DT).IsValid());
    EXPECT_FALSE(node->FindProperty("none", FbxDouble3DT).IsValid());
}

TEST_F(FbxPropertyTest, HandlesAreEqualWhenTheyMeanTheSame) {
    FbxNode* other = FbxNode::Create(manager, "other");

    EXPECT_EQ(node->FindProperty("Visibility"), node->Visibility);
    EXPECT_NE(node->LclTranslation, node->LclRotation);
    EXPECT_NE(node->LclTranslation, other->LclTranslation);
}

TEST_F(FbxPropertyTest, CopyingAHandleCopiesNoValue) {
    FbxProperty copy = node->LclTranslation;

    copy.Set(FbxDouble3(1, 2, 3));

    EXPECT_EQ(node->LclTranslation.Get(), FbxDouble3(1, 2, 3));
}

TEST_F(FbxPropertyTest, AssigningATypedPropertyCopiesTheValue) {
    FbxNode* other = FbxNode::Create(manager, "other");
    other->LclTranslation.Set(FbxDouble3(1, 2, 3));

    node->LclTranslation = other->LclTranslation;
    other->LclTranslation = FbxDouble3(4, 5, 6);

    EXPECT_EQ(node->LclTranslation.Get(), FbxDouble3(1, 2, 3));
    EXPECT_EQ(node->LclTranslation.GetFbxObject(), node);
}

TEST_F(FbxPropertyTest, CostsNothingUntilItIsChanged) {
    EXPECT_TRUE(node->data().properties().empty());

    EXPECT_EQ(node->LclScaling.Get(), FbxDouble3(1, 1, 1));
    EXPECT_TRUE(node->LclScaling.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_TRUE(node->data().properties().empty());

    node->LclScaling.Set(FbxDouble3(2, 2, 2));
    EXPECT_EQ(node->data().properties().size(), 1U);
}

TEST_F(FbxPropertyTest, KeepsValuesApartHoweverManyAreChanged) {
    std::vector<FbxProperty> changed;
    for (FbxProperty each = node->GetFirstProperty(); each.IsValid(); each = node->GetNextProperty(each))
        if (each.GetPropertyDataType().GetType() == eFbxDouble3)
            changed.push_back(each);
    ASSERT_GT(changed.size(), 10U);
    for (std::size_t i = changed.size(); i-- > 0;)
        changed[i].Set(FbxDouble3(static_cast<double>(i), 0, 0));

    for (std::size_t i = 0; i < changed.size(); ++i)
        EXPECT_EQ(changed[i].Get<FbxDouble3>()[0], static_cast<double>(i)) << changed[i].GetNameAsCStr();
}

// Dynamic properties.

TEST_F(FbxPropertyTest, IsZeroOfItsTypeWhenCreated) {
    EXPECT_EQ(create(FbxIntDT, "int").Get<FbxInt>(), 0);
    EXPECT_EQ(create(FbxDoubleDT, "double").Get<FbxDouble>(), 0.0);
    EXPECT_EQ(create(FbxDouble4DT, "double4").Get<FbxDouble4>(), FbxDouble4(0, 0, 0, 0));
    EXPECT_FALSE(create(FbxBoolDT, "bool").Get<FbxBool>());
    EXPECT_STREQ(create(FbxStringDT, "string").Get<FbxString>().Buffer(), "");
    EXPECT_EQ(create(FbxTimeDT, "time").Get<FbxTime>(), FbxTime(0));
}

TEST_F(FbxPropertyTest, IsNeitherAnimatableNorUserDefinedWhenCreated) {
    FbxProperty made = create(FbxDoubleDT, "x");

    EXPECT_TRUE(made.IsValid());
    EXPECT_FALSE(made.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_FALSE(made.GetFlag(FbxPropertyFlags::eUserDefined));
    EXPECT_EQ(made.GetPropertyDataType(), FbxDoubleDT);
    EXPECT_EQ(made.GetFbxObject(), node);
}

TEST_F(FbxPropertyTest, IsFoundAgainWithTypeAndValueUntouched) {
    FbxProperty made = create(FbxIntDT, "x");
    made.Set(7);
    bool found = false;

    const FbxProperty again = FbxProperty::Create(node, FbxStringDT, "x", "", true, &found);

    EXPECT_TRUE(found);
    EXPECT_EQ(again, made);
    EXPECT_EQ(again.GetPropertyDataType(), FbxIntDT);
    EXPECT_EQ(again.Get<FbxInt>(), 7);
}

TEST_F(FbxPropertyTest, OfTheClassIsFoundWhenMadeAgain) {
    bool found = false;

    const FbxProperty again = FbxProperty::Create(node, FbxStringDT, "Lcl Scaling", "", true, &found);

    EXPECT_TRUE(found);
    EXPECT_EQ(again, node->LclScaling);
}

TEST_F(FbxPropertyTest, MayBeDuplicatedWithoutTheCheck) {
    bool found = true;
    FbxProperty first = create(FbxIntDT, "x");
    FbxProperty second = FbxProperty::Create(node, FbxIntDT, "x", "", /*pCheckForDup=*/false, &found);

    EXPECT_FALSE(found);
    EXPECT_NE(first, second);
    EXPECT_EQ(node->FindProperty("x"), first);
}

TEST_F(FbxPropertyTest, IsNotMadeWithoutObjectNameOrType) {
    bool found = true;
    EXPECT_FALSE(FbxProperty::Create(static_cast<FbxObject*>(nullptr), FbxIntDT, "x", "", true, &found).IsValid());
    EXPECT_FALSE(found);
    EXPECT_FALSE(FbxProperty::Create(node, FbxIntDT, nullptr).IsValid());
    EXPECT_FALSE(FbxProperty::Create(node, FbxDataType(), "x").IsValid());
    EXPECT_FALSE(FbxProperty::Create(node->RootProperty, FbxIntDT, nullptr).IsValid());
}

TEST_F(FbxPropertyTest, IsFoundAmongThousands) {
    std::vector<FbxProperty> made;
    for (int i = 0; i < 5'000; ++i)
        made.push_back(create(FbxIntDT, ("p" + std::to_string(i)).c_str()));
    FbxProperty doubled = FbxProperty::Create(node, FbxIntDT, "p17", "", false);

    for (const int i : {0, 31, 32, 33, 4'999})
        EXPECT_EQ(node->FindProperty(("p" + std::to_string(i)).c_str()), made[static_cast<std::size_t>(i)]) << i;
    EXPECT_EQ(node->FindProperty("P4999", false), made[4'999]);
    EXPECT_EQ(node->FindProperty("p17"), made[17]);
    EXPECT_NE(node->FindProperty("p17"), doubled);
    EXPECT_FALSE(node->FindProperty("p5000").IsValid());
}

TEST_F(FbxPropertyTest, IsListedAfterThoseOfTheClass) {
    const FbxProperty made = create(FbxIntDT, "x");

    FbxProperty last;
    int count = 0;
    for (FbxProperty each = node->GetFirstProperty(); each.IsValid(); each = node->GetNextProperty(each)) {
        last = each;
        ++count;
    }

    EXPECT_EQ(last, made);
    EXPECT_EQ(count, node->data().propertyCount());
    EXPECT_FALSE(node->GetNextProperty(made).IsValid());
    EXPECT_FALSE(node->GetNextProperty(FbxProperty()).IsValid());
    EXPECT_FALSE(node->GetNextProperty(make<FbxNode>()->LclScaling).IsValid());
}

TEST_F(FbxPropertyTest, OfAnObjectWithoutAnyIsNotListed) {
    EXPECT_FALSE(FbxObject::Create(manager, "bare")->GetFirstProperty().IsValid());
}

TEST_F(FbxPropertyTest, FallsBackToItsNameForALabel) {
    const FbxProperty plain = create(FbxIntDT, "plain");
    const FbxProperty labelled = FbxProperty::Create(node, FbxIntDT, "x", "The X");
    const FbxProperty null = FbxProperty::Create(node, FbxIntDT, "y", nullptr);

    EXPECT_STREQ(plain.GetLabel().Buffer(), "plain");
    EXPECT_STREQ(plain.GetLabel(/*pReturnNameIfEmpty=*/false).Buffer(), "");
    EXPECT_STREQ(labelled.GetLabel().Buffer(), "The X");
    EXPECT_STREQ(labelled.GetLabel(false).Buffer(), "The X");
    EXPECT_STREQ(null.GetLabel().Buffer(), "y");
    EXPECT_STREQ(node->LclScaling.GetLabel().Buffer(), "Lcl Scaling");
}

// Compounds.

TEST_F(FbxPropertyTest, IsBelowItsCompound) {
    FbxProperty compound = create(FbxCompoundDT, "Group");
    FbxProperty first = FbxProperty::Create(compound, FbxDoubleDT, "First");
    FbxProperty nested = FbxProperty::Create(compound, FbxCompoundDT, "Nested");
    FbxProperty deep = FbxProperty::Create(nested, FbxIntDT, "Deep");
    FbxProperty second = FbxProperty::Create(compound, FbxIntDT, "Second");

    EXPECT_STREQ(deep.GetNameAsCStr(), "Deep");
    EXPECT_STREQ(deep.GetHierarchicalName().Buffer(), "Group|Nested|Deep");
    EXPECT_EQ(compound.GetChild(), first);
    EXPECT_EQ(first.GetSibling(), nested);
    EXPECT_EQ(nested.GetSibling(), second);
    EXPECT_FALSE(second.GetSibling().IsValid());
    EXPECT_EQ(nested.GetChild(), deep);
    EXPECT_FALSE(deep.GetChild().IsValid());
    EXPECT_EQ(deep.GetParent(), nested);
    EXPECT_EQ(nested.GetParent(), compound);
    EXPECT_EQ(compound.GetParent(), node->RootProperty);
}

TEST_F(FbxPropertyTest, IsFoundBelowItsCompoundOrByItsWholePath) {
    FbxProperty compound = create(FbxCompoundDT, "Group");
    FbxProperty nested = FbxProperty::Create(compound, FbxCompoundDT, "Nested");
    FbxProperty deep = FbxProperty::Create(nested, FbxIntDT, "Deep");

    EXPECT_EQ(compound.Find("Nested"), nested);
    EXPECT_EQ(compound.Find("Nested|Deep"), deep);
    EXPECT_EQ(node->FindProperty("Group|Nested|Deep"), deep);
    EXPECT_EQ(node->RootProperty.Find("Group"), compound);
    EXPECT_EQ(compound.Find("nested", false), nested);
    EXPECT_FALSE(compound.Find("Deep").IsValid());
    EXPECT_FALSE(compound.Find(nullptr).IsValid());
    EXPECT_FALSE(node->FindProperty("Deep").IsValid());
}

TEST_F(FbxPropertyTest, IsNoChildOfACompoundWithALikeName) {
    FbxProperty compound = create(FbxCompoundDT, "Group");
    create(FbxIntDT, "Grouped");
    create(FbxIntDT, "Group2|x");

    EXPECT_FALSE(compound.GetChild().IsValid());
}

TEST_F(FbxPropertyTest, MadeBelowTheRootIsOneOfTheObject) {
    const FbxProperty made = FbxProperty::Create(node->RootProperty, FbxIntDT, "x");

    EXPECT_EQ(node->FindProperty("x"), made);
    EXPECT_STREQ(made.GetHierarchicalName().Buffer(), "x");
}

TEST_F(FbxPropertyTest, TheRootItselfHasNoValueAndTakesNoConnection) {
    FbxProperty root = node->RootProperty;

    EXPECT_TRUE(root.IsValid());
    EXPECT_FALSE(root.Set(1));
    EXPECT_EQ(root.Get<FbxInt>(), 0);
    EXPECT_FALSE(root.ConnectSrcObject(make<FbxNode>()));
    EXPECT_FALSE(root.ConnectDstObject(make<FbxNode>()));
    EXPECT_FALSE(root.ConnectSrcProperty(node->LclScaling));
    EXPECT_FALSE(node->LclScaling.ConnectSrcProperty(root));
    EXPECT_FALSE(root.GetFlag(FbxPropertyFlags::eStatic));
}

TEST_F(FbxPropertyTest, TheRootIsNoEndOfAConnectionOfObjectsEither) {
    EXPECT_FALSE(make<FbxNode>()->ConnectSrcProperty(node->RootProperty));
    EXPECT_FALSE(make<FbxNode>()->ConnectDstProperty(node->RootProperty));
}

// Flags.

TEST_F(FbxPropertyTest, TakesAndLosesFlagsOneByOne) {
    FbxProperty made = create(FbxDoubleDT, "x");

    made.ModifyFlag(FbxPropertyFlags::eAnimatable, true);
    made.ModifyFlag(FbxPropertyFlags::eUserDefined, true);
    EXPECT_TRUE(made.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_TRUE(made.GetFlag(FbxPropertyFlags::eUserDefined));
    EXPECT_FALSE(made.GetFlag(FbxPropertyFlags::eHidden));

    made.ModifyFlag(FbxPropertyFlags::eAnimatable, false);
    EXPECT_FALSE(made.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_TRUE(made.GetFlag(FbxPropertyFlags::eUserDefined));
}

TEST_F(FbxPropertyTest, ChangesFlagsOfOneObjectOnly) {
    FbxNode* other = FbxNode::Create(manager, "other");

    node->LclTranslation.ModifyFlag(FbxPropertyFlags::eAnimatable, false);

    EXPECT_FALSE(node->LclTranslation.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_TRUE(other->LclTranslation.GetFlag(FbxPropertyFlags::eAnimatable));
}

TEST_F(FbxPropertyTest, KnowsTheNumbersOfTheFlags) {
    EXPECT_EQ(FbxPropertyFlags::eStatic, 1);
    EXPECT_EQ(FbxPropertyFlags::eAnimatable, 2);
    EXPECT_EQ(FbxPropertyFlags::eAnimated, 4);
    EXPECT_EQ(FbxPropertyFlags::eImported, 8);
    EXPECT_EQ(FbxPropertyFlags::eUserDefined, 16);
    EXPECT_EQ(FbxPropertyFlags::eHidden, 32);
    EXPECT_EQ(FbxPropertyFlags::eNotSavable, 64);
    EXPECT_EQ(FbxPropertyFlags::eLockedMember0, 128);
}

TEST_F(FbxPropertyTest, SpellsFlagsAsFilesDo) {
    using Flags = FbxPropertyFlags;
    const struct {
        const char* text;
        unsigned flags;
    } kSpellings[] = {
        {"", 0},
        {"A", Flags::eAnimatable},
        {"A+", Flags::eAnimatable | Flags::eAnimated},
        {"A+U", Flags::eAnimatable | Flags::eAnimated | Flags::eUserDefined},
        {"UH", Flags::eUserDefined | Flags::eHidden},
        {"AL7", Flags::eAnimatable | Flags::eLockedMember0 | Flags::eLockedMember1 | Flags::eLockedMember2},
        {"A+L4M1", Flags::eAnimatable | Flags::eAnimated | Flags::eLockedMember2 | Flags::eMutedMember0},
        {"L15M15", Flags::eLockedAll | Flags::eMutedAll},
    };
    for (const auto& row : kSpellings) {
        EXPECT_EQ(detail::propertyFlags(row.text), row.flags) << row.text;
        EXPECT_EQ(detail::propertyFlagText(row.flags), row.text);
    }
}

TEST_F(FbxPropertyTest, TakesNothingFromFlagsThatAreNone) {
    for (const char* text : {"N", "L", "M", "L-1", "L0", "L99999999999", "7", "\xff"})
        EXPECT_EQ(detail::propertyFlags(text), 0U) << text;
    EXPECT_EQ(detail::propertyFlags("AL16N"), FbxPropertyFlags::eAnimatable);
    EXPECT_EQ(detail::propertyFlagText(FbxPropertyFlags::eStatic | FbxPropertyFlags::eNotSavable), "");
}

// Connections.

TEST_F(FbxPropertyTest, ConnectsWithObjectsOnceOnly) {
    FbxNode* source = FbxNode::Create(manager, "source");

    EXPECT_TRUE(node->LclTranslation.ConnectSrcObject(source));
    EXPECT_FALSE(node->LclTranslation.ConnectSrcObject(source));
    EXPECT_FALSE(node->LclTranslation.ConnectSrcObject(nullptr));
    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount(), 1);
    EXPECT_EQ(node->LclTranslation.GetSrcObject<FbxNode>(), source);
    EXPECT_TRUE(node->LclTranslation.IsConnectedSrcObject(source));
    EXPECT_FALSE(node->LclRotation.IsConnectedSrcObject(source));
    EXPECT_TRUE(node->LclTranslation.DisconnectSrcObject(source));
    EXPECT_FALSE(node->LclTranslation.DisconnectSrcObject(source));
    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount(), 0);
}

TEST_F(FbxPropertyTest, ConnectsWithPropertiesInOrder) {
    FbxNode* other = FbxNode::Create(manager, "other");

    EXPECT_TRUE(node->LclTranslation.ConnectSrcProperty(other->LclScaling));
    EXPECT_TRUE(other->LclRotation.ConnectDstProperty(node->LclTranslation));
    EXPECT_FALSE(node->LclTranslation.ConnectSrcProperty(node->LclTranslation));
    EXPECT_FALSE(node->LclTranslation.ConnectSrcProperty(FbxProperty()));
    EXPECT_EQ(node->LclTranslation.GetSrcPropertyCount(), 2);
    EXPECT_EQ(node->LclTranslation.GetSrcProperty(0), other->LclScaling);
    EXPECT_EQ(node->LclTranslation.GetSrcProperty(1), other->LclRotation);
    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount(), 0);
}

TEST_F(FbxPropertyTest, FeedsObjects) {
    FbxNode* destination = FbxNode::Create(manager, "destination");

    EXPECT_TRUE(node->LclTranslation.ConnectDstObject(destination));
    EXPECT_EQ(node->LclTranslation.GetDstObjectCount(), 1);
    EXPECT_EQ(node->LclTranslation.GetDstObject(), destination);
    EXPECT_EQ(destination->GetSrcProperty(), node->LclTranslation);
}

TEST_F(FbxPropertyTest, CountsByCriteria) {
    node->LclTranslation.ConnectSrcObject(FbxNode::Create(manager, ""));
    node->LclTranslation.ConnectSrcObject(FbxCamera::Create(manager, ""));

    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount(FbxCriteria::ObjectType(FbxNodeAttribute::ClassId)), 1);
    EXPECT_EQ(node->LclTranslation.GetSrcObjectCount<FbxNode>(), 1);
    EXPECT_EQ(node->LclTranslation.GetSrcObject<FbxLight>(), nullptr);
    EXPECT_EQ(node->LclTranslation.GetSrcObject(2), nullptr);
    EXPECT_EQ(node->LclTranslation.GetSrcObject(-1), nullptr);
}

// Enumerations.

TEST_F(FbxPropertyTest, GivesTheNumberOfAnEnumeration) {
    FbxLight* light = FbxLight::Create(manager, "light");
    light->LightType.Set(FbxLight::eSpot);

    EXPECT_EQ(light->LightType.Get(), FbxLight::eSpot);
    EXPECT_EQ(light->FindProperty("LightType").Get<FbxEnum>(), 2);
    EXPECT_EQ(light->FindProperty("LightType").Get<FbxDouble>(), 2.0);
}

TEST_F(FbxPropertyTest, StoresNothingForADefaultThatIsSet) {
    const std::size_t stored = node->data().properties().size();
    const FbxDouble3 translation = node->LclTranslation.Get();

    node->LclTranslation.Set(translation);
    EXPECT_EQ(node->data().properties().size(), stored);

    node->LclTranslation.Set(FbxDouble3(-0.0, 0.0, 0.0));
    EXPECT_EQ(node->data().properties().size(), stored + 1) << "minus zero is another value";
    node->LclTranslation.Set(translation);
    EXPECT_FALSE(std::signbit(node->LclTranslation.Get()[0]));
}

} // namespace
