// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One animatable value: its two states, how samples are set, and how it is copied.
#include "TnFbxChannel.h"

#include "ModelValues.h"

#include <bit>
#include <cstddef>
#include <cstdint>
#include <iterator>
#include <random>
#include <type_traits>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using test::channelOver;
using test::expectDefaultTime;
using test::expectTime;
using test::kHighest;
using test::kInfinity;
using test::kLowest;
using test::kNaN;
using test::range;
using test::samplesOf;
using test::timeRecord;
using Samples = std::vector<float>;

static_assert(TnFbxChannel::kDefaultChannelValue == 0.0f);
static_assert(!std::is_polymorphic_v<TnFbxChannel>);

/// Samples 2, 4, 6 over frames 10 to 12, static value 9, frame 1.5 at 30 frames per second.
TnFbxChannel filledChannel() {
    TnFbxChannel channel;
    channel.setValue(9.0f);
    channel.setAnimatedValues(timeRecord(1.5f, 10, 12, 30.0f), {2.0f, 4.0f, 6.0f});
    return channel;
}

void expectFilled(const TnFbxChannel& channel) {
    EXPECT_TRUE(channel.getAnimated());
    EXPECT_EQ(channel.getValue(), 9.0f);
    expectTime(channel.getTime(), 1.5f, 10, 12, 30.0f);
    EXPECT_EQ(samplesOf(channel), (Samples{2.0f, 4.0f, 6.0f}));
}

void expectStatic(const TnFbxChannel& channel, float value) {
    EXPECT_FALSE(channel.getAnimated());
    EXPECT_EQ(channel.getValue(), value);
    EXPECT_EQ(channel.getAnimatedValue(11.0f), value);
}

TEST(TnFbxChannel, StartsStaticAtZero) {
    const TnFbxChannel channel;

    EXPECT_FALSE(channel.getAnimated());
    EXPECT_EQ(channel.getValue(), 0.0f);
    for (const float frame : {-1e9f, -1.0f, 0.0f, 0.5f, 100.0f, kInfinity, kNaN})
        EXPECT_EQ(channel.getAnimatedValue(frame), 0.0f);
    expectDefaultTime(channel.getTime());
}

TEST(TnFbxChannel, InitSetsTheStaticValueAndRemovesEverythingElse) {
    TnFbxChannel channel = filledChannel();

    EXPECT_TRUE(channel.initChannel(50.0f));

    expectStatic(channel, 50.0f);
    EXPECT_EQ(channel.getAnimatedValue(10.0f), 50.0f);
    expectDefaultTime(channel.getTime());
}

TEST(TnFbxChannel, InitAndDeleteWithoutAValueGoBackToZero) {
    TnFbxChannel channel = filledChannel();
    EXPECT_TRUE(channel.initChannel());
    expectStatic(channel, 0.0f);
    expectDefaultTime(channel.getTime());

    channel = filledChannel();
    EXPECT_TRUE(channel.deleteChannel());
    expectStatic(channel, 0.0f);
    expectDefaultTime(channel.getTime());
}

TEST(TnFbxChannel, DeletingTheSamplesKeepsTheTimeRecordAndTheStaticValue) {
    TnFbxChannel channel = filledChannel();

    EXPECT_TRUE(channel.deleteAnimatedValues());

    expectStatic(channel, 9.0f);
    expectTime(channel.getTime(), 1.5f, 10, 12, 30.0f);
}

TEST(TnFbxChannel, SettingTheStaticValueLeavesTheSamplesAlone) {
    TnFbxChannel channel = filledChannel();

    EXPECT_TRUE(channel.setValue(-3.0f));

    EXPECT_EQ(channel.getValue(), -3.0f);
    EXPECT_TRUE(channel.getAnimated());
    EXPECT_EQ(samplesOf(channel), (Samples{2.0f, 4.0f, 6.0f}));
}

