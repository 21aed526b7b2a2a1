// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Attributes for display: nulls, markers, bones, groups, and those of unknown kind.
#include <fbxsdk/FbxNodeAttribute.h>

#include <fbxsdk/FbxCachedEffect.h>
#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxLODGroup.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxNode.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxOpticalReference.h>
#include <fbxsdk/FbxSkeleton.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

using FbxNodeAttributeTest = SceneFixture;

TEST_F(FbxNodeAttributeTest, NumbersItsKinds) {
    EXPECT_EQ(FbxNodeAttribute::eUnknown, 0);
    EXPECT_EQ(FbxNodeAttribute::eMesh, 4);
    EXPECT_EQ(FbxNodeAttribute::eCameraSwitcher, 9);
    EXPECT_EQ(FbxNodeAttribute::eNurbsSurface, 16);
    EXPECT_EQ(FbxNodeAttribute::eLine, 21);
}

TEST_F(FbxNodeAttributeTest, RepresentsUnknownKinds) {
    FbxNodeAttribute* attribute = make<FbxNodeAttribute>("unknown");

    EXPECT_EQ(attribute->GetAttributeType(), FbxNodeAttribute::eUnknown);
    EXPECT_EQ(attribute->Color.Get(), FbxDouble3(0.8, 0.8, 0.8));
    EXPECT_EQ(attribute->Color.Get(), FbxNodeAttribute::sDefaultColor);
    EXPECT_STREQ(attribute->Color.GetNameAsCStr(), FbxNodeAttribute::sColor);
    EXPECT_EQ(attribute->GetNodeCount(), 0);
    EXPECT_EQ(attribute->GetNode(), nullptr);
}

TEST_F(FbxNodeAttributeTest, KnowsTheNodeItWasConnectedToByHand) {
    FbxNode* node = make<FbxNode>();
    FbxNodeAttribute* attribute = make<FbxNodeAttribute>();

    node->ConnectSrcObject(attribute);
    EXPECT_EQ(attribute->GetNode(), node);
    EXPECT_EQ(node->GetNodeAttribute(), attribute);

    node->DisconnectSrcObject(attribute);
    EXPECT_EQ(attribute->GetNodeCount(), 0);
    EXPECT_EQ(node->GetNodeAttribute(), nullptr);
}

TEST_F(FbxNodeAttributeTest, IsNoNodesForBeingASceneMember) { EXPECT_EQ(make<FbxNull>()->GetNodeCount(), 0); }

using FbxNullTest = SceneFixture;

TEST_F(FbxNullTest, HasTheDefaultsOfFiles) {
    FbxNull* null = make<FbxNull>();

    EXPECT_EQ(null->GetAttributeType(), FbxNodeAttribute::eNull);
    EXPECT_EQ(null->Size.Get(), 100.0);
    EXPECT_EQ(null->Look.Get(), FbxNull::eCross);
    EXPECT_EQ(null->Look.Get<FbxEnum>(), 1);
    EXPECT_EQ(null->Color.Get(), FbxDouble3(0.8, 0.8, 0.8));
    EXPECT_EQ(FbxNull::sDefaultSize, 100.0);
    EXPECT_EQ(FbxNull::sDefaultLook, FbxNull::eCross);
    EXPECT_STREQ(FbxNull::sSize, "Size");
    EXPECT_STREQ(FbxNull::sLook, "Look");
    EXPECT_EQ(null->GetSizeDefaultValue(), 100.0);
    EXPECT_FALSE(null->Size.GetFlag(FbxPropertyFlags::eAnimatable));
}

TEST_F(FbxNullTest, GoesBackToItsDefaults) {
    FbxNull* null = make<FbxNull>();
    null->Size.Set(5.0);
    null->Look.Set(FbxNull::eNone);

    null->Reset();

    EXPECT_EQ(null->Size.Get(), 100.0);
    EXPECT_EQ(null->Look.Get(), FbxNull::eCross);
}

using FbxMarkerTest = SceneFixture;

