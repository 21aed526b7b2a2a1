// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The attributes of nodes are read back from a file of any version: cameras, lights, nulls, markers, bones.

#include <fbxsdk/FbxCamera.h>
#include <fbxsdk/FbxCameraStereo.h>
#include <fbxsdk/FbxLODGroup.h>
#include <fbxsdk/FbxLight.h>
#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxNull.h>
#include <fbxsdk/FbxSkeleton.h>

#include "ExportFixture.h"

namespace {

using namespace fbxsdk;
using exporting::expectVector;

class AttributeWriting : public exporting::EveryLayout {};

INSTANTIATE_TEST_SUITE_P(Versions, AttributeWriting, testing::ValuesIn(exporting::allLayouts()));

TEST_P(AttributeWriting, KeepsACamera) {
    FbxCamera* camera = make<FbxCamera>("camera");
    addNode("node", camera);
    camera->Position.Set(FbxDouble3(1, 2, 3));
    camera->UpVector.Set(FbxDouble3(0, 0, 1));
    camera->InterestPosition.Set(FbxDouble3(4, 5, 6));
    camera->Roll.Set(12.5);
    camera->ProjectionType.Set(FbxCamera::eOrthogonal);
    camera->FilmWidth.Set(1.41732);
    camera->FilmHeight.Set(0.94488);
    camera->FocalLength.Set(35.0);
    camera->FieldOfView.Set(54.43);
    camera->NearPlane.Set(0.1);
    camera->FarPlane.Set(123456.75);
    camera->ApertureMode.Set(FbxCamera::eHorizontal);
    camera->FilmOffsetX.Set(0.25);

    FbxCamera* back = attributeOf<FbxCamera>(writeAndRead());

    ASSERT_NE(back, nullptr);
    expectVector(back->Position.Get(), 1, 2, 3);
    expectVector(back->UpVector.Get(), 0, 0, 1);
    expectVector(back->InterestPosition.Get(), 4, 5, 6);
    EXPECT_EQ(back->Roll.Get(), 12.5);
    EXPECT_EQ(back->ProjectionType.Get(), FbxCamera::eOrthogonal);
    EXPECT_EQ(back->FilmWidth.Get(), 1.41732);
    EXPECT_EQ(back->FilmHeight.Get(), 0.94488);
    EXPECT_EQ(back->FocalLength.Get(), 35.0);
    EXPECT_EQ(back->FieldOfView.Get(), 54.43);
    EXPECT_EQ(back->NearPlane.Get(), 0.1);
    EXPECT_EQ(back->FarPlane.Get(), 123456.75);
    EXPECT_EQ(back->ApertureMode.Get(), FbxCamera::eHorizontal);
    EXPECT_EQ(back->FilmOffsetX.Get(), 0.25);
}

TEST_P(AttributeWriting, KeepsALight) {
    FbxLight* light = make<FbxLight>("light");
    addNode("node", light);
    light->LightType.Set(FbxLight::eSpot);
    light->Color.Set(FbxDouble3(0.25, 0.5, 0.75));
    light->Intensity.Set(250.0);
    light->InnerAngle.Set(20.0);
    light->OuterAngle.Set(60.0);
    light->CastLight.Set(false);
    light->CastShadows.Set(true);
    light->DecayType.Set(FbxLight::eQuadratic);

    FbxLight* back = attributeOf<FbxLight>(writeAndRead());

    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->LightType.Get(), FbxLight::eSpot);
    expectVector(back->Color.Get(), 0.25, 0.5, 0.75);
    EXPECT_EQ(back->Intensity.Get(), 250.0);
    EXPECT_EQ(back->InnerAngle.Get(), 20.0);
    EXPECT_EQ(back->OuterAngle.Get(), 60.0);
    EXPECT_FALSE(back->CastLight.Get());
    EXPECT_TRUE(back->CastShadows.Get());
    EXPECT_EQ(back->DecayType.Get(), FbxLight::eQuadratic);
}