TEST(TnFbxChannel, StartsItsRangeAtTheFirstFrameKeyed) {
    TnFbxChannel channel;

    EXPECT_TRUE(channel.setValueAt(10.0f, 1.0f));

    EXPECT_TRUE(channel.getAnimated());
    expectTime(channel.getTime(), 0.0f, 10, 10, 24.0f);
    EXPECT_EQ(channel.getAnimatedValue(3.0f), 1.0f);
    EXPECT_EQ(channel.getAnimatedValue(20.0f), 1.0f);
    EXPECT_EQ(channel.getValue(), 0.0f);
}

TEST(TnFbxChannel, FillsTheGapWithZeroWhenKeyedBeyondTheRange) {
    TnFbxChannel channel;
    channel.setValue(7.0f);
    channel.setValueAt(10.0f, 1.0f);

    EXPECT_TRUE(channel.setValueAt(13.0f, 4.0f));

    EXPECT_EQ(samplesOf(channel), (Samples{1.0f, 0.0f, 0.0f, 4.0f}));
    EXPECT_EQ(channel.getAnimatedValue(12.5f), 2.0f);
    expectTime(channel.getTime(), 0.0f, 10, 13, 24.0f);
}

TEST(TnFbxChannel, FillsTheGapWithZeroWhenKeyedBeforeTheRange) {
    TnFbxChannel channel;
    channel.setValue(7.0f);
    channel.setValueAt(10.0f, 1.0f);

    EXPECT_TRUE(channel.setValueAt(7.0f, 5.0f));

    EXPECT_EQ(samplesOf(channel), (Samples{5.0f, 0.0f, 0.0f, 1.0f}));
    expectTime(channel.getTime(), 0.0f, 7, 10, 24.0f);
}

TEST(TnFbxChannel, LeavesNoGapBetweenNeighbouringFrames) {
    TnFbxChannel channel = channelOver(10, {1.0f, 2.0f});

    channel.setValueAt(12.0f, 3.0f);
    channel.setValueAt(9.0f, 0.5f);

    EXPECT_EQ(samplesOf(channel), (Samples{0.5f, 1.0f, 2.0f, 3.0f}));
}

TEST(TnFbxChannel, OverwritesASampleInsideTheRange) {
    TnFbxChannel channel = filledChannel();

    EXPECT_TRUE(channel.setValueAt(10.0f, -1.0f));
    EXPECT_TRUE(channel.setValueAt(12.0f, -2.0f));

    EXPECT_EQ(samplesOf(channel), (Samples{-1.0f, 4.0f, -2.0f}));
    expectTime(channel.getTime(), 1.5f, 10, 12, 30.0f);
}

TEST(TnFbxChannel, TruncatesAKeyedFrameTowardZero) {
    TnFbxChannel channel;

    channel.setValueAt(9.99f, 1.0f);
    EXPECT_EQ(channel.getTime().getStartFrame(), 9);
    EXPECT_EQ(channel.getTime().getEndFrame(), 9);

    channel.initChannel();
    channel.setValueAt(-2.5f, 1.0f);
    EXPECT_EQ(channel.getTime().getStartFrame(), -2);
}

TEST(TnFbxChannel, KeyingKeepsTheFrameAndTheRateOfTheTimeRecord) {
    TnFbxChannel channel = filledChannel();

    channel.setValueAt(14.0f, 1.0f);
    channel.setValueAt(8.0f, 1.0f);

    expectTime(channel.getTime(), 1.5f, 8, 14, 30.0f);
}

TEST(TnFbxChannel, StartsANewRangeAfterItsSamplesWereDeleted) {
    TnFbxChannel channel = filledChannel();
    channel.deleteAnimatedValues();

    channel.setValueAt(100.0f, 1.0f);

    EXPECT_EQ(samplesOf(channel), (Samples{1.0f}));
    expectTime(channel.getTime(), 1.5f, 100, 100, 30.0f);
}