TEST_F(FbxMarkerTest, HasItsDefaults) {
    FbxMarker* marker = make<FbxMarker>();

    EXPECT_EQ(marker->GetAttributeType(), FbxNodeAttribute::eMarker);
    EXPECT_EQ(marker->GetType(), FbxMarker::eStandard);
    EXPECT_EQ(marker->Look.Get(), FbxMarker::eCube);
    EXPECT_TRUE(marker->DrawLink.Get());
    EXPECT_EQ(marker->Size.Get(), 100.0);
    EXPECT_FALSE(marker->ShowLabel.Get());
    EXPECT_EQ(marker->IKPivot.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(marker->Color.Get(), FbxDouble3(0.8, 0.8, 0.8));
    EXPECT_EQ(marker->GetDefaultColor(), FbxColor(0.8, 0.8, 0.8, 1.0));
    EXPECT_EQ(FbxMarker::eNone, 10);
}

TEST_F(FbxMarkerTest, IsAMarkerWhateverItsType) {
    FbxMarker* marker = make<FbxMarker>();
    for (const auto type : {FbxMarker::eOptical, FbxMarker::eEffectorFK, FbxMarker::eEffectorIK}) {
        marker->SetType(type);
        EXPECT_EQ(marker->GetType(), type);
        EXPECT_EQ(marker->GetAttributeType(), FbxNodeAttribute::eMarker);
    }
}

TEST_F(FbxMarkerTest, GoesBackToItsDefaults) {
    FbxMarker* marker = make<FbxMarker>();
    marker->SetType(FbxMarker::eOptical);
    marker->Look.Set(FbxMarker::eSphere);
    marker->DrawLink.Set(false);
    marker->Size.Set(1.0);
    marker->ShowLabel.Set(true);
    marker->IKPivot.Set(FbxDouble3(1, 2, 3));

    marker->Reset();

    EXPECT_EQ(marker->GetType(), FbxMarker::eStandard);
    EXPECT_EQ(marker->Look.Get(), FbxMarker::eCube);
    EXPECT_TRUE(marker->DrawLink.Get());
    EXPECT_EQ(marker->Size.Get(), 100.0);
    EXPECT_FALSE(marker->ShowLabel.Get());
    EXPECT_EQ(marker->IKPivot.Get(), FbxDouble3(0, 0, 0));
}

using FbxSkeletonTest = SceneFixture;

TEST_F(FbxSkeletonTest, HasTheDefaultsOfFiles) {
    FbxSkeleton* bone = make<FbxSkeleton>();

    EXPECT_EQ(bone->GetAttributeType(), FbxNodeAttribute::eSkeleton);
    EXPECT_EQ(bone->GetSkeletonType(), FbxSkeleton::eLimbNode);
    EXPECT_EQ(bone->Size.Get(), 100.0);
    EXPECT_EQ(bone->LimbLength.Get(), 1.0);
    EXPECT_TRUE(bone->LimbLength.GetFlag(FbxPropertyFlags::eHidden));

    bone->SetSkeletonType(FbxSkeleton::eRoot);
    EXPECT_EQ(bone->GetSkeletonType(), FbxSkeleton::eRoot);
}

using FbxLODGroupTest = SceneFixture;

TEST_F(FbxLODGroupTest, HasTheDefaultsOfFiles) {
    FbxLODGroup* group = make<FbxLODGroup>();

    EXPECT_EQ(group->GetAttributeType(), FbxNodeAttribute::eLODGroup);
    EXPECT_FALSE(group->ThresholdsUsedAsPercentage.Get());
    EXPECT_FALSE(group->MinMaxDistance.Get());
    EXPECT_EQ(group->MinDistance.Get(), -100.0);
    EXPECT_EQ(group->MaxDistance.Get(), 100.0);
    EXPECT_FALSE(group->WorldSpace.Get());
    EXPECT_TRUE(group->FindProperty("Thresholds").IsValid());
}

using OtherAttributesTest = SceneFixture;

TEST_F(OtherAttributesTest, KnowTheirKind) {
    EXPECT_EQ(make<FbxOpticalReference>()->GetAttributeType(), FbxNodeAttribute::eOpticalReference);
    EXPECT_EQ(make<FbxCachedEffect>()->GetAttributeType(), FbxNodeAttribute::eCachedEffect);
    EXPECT_EQ(make<FbxCachedEffect>()->Color.Get(), FbxDouble3(0.8, 0.8, 0.8));
}

TEST_F(OtherAttributesTest, AreMadeByNeitherANullManagerNorANullContainer) {
    EXPECT_EQ(FbxNull::Create(static_cast<FbxManager*>(nullptr), "null"), nullptr);
    EXPECT_EQ(FbxNull::Create(static_cast<FbxObject*>(nullptr), "null"), nullptr);
    EXPECT_STREQ(FbxNull::Create(manager, nullptr)->GetName(), "");
}

TEST_F(OtherAttributesTest, DeriveAsTheClassTreeSays) {
    EXPECT_TRUE(FbxCamera::ClassId.Is(FbxNodeAttribute::ClassId));
    EXPECT_TRUE(FbxNull::ClassId.Is(FbxNodeAttribute::ClassId));
    EXPECT_TRUE(FbxMarker::ClassId.Is(FbxObject::ClassId));
    EXPECT_FALSE(FbxNodeAttribute::ClassId.Is(FbxCamera::ClassId));
    EXPECT_STREQ(FbxMarker::ClassId.GetName(), "FbxMarker");
}

} // namespace