TEST_P(AttributeWriting, KeepsANull) {
    FbxNull* null = make<FbxNull>("null");
    addNode("node", null);
    null->Size.Set(12.0);
    null->Look.Set(FbxNull::eNone);

    FbxNull* back = attributeOf<FbxNull>(writeAndRead());

    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->Size.Get(), 12.0);
    EXPECT_EQ(back->Look.Get(), FbxNull::eNone);
}

TEST_P(AttributeWriting, KeepsAMarkerOfEveryType) {
    for (const FbxMarker::EType type :
         {FbxMarker::eStandard, FbxMarker::eOptical, FbxMarker::eEffectorFK, FbxMarker::eEffectorIK}) {
        FbxMarker* marker = make<FbxMarker>("marker");
        marker->SetType(type);
        marker->Look.Set(FbxMarker::eSphere);
        marker->Size.Set(3.0);
        marker->DrawLink.Set(false);
        addNode(std::to_string(type).c_str(), marker);
    }

    FbxScene* copy = writeAndRead();

    for (int i = 0; i < 4; ++i) {
        FbxMarker* back = FbxCast<FbxMarker>(childOf(copy, i)->GetNodeAttribute());
        ASSERT_NE(back, nullptr);
        EXPECT_EQ(back->GetType(), i);
        EXPECT_EQ(back->Look.Get(), FbxMarker::eSphere);
        EXPECT_EQ(back->Size.Get(), 3.0);
        EXPECT_FALSE(back->DrawLink.Get());
    }
}

TEST_P(AttributeWriting, KeepsABoneOfEveryType) {
    for (const FbxSkeleton::EType type :
         {FbxSkeleton::eRoot, FbxSkeleton::eLimb, FbxSkeleton::eLimbNode, FbxSkeleton::eEffector}) {
        FbxSkeleton* bone = make<FbxSkeleton>("bone");
        bone->SetSkeletonType(type);
        bone->Size.Set(33.25);
        addNode(std::to_string(type).c_str(), bone);
    }

    FbxScene* copy = writeAndRead();

    for (int i = 0; i < 4; ++i) {
        FbxSkeleton* back = FbxCast<FbxSkeleton>(childOf(copy, i)->GetNodeAttribute());
        ASSERT_NE(back, nullptr);
        EXPECT_EQ(back->GetSkeletonType(), i);
        EXPECT_EQ(back->Size.Get(), 33.25);
    }
}

TEST_P(AttributeWriting, KeepsAStereoCameraWithItsTwoCameras) {
    FbxCameraStereo* stereo = make<FbxCameraStereo>("stereo");
    addNode("node", stereo);
    stereo->InteraxialSeparation.Set(6.5);
    FbxCamera* left = make<FbxCamera>("left");
    FbxCamera* right = make<FbxCamera>("right");
    left->FocalLength.Set(21.0);
    right->FocalLength.Set(22.0);
    stereo->SetLeftCamera(left);
    stereo->SetRightCamera(right);

    FbxCameraStereo* back = attributeOf<FbxCameraStereo>(writeAndRead());

    ASSERT_NE(back, nullptr);
    EXPECT_EQ(back->InteraxialSeparation.Get(), 6.5);
    ASSERT_NE(back->GetLeftCamera(), nullptr);
    ASSERT_NE(back->GetRightCamera(), nullptr);
    EXPECT_EQ(back->GetLeftCamera()->FocalLength.Get(), 21.0);
    EXPECT_EQ(back->GetRightCamera()->FocalLength.Get(), 22.0);
}

TEST_P(AttributeWriting, KeepsALevelOfDetailGroup) {
    addNode("node", make<FbxLODGroup>("group"));

    attributeOf<FbxLODGroup>(writeAndRead());
}

TEST_P(AttributeWriting, KeepsInstancesOfOneAttribute) {
    FbxLight* light = make<FbxLight>("light");
    addNode("first", light);
    addNode("second", light);

    FbxScene* copy = writeAndRead();

    ASSERT_NE(childOf(copy, 0)->GetNodeAttribute(), nullptr);
    EXPECT_EQ(childOf(copy, 0)->GetNodeAttribute(), childOf(copy, 1)->GetNodeAttribute());
}

} // namespace