TEST(TnFbxChannel, KeyedFrameByFrameGivesTheSameAsSetAtOnce) {
    TnFbxChannel forward;
    TnFbxChannel backward;
    Samples values;
    for (int frame = -50; frame <= 50; ++frame) {
        values.push_back(static_cast<float>(frame * frame));
        forward.setValueAt(static_cast<float>(frame), static_cast<float>(frame * frame));
        backward.setValueAt(static_cast<float>(-frame), static_cast<float>(frame * frame));
    }

    EXPECT_EQ(samplesOf(forward), values);
    EXPECT_EQ(samplesOf(backward), values);
}

TEST(TnFbxChannel, TakesAWholeRangeWithItsTimeRecord) {
    TnFbxChannel channel;

    EXPECT_TRUE(channel.setAnimatedValues(timeRecord(1.5f, -1, 1, 30.0f), {3.0f, 2.0f, 1.0f}));

    EXPECT_TRUE(channel.getAnimated());
    expectTime(channel.getTime(), 1.5f, -1, 1, 30.0f);
    EXPECT_EQ(samplesOf(channel), (Samples{3.0f, 2.0f, 1.0f}));
    EXPECT_EQ(channel.getValue(), 0.0f);
}

TEST(TnFbxChannel, ReplacesEarlierSamples) {
    TnFbxChannel channel = filledChannel();

    EXPECT_TRUE(channel.setAnimatedValues(range(1, 2), {5.0f, 6.0f}));

    EXPECT_EQ(samplesOf(channel), (Samples{5.0f, 6.0f}));
    expectTime(channel.getTime(), 0.0f, 1, 2, 24.0f);
    EXPECT_EQ(channel.getValue(), 9.0f);
}

TEST(TnFbxChannel, RejectsWhatDoesNotFitAndStaysAsItWas) {
    const struct {
        const char* what;
        TnFbxTime time;
        Samples values;
    } rejected[] = {
        {"fewer values than frames", range(1, 3), {1.0f, 2.0f}},
        {"inverted range", range(2, 1), {1.0f, 2.0f}},
        {"no values", range(1, 1), {}},
        {"rate of zero", timeRecord(0.0f, 1, 2, 0.0f), {1.0f, 2.0f}},
        {"rate of minus zero", timeRecord(0.0f, 1, 2, -0.0f), {1.0f, 2.0f}},
        {"negative rate", timeRecord(0.0f, 1, 2, -24.0f), {1.0f, 2.0f}},
        {"all frames there are", range(kLowest, kHighest), {1.0f, 2.0f}},
        {"half of all frames", range(0, kHighest), {1.0f, 2.0f}},
        {"inverted range of all frames", range(kHighest, kLowest), {1.0f, 2.0f}},
    };
    for (const auto& [what, time, values] : rejected) {
        SCOPED_TRACE(what);
        TnFbxChannel channel = filledChannel();
        EXPECT_FALSE(channel.setAnimatedValues(time, values));
        expectFilled(channel);
    }
}

TEST(TnFbxChannel, AcceptsARateOfNaN) {
    TnFbxChannel channel;

    EXPECT_TRUE(channel.setAnimatedValues(timeRecord(0.0f, 1, 2, kNaN), {1.0f, 2.0f}));

    EXPECT_EQ(samplesOf(channel), (Samples{1.0f, 2.0f}));
}

TEST(TnFbxChannel, NeverReadsValuesBeyondTheRange) {
    TnFbxChannel channel;

    EXPECT_TRUE(channel.setAnimatedValues(range(1, 3), {10.0f, 20.0f, 30.0f, 40.0f, 50.0f}));

    EXPECT_EQ(samplesOf(channel), (Samples{10.0f, 20.0f, 30.0f}));
    EXPECT_EQ(channel.getAnimatedValue(3.5f), 30.0f);
    EXPECT_EQ(channel.getAnimatedValue(4.0f), 30.0f);
    EXPECT_EQ(channel.getAnimatedValue(1e9f), 30.0f);
}

