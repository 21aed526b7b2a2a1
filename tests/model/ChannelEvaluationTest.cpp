// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A channel between its samples, at its ends, and at frames that an int or a float cannot represent.
#include "TnFbxChannel.h"

#include "ModelValues.h"
#include "model/SameBits.h"

#include <cmath>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using test::channelOver;
using test::kHighest;
using test::kInfinity;
using test::kLowest;
using test::kNaN;
using test::range;

TEST(ChannelEvaluation, HoldsTheEndSamplesOutsideTheRange) {
    TnFbxChannel channel = channelOver(10, {1.0f, 2.0f, 3.0f});
    channel.setValue(99.0f);

    for (const float before : {9.999f, 0.0f, -1e30f, -kInfinity})
        EXPECT_EQ(channel.getAnimatedValue(before), 1.0f) << before;
    for (const float after : {12.001f, 1e30f, kInfinity})
        EXPECT_EQ(channel.getAnimatedValue(after), 3.0f) << after;
}

TEST(ChannelEvaluation, JoinsNeighboursByAStraightLine) {
    const TnFbxChannel channel = channelOver(10, {1.0f, 2.0f, -2.0f});

    EXPECT_EQ(channel.getAnimatedValue(10.25f), 1.25f);
    EXPECT_EQ(channel.getAnimatedValue(10.5f), 1.5f);
    EXPECT_EQ(channel.getAnimatedValue(11.75f), -1.0f);
}

TEST(ChannelEvaluation, InterpolatesInSinglePrecisionInItsOwnGrouping) {
    const TnFbxChannel channel = channelOver(1, {0.1f, 0.6f});

    // (1 − t)·a + t·b, a fused multiply-add and double precision would all give 0x1.fffffep-3
    EXPECT_EQ(channel.getAnimatedValue(1.3f), 0x1.fffffcp-3f);
}

TEST(ChannelEvaluation, TakesAFrameWithinTheToleranceForAWholeOne) {
    const TnFbxChannel channel = channelOver(10, {1.0f, 1001.0f});

    EXPECT_EQ(channel.getAnimatedValue(10.00005f), 1.0f);
    EXPECT_EQ(channel.getAnimatedValue(10.00009f), 1.0f);
    EXPECT_GT(channel.getAnimatedValue(10.00011f), 1.0f);
}

TEST(ChannelEvaluation, HasTheToleranceOnlyAboveAPositiveFrame) {
    const TnFbxChannel channel = channelOver(10, {1.0f, 1001.0f});

    EXPECT_LT(channel.getAnimatedValue(10.99995f), 1001.0f); // truncated to 10, hence interpolated
    EXPECT_EQ(channel.getAnimatedValue(11.0f), 1001.0f);
}

TEST(ChannelEvaluation, ExtrapolatesFromTheRightBelowZero) {
    const TnFbxChannel channel = channelOver(-5, {10.0f, 20.0f, 60.0f});

    EXPECT_EQ(channel.getAnimatedValue(-4.5f), 0.0f);  // 20 − 0.5·(60 − 20), not the 15 between −5 and −4
    EXPECT_EQ(channel.getAnimatedValue(-3.5f), 60.0f); // −3 has no sample to its right
    EXPECT_EQ(channel.getAnimatedValue(-5.0f), 10.0f);
    EXPECT_EQ(channel.getAnimatedValue(-4.0f), 20.0f);
}

TEST(ChannelEvaluation, ExtrapolatesAcrossZeroFromZero) {
    const TnFbxChannel channel = channelOver(-1, {5.0f, 1.0f, 3.0f});

    EXPECT_EQ(channel.getAnimatedValue(-0.5f), 0.0f); // 1 − 0.5·(3 − 1)
    EXPECT_EQ(channel.getAnimatedValue(0.5f), 2.0f);
}

TEST(ChannelEvaluation, GivesTheOnlySampleEverywhere) {
    const TnFbxChannel channel = channelOver(-3, {7.0f});

    for (const float frame : {-kInfinity, -4.0f, -3.0f, -2.5f, 0.0f, kInfinity})
        EXPECT_EQ(channel.getAnimatedValue(frame), 7.0f) << frame;
}

TEST(ChannelEvaluation, GivesTheStaticValueAtAFrameOfNaN) {
    TnFbxChannel channel = channelOver(0, {1.0f, 2.0f});
    channel.setValue(99.0f);
    EXPECT_EQ(channel.getAnimatedValue(kNaN), 99.0f);

    TnFbxChannel lowest = channelOver(kLowest, {1.0f, 2.0f}); // NaN is not its lowest frame either
    lowest.setValue(99.0f);
    EXPECT_EQ(lowest.getAnimatedValue(kNaN), 99.0f);
}

TEST(ChannelEvaluation, PassesSamplesThatAreNoNumbersOn) {
    const TnFbxChannel channel = channelOver(0, {1.0f, kNaN, kInfinity});

    EXPECT_EQ(channel.getAnimatedValue(0.0f), 1.0f);
    EXPECT_TRUE(std::isnan(channel.getAnimatedValue(0.5f)));
    EXPECT_TRUE(std::isnan(channel.getAnimatedValue(1.0f)));
    EXPECT_EQ(channel.getAnimatedValue(2.0f), kInfinity);
}

