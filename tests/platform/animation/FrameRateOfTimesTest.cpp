// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The frame rate that is derived from key times.
#include "animation/FrameRateOfTimes.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <vector>

#include <gtest/gtest.h>

namespace fbxsdk::detail {
namespace {

constexpr double kTicksPerSecond = 46186158000.0;

using Times = std::vector<std::int64_t>;

std::int64_t timeOf(double frame, double rate) { return std::llround(frame / rate * kTicksPerSecond); }

/// Every n-th frame from the first to the last one.
Times timesAt(double rate, int first, int last, int step = 1) {
    Times times;
    for (int frame = first; frame <= last; frame += step)
        times.push_back(timeOf(frame, rate));
    return times;
}

Times with(Times times, std::int64_t more) {
    times.insert(std::upper_bound(times.begin(), times.end(), more), more);
    return times;
}

TEST(FrameRateOfTimes, IsThatOfAKeyPerFrame) {
    for (const double rate :
         {29.97, 23.976, 12.0, 12.5, 15.0, 24.0, 25.0, 30.0, 50.0, 59.94, 90.0, 120.0, 240.0, 1000.0}) {
        EXPECT_EQ(frameRateOfTimes(timesAt(rate, 0, 10)), rate);
        EXPECT_EQ(frameRateOfTimes(timesAt(rate, 1001, 1100)), rate);
        EXPECT_EQ(frameRateOfTimes(timesAt(rate, -20, 5)), rate);
        EXPECT_EQ(frameRateOfTimes(timesAt(rate, 0, 20000)), rate) << "of a long clip";
    }
}

TEST(FrameRateOfTimes, DistinguishesNeighbouringRates) {
    for (const double rate : {29.97, 30000.0 / 1001.0, 23.976, 24000.0 / 1001.0}) {
        const double found = frameRateOfTimes(timesAt(rate, 0, 1000));
        EXPECT_NEAR(found, rate, 1e-7 * rate);
    }
}

// Hosts keep their rate in single precision, and their times are those of that number.
TEST(FrameRateOfTimes, IsTheDecimalFractionThatAFloatApproximates) {
    for (const float rate : {29.97F, 23.976F, 59.94F})
        EXPECT_EQ(static_cast<float>(frameRateOfTimes(timesAt(static_cast<double>(rate), 1, 100))), rate);
    EXPECT_EQ(frameRateOfTimes(timesAt(static_cast<double>(29.97F), 1, 100)), 29.97);
}

TEST(FrameRateOfTimes, IsAUsualOneThatFitsSparseKeys) {
    EXPECT_EQ(frameRateOfTimes(timesAt(24.0, 0, 96, 7)), 24.0);
    EXPECT_EQ(frameRateOfTimes(timesAt(25.0, 0, 100, 9)), 25.0);
    EXPECT_EQ(frameRateOfTimes(timesAt(29.97, 0, 100, 50)), 29.97);
    EXPECT_EQ(frameRateOfTimes(timesAt(30.0, 0, 90, 15)), 30.0);
    EXPECT_EQ(frameRateOfTimes(Times{timeOf(0, 25), timeOf(13, 25), timeOf(17, 25), timeOf(40, 25)}), 25.0);
}

TEST(FrameRateOfTimes, StaysThirtyUnlessTheTimesContradictIt) {
    EXPECT_EQ(frameRateOfTimes(Times{timeOf(1, 1)}), 30.0); // a whole second, as at any rate
    EXPECT_EQ(frameRateOfTimes(Times{timeOf(7, 24)}), 24.0);
    EXPECT_EQ(frameRateOfTimes(Times{0, timeOf(100, 29.97)}), 29.97);
}

TEST(FrameRateOfTimes, DoesNotFollowAFewKeysBetweenFrames) {
    Times times = with(timesAt(24.0, 0, 100), timeOf(10.3, 24));
    EXPECT_EQ(frameRateOfTimes(times), 24.0);
    for (const double frame : {20.25, 31.71, 50.5, 77.77})
        times = with(std::move(times), timeOf(frame, 24));
    EXPECT_EQ(frameRateOfTimes(times), 24.0);
}

TEST(FrameRateOfTimes, FollowsKeysThatAreAllOnHalfFrames) { EXPECT_EQ(frameRateOfTimes(timesAt(48.0, 0, 100)), 48.0); }

TEST(FrameRateOfTimes, EndsForTimesAtBothEndsOfTheirRange) {
    using Limits = std::numeric_limits<std::int64_t>;
    for (const std::int64_t inset : {0, 1, 200, 401}) {
        EXPECT_GE(frameRateOfTimes(Times{Limits::min() + inset, Limits::max() - inset}), 0.0);
        EXPECT_EQ(frameRateOfTimes(with(timesAt(24.0, 1, 100), Limits::max() - inset)), 24.0);
    }
}

TEST(FrameRateOfTimes, IsNoneWhereNothingTellsOne) {
    EXPECT_EQ(frameRateOfTimes(Times{}), 0.0);
    EXPECT_EQ(frameRateOfTimes(Times{0}), 0.0);
    EXPECT_EQ(frameRateOfTimes(Times{1, 3, 7, 12345, 99999}), 0.0);
    EXPECT_EQ(frameRateOfTimes(Times{INT64_MIN, -1, 0, INT64_MAX}), 0.0);
}

} // namespace
} // namespace fbxsdk::detail
