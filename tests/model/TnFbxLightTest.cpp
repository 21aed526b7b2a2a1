// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The light's type and decay, and what its lifecycle leaves unchanged. Its channels are tested with those of all
// owners.
#include "TnFbxLight.h"

#include "TransformOwner.h"

#include <type_traits>

namespace Tarnell::Fbx {
namespace {

using test::expectMarkedTransform;
using test::markTransform;

static_assert(std::is_base_of_v<TnFbxTransform, TnFbxLight>);

static_assert(TnFbxLight::kFbxLightPoint == 0);
static_assert(TnFbxLight::kFbxLightDirectional == 1);
static_assert(TnFbxLight::kFbxLightSpot == 2);
static_assert(TnFbxLight::kFbxLightDecayNone == 0);
static_assert(TnFbxLight::kFbxLightDecayLinear == 1);
static_assert(TnFbxLight::kFbxLightDecayQuadratic == 2);
static_assert(TnFbxLight::kFbxLightDecayCubic == 3);
static_assert(TnFbxLight::kNormalizeLightIntensity == 0.01f);
static_assert(sizeof(TnFbxLight::EFbxLightChannelType) == 4);
static_assert(sizeof(TnFbxLight::EFbxLightType) == 4);
static_assert(sizeof(TnFbxLight::EFbxLightDecayType) == 4);

TnFbxLight changedLight() {
    TnFbxLight light;
    light.setLightType(TnFbxLight::kFbxLightDirectional);
    light.setDecayType(TnFbxLight::kFbxLightDecayNone);
    light.setValue(TnFbxLight::kFbxLightIntensity, 0.25f);
    markTransform(light, "light", 5.0f);
    return light;
}

TEST(TnFbxLight, StartsAsASpotLightWithQuadraticDecay) {
    const TnFbxLight light;

    EXPECT_EQ(light.getLightType(), TnFbxLight::kFbxLightSpot);
    EXPECT_EQ(light.getDecayType(), TnFbxLight::kFbxLightDecayQuadratic);
    EXPECT_EQ(light.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 1.0f);
}

TEST(TnFbxLight, StoresTypeAndDecayWithoutACheck) {
    TnFbxLight light;

    for (const int type : {0, 2, 3, 4, -1, test::kLowest, test::kHighest}) {
        EXPECT_TRUE(light.setLightType(static_cast<TnFbxLight::EFbxLightType>(type)));
        EXPECT_TRUE(light.setDecayType(static_cast<TnFbxLight::EFbxLightDecayType>(type)));
        EXPECT_EQ(light.getLightType(), type);
        EXPECT_EQ(light.getDecayType(), type);
    }
}

TEST(TnFbxLight, NamesTheConeAngleWithASpace) {
    EXPECT_STREQ(TnFbxLight::getChannelName(TnFbxLight::kFbxLightConeAngle), "cone angle");
    EXPECT_EQ(TnFbxLight::getChannelName(static_cast<TnFbxLight::EFbxLightChannelType>(6)), nullptr);
}

TEST(TnFbxLight, InitResetsTheLightPartAlone) {
    TnFbxLight light = changedLight();

    EXPECT_TRUE(light.initLight());

    EXPECT_EQ(light.getLightType(), TnFbxLight::kFbxLightSpot);
    EXPECT_EQ(light.getDecayType(), TnFbxLight::kFbxLightDecayQuadratic);
    EXPECT_EQ(light.getValue(TnFbxLight::kFbxLightIntensity), 1.0f);
    EXPECT_EQ(light.getValue(TnFbxLight::kFbxLightConeAngle), 40.0f);
    expectMarkedTransform(light, "light", 5.0f);
}

TEST(TnFbxLight, DeleteLeavesIntensityAndColourAtZeroAndTheTransformAlone) {
    TnFbxLight light = changedLight();

    EXPECT_TRUE(light.deleteLight());

    EXPECT_EQ(light.getValue(TnFbxLight::kFbxLightIntensity), 0.0f);
    EXPECT_EQ(light.getValue(TnFbxLight::kFbxLightRed), 0.0f);
    EXPECT_EQ(light.getLightType(), TnFbxLight::kFbxLightSpot);
    EXPECT_EQ(light.getDecayType(), TnFbxLight::kFbxLightDecayQuadratic);
    expectMarkedTransform(light, "light", 5.0f);
}

TEST(TnFbxLight, AssignmentKeepsTheTargetsTransformAndName) {
    TnFbxLight target;
    markTransform(target, "target", -1.0f);

    target = changedLight();

    EXPECT_EQ(target.getLightType(), TnFbxLight::kFbxLightDirectional);
    EXPECT_EQ(target.getDecayType(), TnFbxLight::kFbxLightDecayNone);
    EXPECT_EQ(target.getValue(TnFbxLight::kFbxLightIntensity), 0.25f);
    expectMarkedTransform(target, "target", -1.0f);
}

} // namespace
} // namespace Tarnell::Fbx
