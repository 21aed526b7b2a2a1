// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The null's size and look, and what its lifecycle leaves unchanged.
#include "TnFbxNull.h"

#include "TransformOwner.h"

#include <type_traits>

namespace Tarnell::Fbx {
namespace {

using test::expectMarkedTransform;
using test::markTransform;

static_assert(std::is_base_of_v<TnFbxTransform, TnFbxNull>);

static_assert(TnFbxNull::kDefaultNullSize == 1.0f);
static_assert(TnFbxNull::kFbxNullLookNone == 0);
static_assert(TnFbxNull::kFbxNullLookCross == 1);
static_assert(sizeof(TnFbxNull::EFbxNullLookType) == 4);

TnFbxNull changedNull() {
    TnFbxNull null;
    null.setNullSize(2.5f);
    null.setNullLookType(TnFbxNull::kFbxNullLookNone);
    markTransform(null, "null", 5.0f);
    return null;
}

TEST(TnFbxNull, StartsAsACrossOfSizeOne) {
    const TnFbxNull null;

    EXPECT_EQ(null.getNullSize(), 1.0f);
    EXPECT_EQ(null.getNullLookType(), TnFbxNull::kFbxNullLookCross);
    EXPECT_EQ(null.getTransformValue(TnFbxTransform::kFbxTransformScaleX), 1.0f);
}

TEST(TnFbxNull, StoresSizeAndLookWithoutACheck) {
    TnFbxNull null;

    for (const float size : {0.0f, -1.0f, 1e30f, test::kInfinity}) {
        EXPECT_TRUE(null.setNullSize(size));
        EXPECT_EQ(null.getNullSize(), size);
    }
    for (const int look : {0, 1, 2, -1, test::kLowest, test::kHighest}) {
        EXPECT_TRUE(null.setNullLookType(static_cast<TnFbxNull::EFbxNullLookType>(look)));
        EXPECT_EQ(null.getNullLookType(), look);
    }
}

TEST(TnFbxNull, InitAndDeleteResetTheNullPartAlone) {
    TnFbxNull null = changedNull();
    EXPECT_TRUE(null.initNull());
    EXPECT_EQ(null.getNullSize(), 1.0f);
    EXPECT_EQ(null.getNullLookType(), TnFbxNull::kFbxNullLookCross);
    expectMarkedTransform(null, "null", 5.0f);

    null = changedNull();
    EXPECT_TRUE(null.deleteNull());
    EXPECT_EQ(null.getNullSize(), 1.0f);
    EXPECT_EQ(null.getNullLookType(), TnFbxNull::kFbxNullLookCross);
    expectMarkedTransform(null, "null", 5.0f);
}

TEST(TnFbxNull, AssignmentKeepsTheTargetsTransformAndName) {
    TnFbxNull target;
    markTransform(target, "target", -1.0f);

    target = changedNull();

    EXPECT_EQ(target.getNullSize(), 2.5f);
    EXPECT_EQ(target.getNullLookType(), TnFbxNull::kFbxNullLookNone);
    expectMarkedTransform(target, "target", -1.0f);

    const TnFbxNull& alias = target;
    target = alias;
    EXPECT_EQ(target.getNullSize(), 2.5f);
    expectMarkedTransform(target, "target", -1.0f);
}

TEST(TnFbxNull, ACopyHasTheTransformAndTheName) {
    const TnFbxNull source = changedNull();

    const TnFbxNull copy(source);

    EXPECT_EQ(copy.getNullSize(), 2.5f);
    expectMarkedTransform(copy, "null", 5.0f);
}

} // namespace
} // namespace Tarnell::Fbx
