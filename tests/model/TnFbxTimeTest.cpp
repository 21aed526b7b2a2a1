// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The time record and its seconds.
#include "TnFbxTime.h"

#include "ModelValues.h"

#include <cmath>
#include <type_traits>

namespace Tarnell::Fbx {
namespace {

using test::expectDefaultTime;
using test::expectTime;
using test::timeRecord;

static_assert(TnFbxTime::kDefaultTimeFrame == 0.0f);
static_assert(TnFbxTime::kDefaultTimeFrameRate == 24.0f);
static_assert(!std::is_polymorphic_v<TnFbxTime>);

TEST(TnFbxTime, StartsAtFrameZeroOverAnEmptyRangeAtTwentyFour) {
    const TnFbxTime time;

    expectDefaultTime(time);
    EXPECT_EQ(time.getTime(), 0.0f);
    EXPECT_EQ(time.getStartTime(), 0.0f);
    EXPECT_EQ(time.getEndTime(), 0.0f);
}

TEST(TnFbxTime, ConvertsFramesToSeconds) {
    TnFbxTime time;

    EXPECT_TRUE(time.setTime(1.5f, 1, 100, 25.0f));

    EXPECT_EQ(time.getTime(), 0.06f);
    EXPECT_EQ(time.getStartTime(), 0.04f);
    EXPECT_EQ(time.getEndTime(), 4.0f);
}

TEST(TnFbxTime, DividesInSinglePrecisionWithoutAnOffset) {
    EXPECT_EQ(timeRecord(12.0f, 1, 1, 24.0f).getTime(), 0.5f);
    EXPECT_EQ(timeRecord(12.0f, 1, 1, 24.0f).getStartTime(), 0x1.555556p-5f); // 1/24, not 0
    EXPECT_EQ(timeRecord(0.0f, 7, 7, 29.97f).getEndTime(), 7.0f / 29.97f);
}

TEST(TnFbxTime, RoundsAFrameToSinglePrecisionBeforeItDivides) {
    const TnFbxTime time = timeRecord(0.0f, 16777217, -16777219, 1.0f); // 2^24 + 1 is no float

    EXPECT_EQ(time.getStartTime(), 16777216.0f);
    EXPECT_EQ(time.getEndTime(), -16777220.0f);
}

TEST(TnFbxTime, StoresAnInvertedRangeAndAnyRateAsGiven) {
    expectTime(timeRecord(-1.25f, 10, -10, -30.0f), -1.25f, 10, -10, -30.0f);
    expectTime(timeRecord(3e38f, test::kHighest, test::kLowest, 0.0f), 3e38f, test::kHighest, test::kLowest, 0.0f);
}

TEST(TnFbxTime, SetsTheEndsOfTheRangeAlone) {
    TnFbxTime time = timeRecord(3.5f, 1, 2, 30.0f);

    EXPECT_TRUE(time.setStartFrame(-7));
    expectTime(time, 3.5f, -7, 2, 30.0f);

    EXPECT_TRUE(time.setEndFrame(99));
    expectTime(time, 3.5f, -7, 99, 30.0f);
}

TEST(TnFbxTime, GivesWhatTheDivisionGivesWhenTheRateIsZero) {
    const TnFbxTime time = timeRecord(0.0f, -1, 1, 0.0f);

    EXPECT_TRUE(std::isnan(time.getTime()));
    EXPECT_EQ(time.getStartTime(), -test::kInfinity);
    EXPECT_EQ(time.getEndTime(), test::kInfinity);
}

TEST(TnFbxTime, InitAndDeleteRestoreTheDefaults) {
    TnFbxTime time = timeRecord(1.0f, 2, 3, 4.0f);
    EXPECT_TRUE(time.initTime());
    expectDefaultTime(time);

    time = timeRecord(1.0f, 2, 3, 4.0f);
    EXPECT_TRUE(time.deleteTime());
    expectDefaultTime(time);
}

TEST(TnFbxTime, IsNewAgainWhenDestroyedAndConstructedInPlace) {
    TnFbxTime time = timeRecord(1.0f, 2, 3, 4.0f);

    time.~TnFbxTime();
    new (&time) TnFbxTime;

    expectDefaultTime(time);
}

TEST(TnFbxTime, CopiesAllFourFields) {
    const TnFbxTime source = timeRecord(1.5f, -2, 3, 4.25f);
    TnFbxTime target;

    target = source;
    expectTime(target, 1.5f, -2, 3, 4.25f);
    expectTime(TnFbxTime(source), 1.5f, -2, 3, 4.25f);

    const TnFbxTime& alias = target;
    target = alias;
    expectTime(target, 1.5f, -2, 3, 4.25f);
}

} // namespace
} // namespace Tarnell::Fbx