TEST(ChannelEvaluation, GivesTheStaticValueWhereTheFloatOfTheLastFrameLiesAfterIt) {
    TnFbxChannel channel = channelOver(16777219, {7.0f}); // the nearest float is 16777220
    channel.setValue(99.0f);

    EXPECT_EQ(channel.getAnimatedValue(0.0f), 99.0f);
    EXPECT_EQ(channel.getAnimatedValue(16777219.0f), 99.0f);
    EXPECT_EQ(channel.getAnimatedValue(2e7f), 99.0f);
}

TEST(ChannelEvaluation, GivesTheStaticValueWhereTheFloatOfTheFirstFrameLiesBeforeIt) {
    TnFbxChannel channel = channelOver(16777217, {7.0f}); // the nearest float is 16777216
    channel.setValue(99.0f);

    EXPECT_EQ(channel.getAnimatedValue(0.0f), 99.0f);
}

TEST(ChannelEvaluation, WorksAtBothEndsOfTheRangeOfAnInt) {
    const TnFbxChannel lowest = channelOver(kLowest, {1.0f, 2.0f});
    EXPECT_EQ(lowest.getAnimatedValue(-kInfinity), 1.0f);
    EXPECT_EQ(lowest.getAnimatedValue(-2147483648.0f), 1.0f);
    EXPECT_EQ(lowest.getAnimatedValue(0.0f), 1.0f); // the float of the last frame is that of the first

    TnFbxChannel highest;
    highest.setAnimatedValues(range(kHighest - 1, kHighest), {1.0f, 2.0f});
    EXPECT_EQ(highest.getAnimatedValue(kInfinity), 2.0f);
    EXPECT_EQ(highest.getAnimatedValue(0.0f), 2.0f); // the float of the first frame is that of the last
}

TEST(ChannelEvaluation, GivesManyFramesWhatItGivesEach) {
    TnFbxChannel keyed = channelOver(-3, {1.0f, 2.0f, -0.0f, kNaN, 5.0f});
    TnFbxChannel constant, beyond, far, isStatic;
    constant.setConstantValues(range(-3, 1), 4.0f);
    beyond.setAnimatedValues(range(-3, -1), {1.0f, 2.0f, 3.0f, 4.0f, 5.0f});
    far.setAnimatedValues(range(16777214, 16777219), {1.0f, 2.0f, 3.0f, 4.0f, 5.0f, 6.0f});
    isStatic.setValue(7.0f);
    for (const TnFbxChannel& channel : {keyed, constant, beyond, far, isStatic}) {
        for (const int start : {-3, 16777214}) {
            for (int first = start - 2; first < start + 8; ++first) {
                for (std::size_t count = 0; count < 10; ++count) {
                    std::vector<float> values(count + 1, -1.0f);
                    channel.getAnimatedValues(first, count, values.data());
                    for (std::size_t i = 0; i < count; ++i)
                        EXPECT_TRUE(detail::haveSameBits(
                            values[i], channel.getAnimatedValue(static_cast<float>(first + static_cast<int>(i)))));
                    EXPECT_EQ(values[count], -1.0f);
                }
            }
        }
    }
}

TEST(ChannelEvaluation, GivesFramesUpToTheHighest) {
    TnFbxChannel channel;
    channel.setAnimatedValues(range(kHighest - 1, kHighest), {1.0f, 2.0f});
    std::vector<float> values(2);
    channel.getAnimatedValues(kHighest - 1, values.size(), values.data());
    for (const float value : values)
        EXPECT_EQ(value, channel.getAnimatedValue(static_cast<float>(kHighest)));
}

TEST(ChannelEvaluation, KeysTheFrameNearestToOneThatNoIntCanHold) {
    TnFbxChannel channel;

    channel.setValueAt(2147483520.0f, 1.0f); // the last float below 2^31
    channel.setValueAt(kInfinity, 2.0f);

    EXPECT_EQ(channel.getTime().getStartFrame(), 2147483520);
    EXPECT_EQ(channel.getTime().getEndFrame(), kHighest);
    EXPECT_EQ(channel.getAnimatedValue(2147483520.0f), 1.0f);
    EXPECT_EQ(channel.getAnimatedValue(3e9f), 2.0f);
}

TEST(ChannelEvaluation, KeysTheLowestFrameForNaNAndForFramesBelowIt) {
    for (const float frame : {kNaN, -kInfinity, -1e20f, -2147483648.0f}) {
        TnFbxChannel channel;
        EXPECT_TRUE(channel.setValueAt(frame, 1.0f));
        EXPECT_EQ(channel.getTime().getStartFrame(), kLowest);
        EXPECT_EQ(channel.getTime().getEndFrame(), kLowest);
        EXPECT_EQ(channel.getAnimatedValue(0.0f), 1.0f);
    }
}

} // namespace
} // namespace Tarnell::Fbx
