// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Frames between float and int.
#include "model/FrameArithmetic.h"

#include "ModelValues.h"

#include <cmath>
#include <cstdint>

namespace Tarnell::Fbx::detail {
namespace {

static_assert(truncateToInt(3.9f) == 3);

TEST(FrameArithmetic, TruncatesTowardZero) {
    EXPECT_EQ(truncateToInt(0.0f), 0);
    EXPECT_EQ(truncateToInt(-0.0f), 0);
    EXPECT_EQ(truncateToInt(3.9f), 3);
    EXPECT_EQ(truncateToInt(-2.5f), -2);
    EXPECT_EQ(truncateToInt(-0.999f), 0);
    EXPECT_EQ(truncateToInt(1e-40f), 0);
}

TEST(FrameArithmetic, IsExactUpToTheEndsOfAnInt) {
    EXPECT_EQ(truncateToInt(2147483520.0f), 2147483520); // the last float below 2^31
    EXPECT_EQ(truncateToInt(-2147483520.0f), -2147483520);
    EXPECT_EQ(truncateToInt(-2147483648.0f), test::kLowest);
}

TEST(FrameArithmetic, HoldsAtTheEndsOfAnIntBeyondThem) {
    for (const float beyond : {2147483648.0f, 1e20f, 3.4e38f, test::kInfinity})
        EXPECT_EQ(truncateToInt(beyond), test::kHighest) << beyond;
    for (const float beyond : {-2147483904.0f, -1e20f, -3.4e38f, -test::kInfinity})
        EXPECT_EQ(truncateToInt(beyond), test::kLowest) << beyond;
}

TEST(FrameArithmetic, TakesNaNForTheLowestInt) {
    EXPECT_EQ(truncateToInt(test::kNaN), test::kLowest);
    EXPECT_EQ(truncateToInt(-test::kNaN), test::kLowest);
}

TEST(FrameArithmetic, CountsTheFramesOfAnyRange) {
    EXPECT_EQ(frameCount(1, 3), 3);
    EXPECT_EQ(frameCount(5, 5), 1);
    EXPECT_EQ(frameCount(3, 1), -1);
    EXPECT_EQ(frameCount(test::kLowest, test::kHighest), std::int64_t{1} << 32);
    EXPECT_EQ(frameCount(test::kHighest, test::kLowest), 2 - (std::int64_t{1} << 32));
}

} // namespace
} // namespace Tarnell::Fbx::detail
