// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves against closed forms, against numbers of real files, and with invalid keys.
#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>
#include <random>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/FbxTime.h>

#include "animation/CurveEvaluation.h"

namespace {

using namespace fbxsdk;
using detail::CurveKeys;
using detail::Extrapolation;
using detail::ExtrapolationType;
using detail::KeyAttributes;
namespace KeyFlag = detail::KeyFlag;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr float kThird = 1.0F / 3.0F;

constexpr std::uint32_t kConstant = KeyFlag::constant;
constexpr std::uint32_t kConstantNext = KeyFlag::constant | KeyFlag::constantNext;
constexpr std::uint32_t kLinear = KeyFlag::linear | KeyFlag::tangentAuto;
constexpr std::uint32_t kUser = KeyFlag::cubic | KeyFlag::tangentUser;
constexpr std::uint32_t kAuto = KeyFlag::cubic | KeyFlag::tangentAuto;
constexpr std::uint32_t kTcb = KeyFlag::cubic | KeyFlag::tangentTcb;
constexpr std::uint32_t kWeighted = KeyFlag::weightedRight | KeyFlag::weightedNextLeft;

struct Key {
    double seconds;
    float value;
    std::uint32_t flags = kLinear;
    float data0 = 0.0F; ///< right slope, bias or tension
    float data1 = 0.0F; ///< next left slope, bias or continuity
    float data2 = kThird;
    float data3 = kThird;
};

std::int64_t ticks(double seconds) { return std::llround(seconds * 46186158000.0); }

CurveKeys curveOf(const std::vector<Key>& keys, Extrapolation before = {}, Extrapolation after = {}) {
    CurveKeys curve;
    curve.before = before;
    curve.after = after;
    for (const Key& key : keys) {
        curve.times.push_back(ticks(key.seconds));
        curve.values.push_back(key.value);
        curve.attributeOfKey.push_back(0);
        curve.setAttributes(curve.times.size() - 1,
                            KeyAttributes{key.flags, {key.data0, key.data1, key.data2, key.data3, 0.0F, 0.0F}});
    }
    return curve;
}

float at(const CurveKeys& curve, double seconds) { return detail::evaluate(curve, ticks(seconds)); }

/// Key times of files are whole frames.
Key keyAtFrame(double frame, double rate, Key key) {
    key.seconds = frame / rate;
    return key;
}

TEST(CurveEvaluation, GivesTheDefaultValueWithoutKeys) {
    CurveKeys curve;
    EXPECT_EQ(at(curve, 1.0), 0.0F);
    curve.defaultValue = 7.5F;
    EXPECT_EQ(at(curve, 1.0), 7.5F);
    curve.times.push_back(0); // a key without value is not counted
    EXPECT_EQ(at(curve, 1.0), 7.5F);
}

TEST(CurveEvaluation, GivesTheValueOfAnOnlyKeyEverywhere) {
    for (const int type : {1, 2, 3, 4, 5}) {
        const Extrapolation extrapolation = {static_cast<ExtrapolationType>(type), -1};
        const CurveKeys curve = curveOf({{1.0, 3.5F, kUser, 100.0F, 100.0F}}, extrapolation, extrapolation);
        EXPECT_EQ(at(curve, -50.0), 3.5F);
        EXPECT_EQ(at(curve, 1.0), 3.5F);
        EXPECT_EQ(at(curve, 50.0), 3.5F);
    }
}

TEST(CurveEvaluation, GivesTheKeysValueExactlyOnAKey) {
    for (const std::uint32_t flags : {kConstant, kConstantNext, kLinear, kUser, kAuto, kTcb, kUser | kWeighted}) {
        const CurveKeys curve = curveOf({{0.0, 0.1F, flags, 5.0F, 6.0F, 0.7F, 0.1F},
                                         {0.3, 0.7F, flags, 5.0F, 6.0F, 0.7F, 0.1F},
                                         {1.1, -0.3F, flags}});
        EXPECT_EQ(at(curve, 0.0), 0.1F) << flags;
        EXPECT_EQ(at(curve, 0.3), 0.7F) << flags;
        EXPECT_EQ(at(curve, 1.1), -0.3F) << flags;
    }
}

TEST(CurveEvaluation, HoldsTheLeftValueWhenConstant) {
    const CurveKeys curve = curveOf({{0.0, 1.0F, kConstant}, {1.0, 2.0F, kConstant}});
    EXPECT_EQ(detail::evaluate(curve, 1), 1.0F);
    EXPECT_EQ(detail::evaluate(curve, ticks(1.0) - 1), 1.0F);
    EXPECT_EQ(at(curve, 1.0), 2.0F);
}

TEST(CurveEvaluation, HoldsTheRightValueWhenConstantNext) {
    const CurveKeys curve = curveOf({{0.0, 1.0F, kConstantNext}, {1.0, 2.0F, kConstant}});
    EXPECT_EQ(at(curve, 0.0), 1.0F);
    EXPECT_EQ(detail::evaluate(curve, 1), 2.0F);
    EXPECT_EQ(detail::evaluate(curve, ticks(1.0) - 1), 2.0F);
}

TEST(CurveEvaluation, IsConstantWhenTheFlagsSayNothing) {
    const CurveKeys curve = curveOf({{0.0, 1.0F, 0}, {1.0, 2.0F, 0}});
    EXPECT_EQ(at(curve, 0.5), 1.0F);
}

TEST(CurveEvaluation, IsLinearInWholeTicks) {
    const CurveKeys curve = curveOf({{0.0, -2.0F}, {2.0, 6.0F}});
    for (int i = 0; i <= 1000; ++i) {
        const double seconds = 2.0 * i / 1000.0;
        const double expected = -2.0 + 8.0 * static_cast<double>(ticks(seconds)) / static_cast<double>(ticks(2.0));
        EXPECT_EQ(at(curve, seconds), static_cast<float>(expected)) << i;
    }
}

TEST(CurveEvaluation, IsTheHermiteCubicOfUserSlopes) {
    const CurveKeys curve = curveOf({{1.0, 3.0F, kUser, 4.0F, -6.0F}, {3.0, 5.0F, kUser}});
    for (int i = 1; i < 200; ++i) {
        const double u = i / 200.0;
        const double h00 = 2.0 * u * u * u - 3.0 * u * u + 1.0;
        const double h10 = u * u * u - 2.0 * u * u + u;
        const double h11 = u * u * u - u * u;
        const double expected = 3.0 * h00 + 4.0 * 2.0 * h10 + 5.0 * (1.0 - h00) - 6.0 * 2.0 * h11;
        EXPECT_NEAR(at(curve, 1.0 + 2.0 * u), expected, 1.0e-6) << u;
    }
}

TEST(CurveEvaluation, IsTheHermiteCubicAlsoWithWeightsOfAThird) {
    const CurveKeys plain = curveOf({{0.0, 3.0F, kUser, 4.0F, -6.0F}, {2.0, 5.0F, kUser}});
    const CurveKeys weighted = curveOf({{0.0, 3.0F, kUser | kWeighted, 4.0F, -6.0F}, {2.0, 5.0F, kUser}});
    for (double seconds = 0.0; seconds <= 2.0; seconds += 0.01)
        EXPECT_NEAR(at(weighted, seconds), at(plain, seconds), 1.0e-6) << seconds;
}

TEST(CurveEvaluation, IsTheBezierCurveOfWeightedSlopes) {
    const double weights[] = {0.0001, 0.01, 0.25, 0.5, 0.76, 0.99};
    for (const double right : weights) {
        for (const double left : weights) {
            const CurveKeys curve = curveOf(
                {{0.0, 1.0F, kUser | kWeighted, 2.0F, -1.0F, static_cast<float>(right), static_cast<float>(left)},
                 {4.0, 2.0F, kUser}});
            for (int i = 1; i < 100; ++i) {
                const double u = i / 100.0;
                const double b1 = 3.0 * (1.0 - u) * (1.0 - u) * u;
                const double b2 = 3.0 * (1.0 - u) * u * u;
                const double b3 = u * u * u;
                const double b0 = 1.0 - b1 - b2 - b3;
                const double time = 4.0 * (b1 * right + b2 * (1.0 - left) + b3);
                const double value =
                    b0 * 1.0 + b1 * (1.0 + 2.0 * right * 4.0) + b2 * (2.0 + 1.0 * left * 4.0) + b3 * 2.0;
                ASSERT_NEAR(at(curve, time), value, 2.0e-5) << right << ' ' << left << ' ' << u;
            }
        }
    }
}

TEST(CurveEvaluation, UsesAThirdOnTheSideThatIsNotWeighted) {
    const Key start = {0.0, 0.0F, kUser | KeyFlag::weightedRight, 3.0F, 3.0F, 0.6F, 0.9F};
    Key reference = start;
    reference.flags = kUser | kWeighted;
    reference.data3 = kThird;
    const CurveKeys curve = curveOf({start, {1.0, 1.0F, kUser}});
    const CurveKeys expected = curveOf({reference, {1.0, 1.0F, kUser}});
    for (double seconds = 0.05; seconds < 1.0; seconds += 0.05)
        EXPECT_NEAR(at(curve, seconds), at(expected, seconds), 1.0e-6);
}

TEST(CurveEvaluation, FollowsTheInterpolationOfTheLeftKey) {
    const CurveKeys curve = curveOf(
        {{0.0, 0.0F, kConstant}, {1.0, 10.0F, kLinear}, {2.0, 20.0F, kUser, 0.0F, 0.0F}, {3.0, 30.0F, kConstant}});
    EXPECT_EQ(at(curve, 0.5), 0.0F);
    EXPECT_EQ(at(curve, 1.5), 15.0F);
    EXPECT_EQ(at(curve, 2.5), 25.0F);
    EXPECT_NE(at(curve, 2.25), 22.5F);
}

TEST(CurveEvaluation, HoldsTheEndsWithConstantExtrapolation) {
    const CurveKeys curve = curveOf({{0.0, 1.0F}, {1.0, 2.0F}});
    EXPECT_EQ(at(curve, -1.0e6), 1.0F);
    EXPECT_EQ(at(curve, 1.0e6), 2.0F);
    EXPECT_EQ(detail::evaluate(curve, FBXSDK_TC_INFINITY), 2.0F);
    EXPECT_EQ(detail::evaluate(curve, FBXSDK_TC_MINFINITY), 1.0F);
}

TEST(CurveEvaluation, RepeatsWithoutEnd) {
    const Extrapolation repeat = {ExtrapolationType::repetition, -1};
    const CurveKeys curve = curveOf({{1.0, 10.0F}, {3.0, 30.0F}}, repeat, repeat);
    EXPECT_EQ(at(curve, 3.0), 30.0F);
    EXPECT_EQ(at(curve, 3.5), 15.0F);
    EXPECT_EQ(at(curve, 5.0), 10.0F); // the next repetition begins
    EXPECT_EQ(at(curve, 1000.5), 25.0F);
    EXPECT_EQ(at(curve, 0.5), 25.0F);
    EXPECT_EQ(at(curve, -1.0), 10.0F);
    EXPECT_EQ(at(curve, -1.5), 25.0F);
}

// As MotionBuilder's files with `Repetition: 0` are shown.
TEST(CurveEvaluation, HoldsTheEndsWithoutARepetition) {
    for (const auto type :
         {ExtrapolationType::repetition, ExtrapolationType::mirrorRepetition, ExtrapolationType::relativeRepetition}) {
        const CurveKeys curve = curveOf({{1.0, 10.0F}, {3.0, 30.0F}}, {type, 0}, {type, 0});
        EXPECT_EQ(at(curve, 3.0), 30.0F);
        EXPECT_EQ(at(curve, 3.5), 30.0F);
        EXPECT_EQ(at(curve, 1000.5), 30.0F);
        EXPECT_EQ(at(curve, 0.5), 10.0F);
        EXPECT_EQ(at(curve, -1000.5), 10.0F);
    }
}

TEST(CurveEvaluation, StopsAtTheEndOfTheLastRepetition) {
    const Extrapolation twice = {ExtrapolationType::repetition, 2};
    const CurveKeys curve = curveOf({{0.0, 10.0F}, {1.0, 20.0F}}, twice, twice);
    EXPECT_EQ(at(curve, 2.75), 17.5F);
    EXPECT_EQ(at(curve, 3.0), 20.0F);
    EXPECT_EQ(at(curve, 3.25), 20.0F);
    EXPECT_EQ(at(curve, -1.75), 12.5F);
    EXPECT_EQ(at(curve, -2.0), 10.0F);
    EXPECT_EQ(at(curve, -2.25), 10.0F);
}

TEST(CurveEvaluation, MirrorsEveryOtherRepetition) {
    const Extrapolation mirror = {ExtrapolationType::mirrorRepetition, -1};
    const CurveKeys curve = curveOf({{0.0, 0.0F}, {1.0, 8.0F}}, mirror, mirror);
    EXPECT_EQ(at(curve, 1.25), 6.0F);
    EXPECT_EQ(at(curve, 2.0), 0.0F);
    EXPECT_EQ(at(curve, 2.25), 2.0F);
    EXPECT_EQ(at(curve, 3.25), 6.0F);
    EXPECT_EQ(at(curve, -0.25), 2.0F);
    EXPECT_EQ(at(curve, -1.0), 8.0F);
    EXPECT_EQ(at(curve, -1.25), 6.0F);
    EXPECT_EQ(at(curve, -2.25), 2.0F);
}

TEST(CurveEvaluation, StopsMirroringWhereTheLastRepetitionEnds) {
    const auto mirrored = [](int count) {
        const Extrapolation mirror = {ExtrapolationType::mirrorRepetition, count};
        return curveOf({{0.0, 0.0F}, {1.0, 8.0F}}, mirror, mirror);
    };
    EXPECT_EQ(at(mirrored(1), 1.75), 2.0F);
    EXPECT_EQ(at(mirrored(1), 9.0), 0.0F);
    EXPECT_EQ(at(mirrored(2), 9.0), 8.0F);
    EXPECT_EQ(at(mirrored(1), -9.0), 8.0F);
    EXPECT_EQ(at(mirrored(2), -9.0), 0.0F);
}

TEST(CurveEvaluation, AddsTheRiseWithEveryRelativeRepetition) {
    const Extrapolation relative = {ExtrapolationType::relativeRepetition, -1};
    const CurveKeys curve = curveOf({{0.0, 5.0F}, {1.0, 8.0F}}, relative, relative);
    EXPECT_EQ(at(curve, 1.5), 9.5F);
    EXPECT_EQ(at(curve, 2.0), 11.0F);
    EXPECT_EQ(at(curve, 10.5), 36.5F);
    EXPECT_EQ(at(curve, -0.5), 3.5F);
    EXPECT_EQ(at(curve, -1.0), 2.0F);
    EXPECT_EQ(at(curve, -10.5), -26.5F);
}

TEST(CurveEvaluation, StopsRelativeRepetitionsWhereTheyHaveCome) {
    const Extrapolation relative = {ExtrapolationType::relativeRepetition, 3};
    const CurveKeys curve = curveOf({{0.0, 5.0F}, {1.0, 8.0F}}, relative, relative);
    EXPECT_EQ(at(curve, 3.5), 15.5F);
    EXPECT_EQ(at(curve, 100.0), 17.0F);
    EXPECT_EQ(at(curve, -100.0), -4.0F);
}

TEST(CurveEvaluation, ContinuesAsALineWhenTheSlopeIsKept) {
    const Extrapolation slope = {ExtrapolationType::keepSlope, -1};
    const CurveKeys cubic = curveOf({{0.0, 1.0F, kUser, 2.0F, -3.0F}, {1.0, 5.0F, kUser}}, slope, slope);
    EXPECT_EQ(at(cubic, -2.0), -3.0F);
    EXPECT_EQ(at(cubic, 3.0), -1.0F);
    const CurveKeys linear = curveOf({{0.0, 1.0F}, {2.0, 5.0F}}, slope, slope);
    EXPECT_EQ(at(linear, -1.0), -1.0F);
    EXPECT_EQ(at(linear, 3.0), 7.0F);
    const CurveKeys constant = curveOf({{0.0, 1.0F, kConstant}, {2.0, 5.0F, kConstant}}, slope, slope);
    EXPECT_EQ(at(constant, -1.0), 1.0F);
    EXPECT_EQ(at(constant, 3.0), 5.0F);
}

// the numbers of a MotionBuilder file, and the values that an independent reader gives for them
TEST(CurveEvaluation, MirrorsAMotionBuilderCurveAsOftenAsItsFileSays) {
    const auto keys = {keyAtFrame(1.0, 24.0, {0.0, 0.0F, kUser, -30.9737F, -27.9356F}),
                       keyAtFrame(24.0, 24.0, {0.0, 10.0F, kUser, -27.9356F, 0.0F})};
    const CurveKeys endless =
        curveOf(keys, {ExtrapolationType::mirrorRepetition, -1}, {ExtrapolationType::mirrorRepetition, -1});
    const CurveKeys counted =
        curveOf(keys, {ExtrapolationType::mirrorRepetition, 2}, {ExtrapolationType::mirrorRepetition, 3});
    const CurveKeys slope = curveOf(keys, {ExtrapolationType::keepSlope, -1}, {ExtrapolationType::keepSlope, -1});

    EXPECT_NEAR(at(endless, 39.0 / 30.0), 9.63033016, 2.0e-5);
    EXPECT_NEAR(at(endless, 150.0 / 30.0), 11.6334765, 2.0e-5);
    EXPECT_NEAR(at(counted, 115.0 / 30.0), -1.0773108, 2.0e-5);
    EXPECT_EQ(at(counted, 150.0 / 30.0), 0.0F);
    EXPECT_NEAR(at(slope, 150.0 / 30.0), -101.742379, 2.0e-4);
}

TEST(CurveEvaluation, FollowsTheWeightedTangentsOfAMayaFile) {
    const CurveKeys curve = curveOf(
        {keyAtFrame(36.0, 24.0, {0.0, -3.95811F, KeyFlag::linear | KeyFlag::tangentUser, -4.67487F, -4.67487F}),
         keyAtFrame(46.0, 24.0, {0.0, -5.90598F, kUser | kWeighted, 0.0F, -4.29038F, 0.333333F, 0.766877F}),
         keyAtFrame(53.0, 24.0, {0.0, -5.11854F, kUser | kWeighted, 3.90672F, 3.98061F, 0.540154F, 0.520752F}),
         keyAtFrame(63.0, 24.0, {0.0, -5.11854F, kUser | kWeighted, -4.16532F, 0.216844F, 0.508151F, 0.616662F}),
         keyAtFrame(73.0, 24.0, {0.0, -3.87522F, kConstant})});
    EXPECT_NEAR(at(curve, 60.0 / 24.0), -5.3592688, 1.0e-5);
}

TEST(CurveEvaluation, FollowsTheProgressiveClampOfAMayaFile) {
    constexpr std::uint32_t kClamped =
        kAuto | KeyFlag::genericTimeIndependent | KeyFlag::genericClampProgressive | kWeighted;
    const CurveKeys curve =
        curveOf({keyAtFrame(1.0, 24.0, {0.0, 0.0F, kUser | kWeighted, 6.86191F, 5.37558F, 0.722972F, kThird}),
                 keyAtFrame(11.0, 24.0, {0.0, 0.746608F, kClamped, 0.0F, 3.96905F}),
                 keyAtFrame(20.0, 24.0, {0.0, 9.44874F, kClamped, 0.0F, -6.61502F, kThird, 0.773677F}),
                 keyAtFrame(30.0, 24.0, {0.0, 10.0F, kUser, -6.61503F, 0.0F})});
    EXPECT_NEAR(at(curve, 8.0 / 24.0), 0.77936, 1.0e-4);
    EXPECT_NEAR(at(curve, 15.0 / 24.0), 4.48869, 5.0e-5);
    EXPECT_NEAR(at(curve, 23.0 / 24.0), 10.60957, 1.5e-4);
}

TEST(CurveEvaluation, GivesTheSameInAnyOrderOfSampling) {
    std::mt19937_64 random(11);
    std::uniform_real_distribution<float> value(-10.0F, 10.0F);
    const Extrapolation repeat = {ExtrapolationType::repetition, -1};
    std::vector<Key> keys;
    for (int i = 0; i < 200; ++i)
        keys.push_back({i * 0.25, value(random), i % 3 == 0 ? kLinear : kAuto});
    const CurveKeys curve = curveOf(keys, repeat, repeat);

    detail::CurveCursor cursor;
    for (int i = -2000; i < 6000; ++i)
        ASSERT_EQ(detail::evaluate(curve, ticks(i / 60.0), &cursor), at(curve, i / 60.0)) << i;
    for (int i = 6000; i > -2000; i -= 7)
        ASSERT_EQ(detail::evaluate(curve, ticks(i / 60.0), &cursor), at(curve, i / 60.0)) << i;
    for (std::size_t wrong : {std::size_t{199}, std::size_t{200}, std::size_t{201}, SIZE_MAX, SIZE_MAX - 1}) {
        cursor.segment = wrong;
        EXPECT_EQ(detail::evaluate(curve, ticks(3.1), &cursor), at(curve, 3.1));
    }
}

std::vector<FbxTime> timesOf(int first, int last, double rate) {
    std::vector<FbxTime> times;
    for (int frame = first; frame < last; ++frame)
        times.emplace_back(ticks(frame / rate));
    return times;
}

void expectSameTogether(const CurveKeys& curve, const std::vector<FbxTime>& times, const char* what) {
    std::vector<float> values(times.size());
    detail::evaluate(curve, times.data(), static_cast<int>(times.size()), values.data());
    for (std::size_t i = 0; i < times.size(); ++i) {
        const float alone = detail::evaluate(curve, times[i].Get());
        ASSERT_EQ(std::memcmp(&values[i], &alone, sizeof alone), 0)
            << what << ' ' << i << ": " << values[i] << ' ' << alone;
    }
}

TEST(CurveEvaluation, GivesTheSameBitsForManyTimesTogether) {
    std::mt19937_64 random(17);
    std::uniform_real_distribution<float> value(-10.0F, 10.0F);
    const std::uint32_t kinds[] = {kConstant, kConstantNext, kLinear, kUser, kAuto, kTcb, kUser | kWeighted};
    for (int round = 0; round < 100; ++round) {
        const Extrapolation before = {static_cast<ExtrapolationType>(1 + round % 5), round % 4 - 1};
        const Extrapolation after = {static_cast<ExtrapolationType>(1 + round / 5 % 5), round / 3 % 4 - 1};
        std::vector<Key> keys;
        double time = 0.0;
        for (int i = 0; i < 1 + round % 30; ++i) {
            time += static_cast<double>(random() % 4) * (round % 2 == 0 ? 5.0 / 24.0 : 0.1); // also several at one time
            keys.push_back({time, value(random), kinds[random() % std::size(kinds)], value(random), value(random)});
        }
        const CurveKeys curve = curveOf(keys, before, after);
        expectSameTogether(curve, timesOf(-100, 1000, 24.0), "in order");
        std::vector<FbxTime> mixed = timesOf(-50, 500, 30.0);
        std::shuffle(mixed.begin(), mixed.end(), random);
        mixed.insert(mixed.end(), {FBXSDK_TIME_INFINITE, FBXSDK_TIME_MINUS_INFINITE, mixed.front(), mixed.front()});
        expectSameTogether(curve, mixed, "in any order");
    }
    expectSameTogether({}, timesOf(0, 3, 24.0), "without keys");
    expectSameTogether({}, {}, "without times");
}

TEST(CurveEvaluation, LetsTheLastOfSeveralKeysAtOneTimeCount) {
    const CurveKeys curve = curveOf({{0.0, 0.0F}, {1.0, 10.0F}, {1.0, 20.0F}, {1.0, 30.0F}, {2.0, 40.0F}});
    EXPECT_EQ(at(curve, 0.5), 5.0F);
    EXPECT_EQ(at(curve, 1.0), 30.0F);
    EXPECT_EQ(at(curve, 1.5), 35.0F);
}

TEST(CurveEvaluation, SurvivesKeysThatAreAllAtOneTime) {
    for (const int type : {1, 2, 3, 4, 5}) {
        const Extrapolation extrapolation = {static_cast<ExtrapolationType>(type), -1};
        const CurveKeys curve = curveOf({{1.0, 10.0F, kAuto}, {1.0, 20.0F, kAuto}}, extrapolation, extrapolation);
        EXPECT_EQ(at(curve, 0.0), 10.0F);
        EXPECT_EQ(at(curve, 1.0), 20.0F);
        EXPECT_EQ(at(curve, 2.0), 20.0F);
    }
}

TEST(CurveEvaluation, SpansTheWholeRangeOfTicks) {
    for (const int type : {1, 2, 3, 4, 5}) {
        const Extrapolation extrapolation = {static_cast<ExtrapolationType>(type), -1};
        for (const std::uint32_t flags : {kLinear, kAuto, kUser | kWeighted}) {
            CurveKeys curve = curveOf({{0.0, -1.0F, flags}, {1.0, 1.0F, flags}}, extrapolation, extrapolation);
            curve.times = {INT64_MIN, INT64_MAX};
            EXPECT_EQ(detail::evaluate(curve, INT64_MIN), -1.0F);
            EXPECT_EQ(detail::evaluate(curve, INT64_MAX), 1.0F);
            EXPECT_NEAR(detail::evaluate(curve, 0), 0.0F, 1.0e-6F);
            curve.times = {-1, 0};
            EXPECT_TRUE(std::isfinite(detail::evaluate(curve, INT64_MIN)));
            EXPECT_TRUE(std::isfinite(detail::evaluate(curve, INT64_MAX)));
        }
    }
}

TEST(CurveEvaluation, TreatsAnUnknownExtrapolationAsConstant) {
    const Extrapolation unknown = {static_cast<ExtrapolationType>(77), -1};
    const CurveKeys curve = curveOf({{0.0, 1.0F}, {1.0, 2.0F}}, unknown, unknown);
    EXPECT_EQ(at(curve, -1.0), 1.0F);
    EXPECT_EQ(at(curve, 2.0), 2.0F);
}

TEST(CurveEvaluation, SurvivesAttributesThatAreNotThere) {
    CurveKeys curve = curveOf({{0.0, 1.0F}, {1.0, 2.0F}, {2.0, 3.0F}});
    curve.attributeOfKey = {99, 0};
    curve.attributes.clear();
    EXPECT_TRUE(std::isfinite(at(curve, 0.5)));
    curve.attributeOfKey.clear();
    EXPECT_TRUE(std::isfinite(at(curve, 1.5)));
    EXPECT_EQ(at(curve, 1.0), 2.0F);
}

TEST(CurveEvaluation, UsesTheShorterOfTimesAndValues) {
    CurveKeys curve = curveOf({{0.0, 1.0F}, {1.0, 2.0F}, {2.0, 3.0F}});
    curve.values.pop_back();
    EXPECT_EQ(at(curve, 5.0), 2.0F);
}

TEST(CurveEvaluation, SurvivesNumbersThatAreNone) {
    const float oddities[] = {kNaN, kInfinity, -kInfinity, 3.0e38F, -3.0e38F, 1.0e-45F, 0.0F};
    for (const std::uint32_t flags : {kLinear, kUser, kAuto, kTcb, kUser | kWeighted, kAuto | kWeighted}) {
        for (const float odd : oddities) {
            const CurveKeys curve = curveOf({{0.0, 1.0F, flags, odd, odd, odd, odd}, {1.0, 2.0F, flags, odd, odd}});
            const float between = at(curve, 0.5);
            EXPECT_TRUE(std::isfinite(between)) << flags << ' ' << odd << ' ' << between;
            EXPECT_EQ(at(curve, 1.0), 2.0F);

            const CurveKeys broken = curveOf({{0.0, odd, flags}, {1.0, 2.0F, flags}, {2.0, odd, flags}});
            EXPECT_EQ(at(broken, 1.0), 2.0F);
            EXPECT_TRUE(!std::isfinite(odd) || std::isfinite(at(broken, 1.5))) << flags << ' ' << odd;
        }
    }
}

TEST(CurveEvaluation, SurvivesUnsortedTimes) {
    std::mt19937_64 random(13);
    for (int n = 0; n < 300; ++n) {
        const Extrapolation extrapolation = {static_cast<ExtrapolationType>(1 + n % 5), n % 4};
        CurveKeys curve = curveOf({{0.0, 1.0F, kAuto},
                                   {1.0, 2.0F, kAuto},
                                   {2.0, 3.0F, kUser | kWeighted, 1.0F, 1.0F},
                                   {3.0, 4.0F, kTcb},
                                   {4.0, 5.0F}},
                                  extrapolation, extrapolation);
        for (auto& time : curve.times)
            time = static_cast<std::int64_t>(random());
        detail::CurveCursor cursor;
        cursor.segment = random() % 7;
        for (int i = 0; i < 50; ++i) {
            const float value = detail::evaluate(curve, static_cast<std::int64_t>(random()), &cursor);
            EXPECT_FALSE(std::isnan(value));
        }
    }
}

TEST(CurveKeys, SharesEqualAttributes) {
    const CurveKeys curve = curveOf({{0.0, 1.0F}, {1.0, 2.0F}, {2.0, 3.0F}, {3.0, 3.0F, kAuto}, {4.0, 3.0F, kAuto}});
    EXPECT_EQ(curve.attributes.size(), 2U);
    EXPECT_EQ(curve.attributesOf(4).flags, kAuto);
    EXPECT_EQ(curve.attributesOf(2).flags, kLinear);
}

TEST(CurveKeys, DoesNotGrowWhenAKeysAttributesChangeAgainAndAgain) {
    CurveKeys curve = curveOf({{0.0, 1.0F}, {1.0, 2.0F}});
    for (int i = 0; i < 10000; ++i) {
        const KeyAttributes attributes = {kUser, {static_cast<float>(i), 0.0F, kThird, kThird, 0.0F, 0.0F}};
        curve.setAttributes(0, attributes);
        ASSERT_EQ(curve.attributesOf(0), attributes);
        ASSERT_EQ(curve.attributesOf(1).flags, kLinear);
    }
    EXPECT_LE(curve.attributes.size(), 6U);
}

} // namespace
