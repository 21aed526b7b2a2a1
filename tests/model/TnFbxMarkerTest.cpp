// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The marker's size and look, and what its lifecycle leaves unchanged. Its channels are tested with those of all
// owners.
#include "TnFbxMarker.h"

#include "TransformOwner.h"

#include <type_traits>

namespace Tarnell::Fbx {
namespace {

using test::expectMarkedTransform;
using test::markTransform;

static_assert(std::is_base_of_v<TnFbxTransform, TnFbxMarker>);

static_assert(TnFbxMarker::kDefaultMarkerSize == 1.0f);
static_assert(TnFbxMarker::kFbxMarkerLookCube == 0);
static_assert(TnFbxMarker::kFbxMarkerLookHardCross == 1);
static_assert(TnFbxMarker::kFbxMarkerLookLightCross == 2);
static_assert(TnFbxMarker::kFbxMarkerLookSphere == 3);
static_assert(sizeof(TnFbxMarker::EFbxMarkerChannelType) == 4);
static_assert(sizeof(TnFbxMarker::EFbxMarkerLookType) == 4);

TnFbxMarker changedMarker() {
    TnFbxMarker marker;
    marker.setMarkerSize(2.5f);
    marker.setMarkerLookType(TnFbxMarker::kFbxMarkerLookSphere);
    marker.setValue(TnFbxMarker::kFbxMarkerGreen, 0.25f);
    markTransform(marker, "marker", 5.0f);
    return marker;
}

TEST(TnFbxMarker, StartsAsACubeOfSizeOne) {
    const TnFbxMarker marker;

    EXPECT_EQ(marker.getMarkerSize(), 1.0f);
    EXPECT_EQ(marker.getMarkerLookType(), TnFbxMarker::kFbxMarkerLookCube);
    EXPECT_EQ(marker.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 1.0f);
}

TEST(TnFbxMarker, StoresSizeAndLookWithoutACheck) {
    TnFbxMarker marker;

    for (const float size : {0.0f, -1.0f, 1e30f, test::kInfinity}) {
        EXPECT_TRUE(marker.setMarkerSize(size));
        EXPECT_EQ(marker.getMarkerSize(), size);
    }
    for (const int look : {3, 4, -1, test::kLowest, test::kHighest}) {
        EXPECT_TRUE(marker.setMarkerLookType(static_cast<TnFbxMarker::EFbxMarkerLookType>(look)));
        EXPECT_EQ(marker.getMarkerLookType(), look);
    }
}

TEST(TnFbxMarker, InitResetsTheMarkerPartAlone) {
    TnFbxMarker marker = changedMarker();

    EXPECT_TRUE(marker.initMarker());

    EXPECT_EQ(marker.getMarkerSize(), 1.0f);
    EXPECT_EQ(marker.getMarkerLookType(), TnFbxMarker::kFbxMarkerLookCube);
    EXPECT_EQ(marker.getValue(TnFbxMarker::kFbxMarkerGreen), 1.0f);
    expectMarkedTransform(marker, "marker", 5.0f);
}

TEST(TnFbxMarker, DeleteLeavesTheColourAtZeroButTheSizeAtOne) {
    TnFbxMarker marker = changedMarker();

    EXPECT_TRUE(marker.deleteMarker());

    EXPECT_EQ(marker.getValue(TnFbxMarker::kFbxMarkerRed), 0.0f);
    EXPECT_EQ(marker.getValue(TnFbxMarker::kFbxMarkerAlpha), 0.0f);
    EXPECT_EQ(marker.getMarkerSize(), 1.0f);
    EXPECT_EQ(marker.getMarkerLookType(), TnFbxMarker::kFbxMarkerLookCube);
    expectMarkedTransform(marker, "marker", 5.0f);
}

TEST(TnFbxMarker, AssignmentKeepsTheTargetsTransformAndName) {
    TnFbxMarker target;
    markTransform(target, "target", -1.0f);

    target = changedMarker();

    EXPECT_EQ(target.getMarkerSize(), 2.5f);
    EXPECT_EQ(target.getMarkerLookType(), TnFbxMarker::kFbxMarkerLookSphere);
    EXPECT_EQ(target.getValue(TnFbxMarker::kFbxMarkerGreen), 0.25f);
    expectMarkedTransform(target, "target", -1.0f);
}

} // namespace
} // namespace Tarnell::Fbx
