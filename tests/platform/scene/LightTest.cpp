// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Lights: defaults and names.
#include <fbxsdk/FbxLight.h>

#include "SceneFixture.h"

namespace {

using namespace fbxsdk;

class FbxLightTest : public SceneFixture {
protected:
    FbxLight* light = make<FbxLight>("light");
};

TEST_F(FbxLightTest, HasTheDefaultsOfFiles) {
    EXPECT_EQ(light->GetAttributeType(), FbxNodeAttribute::eLight);
    EXPECT_EQ(light->Color.Get(), FbxDouble3(1, 1, 1));
    EXPECT_EQ(light->ShadowColor.Get(), FbxDouble3(0, 0, 0));
    EXPECT_EQ(light->LightType.Get(), FbxLight::ePoint);
    EXPECT_EQ(light->DecayType.Get(), FbxLight::eNone);
    EXPECT_EQ(light->AreaLightShape.Get(), FbxLight::eRectangle);
    EXPECT_EQ(light->FileName.Get(), FbxString(""));
    const struct {
        const FbxPropertyT<FbxBool>& member;
        const char* name;
        bool value;
    } flags[] = {{light->CastLight, "CastLightOnObject", true},
                 {light->DrawVolumetricLight, "DrawVolumetricLight", true},
                 {light->DrawGroundProjection, "DrawGroundProjection", true},
                 {light->DrawFrontFacingVolumetricLight, "DrawFrontFacingVolumetricLight", false},
                 {light->EnableNearAttenuation, "EnableNearAttenuation", false},
                 {light->EnableFarAttenuation, "EnableFarAttenuation", false},
                 {light->CastShadows, "CastShadows", false},
                 {light->EnableBarnDoor, "EnableBarnDoor", false}};
    for (const auto& each : flags) {
        EXPECT_STREQ(each.member.GetNameAsCStr(), each.name);
        EXPECT_EQ(each.member.Get(), each.value) << each.name;
    }
    const struct {
        const FbxPropertyT<FbxDouble>& member;
        const char* name;
        double value;
    } numbers[] = {{light->Intensity, "Intensity", 100},
                   {light->InnerAngle, "InnerAngle", 0},
                   {light->OuterAngle, "OuterAngle", 45},
                   {light->Fog, "Fog", 50},
                   {light->DecayStart, "DecayStart", 0},
                   {light->NearAttenuationStart, "NearAttenuationStart", 0},
                   {light->NearAttenuationEnd, "NearAttenuationEnd", 0},
                   {light->FarAttenuationStart, "FarAttenuationStart", 0},
                   {light->FarAttenuationEnd, "FarAttenuationEnd", 0}};
    for (const auto& each : numbers) {
        EXPECT_STREQ(each.member.GetNameAsCStr(), each.name);
        EXPECT_EQ(each.member.Get(), each.value) << each.name;
        EXPECT_TRUE(each.member.GetFlag(FbxPropertyFlags::eAnimatable)) << each.name;
    }
    for (const auto* door : {&light->LeftBarnDoor, &light->RightBarnDoor, &light->TopBarnDoor, &light->BottomBarnDoor})
        EXPECT_EQ(door->Get(), 20.0F);
}

TEST_F(FbxLightTest, AnimatesItsColorAlthoughOtherAttributesDoNot) {
    EXPECT_TRUE(light->Color.GetFlag(FbxPropertyFlags::eAnimatable));
    EXPECT_FALSE(make<FbxNodeAttribute>()->Color.GetFlag(FbxPropertyFlags::eAnimatable));
}

TEST_F(FbxLightTest, GivesItsEnumerationsAsNumbers) {
    light->LightType.Set(FbxLight::eVolume);
    light->DecayType.Set(FbxLight::eCubic);

    EXPECT_EQ(light->LightType.Get<FbxEnum>(), 4);
    EXPECT_EQ(light->FindProperty("DecayType").Get<FbxEnum>(), 3);
}

TEST_F(FbxLightTest, ToleratesAnInvalidLightType) {
    light->FindProperty("LightType").Set(FbxEnum{-12345});

    EXPECT_EQ(light->LightType.Get<FbxEnum>(), -12345);
    EXPECT_EQ(static_cast<int>(light->LightType.Get()), -12345);
}

} // namespace