TEST(TnFbxChannel, NeverReadsValuesBeyondTheRangeAfterKeyingPastIt) {
    TnFbxChannel channel;
    channel.setAnimatedValues(range(1, 3), {10.0f, 20.0f, 30.0f, 40.0f, 50.0f});

    channel.setValueAt(5.0f, 9.0f);

    EXPECT_EQ(samplesOf(channel), (Samples{10.0f, 20.0f, 30.0f, 0.0f, 9.0f}));
}

TEST(TnFbxChannel, KeysInFrontOfARangeWithValuesBeyondIt) {
    TnFbxChannel channel;
    channel.setAnimatedValues(range(1, 2), {10.0f, 20.0f, 30.0f});

    channel.setValueAt(0.0f, 9.0f);
    EXPECT_EQ(samplesOf(channel), (Samples{9.0f, 10.0f, 20.0f}));
    EXPECT_EQ(channel.getAnimatedValue(2.5f), 20.0f);

    channel.setValueAt(3.0f, 8.0f);
    EXPECT_EQ(samplesOf(channel), (Samples{9.0f, 10.0f, 20.0f, 8.0f}));
}

TEST(TnFbxChannel, CopiesTheGivenValues) {
    Samples values{1.0f, 2.0f};
    TnFbxChannel channel;

    channel.setAnimatedValues(range(1, 2), values);
    values[0] = 100.0f;

    EXPECT_EQ(channel.getAnimatedValue(1.0f), 1.0f);
}

TEST(TnFbxChannel, AssignmentCopiesSamplesFlagTimeAndStaticValue) {
    TnFbxChannel target = channelOver(1, {1.0f, 2.0f, 3.0f, 4.0f});

    target = filledChannel();

    expectFilled(target);
}

TEST(TnFbxChannel, AssigningAStaticChannelMakesTheTargetStatic) {
    TnFbxChannel target = filledChannel();
    TnFbxChannel source;
    source.setValue(3.0f);

    target = source;

    expectStatic(target, 3.0f);
    expectDefaultTime(target.getTime());
}

TEST(TnFbxChannel, AssignmentToItselfChangesNothing) {
    TnFbxChannel channel = filledChannel();
    const TnFbxChannel& alias = channel;

    channel = alias;

    expectFilled(channel);
}

TEST(TnFbxChannel, ACopyIsIndependentOfItsSource) {
    TnFbxChannel source = filledChannel();
    const TnFbxChannel copy(source);

    source.setValueAt(11.0f, 100.0f);
    source.deleteChannel();

    expectFilled(copy);
}

// ---- Samples that are all equal are stored as one; this must not be observable ----

std::uint32_t bitsOf(float value) { return std::bit_cast<std::uint32_t>(value); }

/// The rules for samples, implemented a second time with every sample stored separately.
class PlainSamples {
public:
    void set(int start, const Samples& values) {
        mStart = start;
        mEnd = start + static_cast<int>(values.size()) - 1;
        mValues = values;
    }
    void setWithSurplus(int start, int end, const Samples& values) {
        mStart = start;
        mEnd = end;
        mValues = values;
    }
    void setAt(int frame, float value) {
        if (mValues.empty()) {
            set(frame, {value});
        } else if (frame < mStart) {
            mValues.insert(mValues.begin(), static_cast<std::size_t>(mStart - frame), 0.0f);
            mStart = frame;
        } else if (frame > mEnd) {
            mValues.resize(static_cast<std::size_t>(mEnd - mStart + 1));
            mValues.resize(static_cast<std::size_t>(frame - mStart + 1), 0.0f);
            mEnd = frame;
        }
        mValues[static_cast<std::size_t>(frame - mStart)] = value;
    }
    void expectIn(const TnFbxChannel& channel) const {
        EXPECT_EQ(channel.getTime().getStartFrame(), mStart);
        EXPECT_EQ(channel.getTime().getEndFrame(), mEnd);
        for (int frame = mStart; frame <= mEnd; ++frame) {
            const float sample = channel.getAnimatedValue(static_cast<float>(frame));
            EXPECT_EQ(bitsOf(sample), bitsOf(mValues[static_cast<std::size_t>(frame - mStart)])) << frame;
        }
    }

private:
    int mStart = 0, mEnd = 0;
    Samples mValues;
};

