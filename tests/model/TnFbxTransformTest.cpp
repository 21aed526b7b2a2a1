// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The transform's orders, and what its lifecycle leaves unchanged. Its channels are tested with those of all owners.
#include "TnFbxTransform.h"

#include "ModelValues.h"

#include <type_traits>

namespace Tarnell::Fbx {
namespace {

static_assert(std::is_base_of_v<TnFbxObject, TnFbxTransform>);

static_assert(TnFbxTransform::kFbxRotationOrderXYZ == 0);
static_assert(TnFbxTransform::kFbxRotationOrderXZY == 1);
static_assert(TnFbxTransform::kFbxRotationOrderYXZ == 2);
static_assert(TnFbxTransform::kFbxRotationOrderYZX == 3);
static_assert(TnFbxTransform::kFbxRotationOrderZXY == 4);
static_assert(TnFbxTransform::kFbxRotationOrderZYX == 5);
static_assert(TnFbxTransform::kFbxTransformOrderDefault == 0);
static_assert(sizeof(TnFbxTransform::EFbxTransformChannelType) == 4);
static_assert(sizeof(TnFbxTransform::EFbxTransformRotationOrder) == 4);
static_assert(sizeof(TnFbxTransform::EFbxTransformTransformOrder) == 4);

TEST(TnFbxTransform, StartsWithRotationOrderZXYAndNoName) {
    const TnFbxTransform transform;

    EXPECT_EQ(transform.getTransformRotationOrder(), 4);
    EXPECT_EQ(transform.getTransformTransformOrder(), 0);
    EXPECT_EQ(transform.getName(), "");
}

TEST(TnFbxTransform, StoresOrdersWithoutACheck) {
    TnFbxTransform transform;

    for (const int order : {0, 5, 6, 99, -1, test::kLowest, test::kHighest}) {
        EXPECT_TRUE(
            transform.setTransformRotationOrder(static_cast<TnFbxTransform::EFbxTransformRotationOrder>(order)));
        EXPECT_TRUE(
            transform.setTransformTransformOrder(static_cast<TnFbxTransform::EFbxTransformTransformOrder>(order)));
        EXPECT_EQ(transform.getTransformRotationOrder(), order);
        EXPECT_EQ(transform.getTransformTransformOrder(), order);
    }
}

TnFbxTransform namedTransform(const char* name) {
    TnFbxTransform transform;
    transform.setName(name);
    transform.setTransformRotationOrder(TnFbxTransform::kFbxRotationOrderXYZ);
    transform.setTransformTransformOrder(static_cast<TnFbxTransform::EFbxTransformTransformOrder>(3));
    transform.setTransformValue(TnFbxTransform::kFbxTransformScaleX, 2.0f);
    return transform;
}

TEST(TnFbxTransform, InitResetsTheOrdersAndKeepsTheName) {
    TnFbxTransform transform = namedTransform("node");

    EXPECT_TRUE(transform.initTransform());

    EXPECT_EQ(transform.getTransformRotationOrder(), TnFbxTransform::kFbxRotationOrderZXY);
    EXPECT_EQ(transform.getTransformTransformOrder(), TnFbxTransform::kFbxTransformOrderDefault);
    EXPECT_EQ(transform.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 1.0f);
    EXPECT_EQ(transform.getName(), "node");
}

TEST(TnFbxTransform, DeleteLeavesAScaleOfZeroAndKeepsTheName) {
    TnFbxTransform transform = namedTransform("node");

    EXPECT_TRUE(transform.deleteTransform());

    EXPECT_EQ(transform.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 0.0f);
    EXPECT_EQ(transform.getTransformRotationOrder(), TnFbxTransform::kFbxRotationOrderZXY);
    EXPECT_EQ(transform.getTransformTransformOrder(), TnFbxTransform::kFbxTransformOrderDefault);
    EXPECT_EQ(transform.getName(), "node");
}

TEST(TnFbxTransform, AssignmentCopiesTheOrdersButNotTheName) {
    const TnFbxTransform source = namedTransform("a");
    TnFbxTransform target;
    target.setName("b");

    target = source;

    EXPECT_EQ(target.getName(), "b");
    EXPECT_EQ(target.getTransformRotationOrder(), TnFbxTransform::kFbxRotationOrderXYZ);
    EXPECT_EQ(target.getTransformTransformOrder(), 3);
    EXPECT_EQ(target.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 2.0f);
}

} // namespace
} // namespace Tarnell::Fbx