TEST(TnFbxChannel, KeepsEqualSamplesAsOneWithoutShowingIt) {
    const float payload = std::bit_cast<float>(std::uint32_t{0x7fc00123});
    const float values[] = {0.0f, -0.0f, 1.0f, 1.0f, 1.0f, kNaN, payload, kInfinity};
    std::minstd_rand random(1);
    const auto pick = [&random](std::size_t count) { return static_cast<std::size_t>(random()) % count; };
    for (int round = 0; round < 300; ++round) {
        TnFbxChannel channel;
        PlainSamples plain;
        for (int step = 0; step < 12; ++step) {
            const int frame = static_cast<int>(pick(24)) - 12;
            const float value = values[pick(std::size(values))];
            const Samples all(1 + pick(5), value);
            switch (pick(6)) {
            case 0:
                EXPECT_TRUE(channel.setAnimatedValues(range(frame, frame + static_cast<int>(all.size()) - 1), all));
                plain.set(frame, all);
                break;
            case 1: // with samples beyond the range
                EXPECT_TRUE(channel.setAnimatedValues(range(frame, frame), all));
                plain.setWithSurplus(frame, frame, all);
                break;
            case 2:
                EXPECT_TRUE(channel.setConstantValues(range(frame, frame + 4), value));
                plain.set(frame, Samples(5, value));
                break;
            default:
                EXPECT_TRUE(channel.setValueAt(static_cast<float>(frame), value));
                plain.setAt(frame, value);
            }
            plain.expectIn(TnFbxChannel(channel));
            ASSERT_FALSE(HasFailure()) << "round " << round << ", step " << step;
        }
    }
}

TEST(TnFbxChannel, DistinguishesZerosAndNaNsWhereItKeepsOneSample) {
    EXPECT_TRUE(channelOver(1, {2.0f, 2.0f, 2.0f}).isConstant());
    EXPECT_TRUE(channelOver(1, {kNaN, kNaN}).isConstant());
    EXPECT_FALSE(channelOver(1, {0.0f, -0.0f}).isConstant());
    EXPECT_FALSE(channelOver(1, {kNaN, std::bit_cast<float>(std::uint32_t{0x7fc00123})}).isConstant());
    EXPECT_TRUE(TnFbxChannel().isConstant());
}

TEST(TnFbxChannel, RefusesAConstantForWhatIsNoRange) {
    for (const TnFbxTime& time : {range(2, 1), timeRecord(0.0f, 1, 2, 0.0f), timeRecord(0.0f, 1, 2, -24.0f)}) {
        TnFbxChannel channel = filledChannel();
        EXPECT_FALSE(channel.setConstantValues(time, 9.0f));
        expectFilled(channel);
    }
}

TEST(TnFbxChannel, InterpolatesBetweenEqualSamplesAsBetweenOthers) {
    TnFbxChannel channel;
    ASSERT_TRUE(channel.setConstantValues(range(-5, 5), -0.0f));

    EXPECT_EQ(bitsOf(channel.getAnimatedValue(2.0f)), bitsOf(-0.0f));
    EXPECT_EQ(bitsOf(channel.getAnimatedValue(2.5f)), bitsOf(-0.0f + 0.5f * (-0.0f - -0.0f)));
    EXPECT_EQ(channel.getAnimatedValue(100.0f), -0.0f);
}

} // namespace
} // namespace Tarnell::Fbx
