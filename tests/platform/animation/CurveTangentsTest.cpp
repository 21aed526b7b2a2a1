// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The slopes that auto and TCB tangents have, from closed forms and from the files of two applications.
#include <cmath>
#include <vector>

#include <gtest/gtest.h>

#include "animation/CurveEvaluation.h"

namespace {

using namespace fbxsdk;
using detail::CurveKeys;
using detail::KeyAttributes;
namespace KeyFlag = detail::KeyFlag;

constexpr float kThird = 1.0F / 3.0F;
constexpr double kTolerance = 1.0e-6;
constexpr std::uint32_t kLinear = KeyFlag::linear | KeyFlag::tangentAuto;
constexpr std::uint32_t kUser = KeyFlag::cubic | KeyFlag::tangentUser;
constexpr std::uint32_t kAuto = KeyFlag::cubic | KeyFlag::tangentAuto;
constexpr std::uint32_t kSpline = kAuto | KeyFlag::genericTimeIndependent;
constexpr std::uint32_t kClamped = kAuto | KeyFlag::genericClamp;
constexpr std::uint32_t kProgressive = kSpline | KeyFlag::genericClampProgressive;
constexpr std::uint32_t kTcb = KeyFlag::cubic | KeyFlag::tangentTcb;

struct Key {
    double seconds;
    float value;
    std::uint32_t flags = kAuto;
    float data0 = 0.0F;
    float data1 = 0.0F;
    float data2 = kThird;
    float data3 = kThird;
};

CurveKeys curveOf(const std::vector<Key>& keys) {
    CurveKeys curve;
    for (const Key& key : keys) {
        curve.times.push_back(std::llround(key.seconds * 46186158000.0));
        curve.values.push_back(key.value);
        curve.attributeOfKey.push_back(0);
        curve.setAttributes(curve.times.size() - 1,
                            KeyAttributes{key.flags, {key.data0, key.data1, key.data2, key.data3, 0.0F, 0.0F}});
    }
    return curve;
}

void expectSlope(const CurveKeys& curve, std::size_t key, double expected) {
    EXPECT_NEAR(detail::leftSlope(curve, key), expected, kTolerance);
    EXPECT_NEAR(detail::rightSlope(curve, key), expected, kTolerance);
}

TEST(CurveTangents, AreStoredOnesForUserKeys) {
    const CurveKeys curve =
        curveOf({{0.0, 0.0F, kUser, 1.0F, 2.0F}, {1.0, 5.0F, kUser, 3.0F, 4.0F}, {2.0, 0.0F, kUser}});
    EXPECT_EQ(detail::rightSlope(curve, 0), 1.0);
    EXPECT_EQ(detail::leftSlope(curve, 1), 2.0);
    EXPECT_EQ(detail::rightSlope(curve, 1), 3.0);
    EXPECT_EQ(detail::leftSlope(curve, 2), 4.0);
}

TEST(CurveTangents, AreTheMeanOfBothChordsForAutoKeys) {
    const CurveKeys curve = curveOf({{0.0, 0.0F}, {1.0, 10.0F}, {3.0, 14.0F}});
    expectSlope(curve, 1, (10.0 + 2.0) / 2.0);
}

TEST(CurveTangents, AreTheChordOfTheNeighboursWhenIndependentOfTime) {
    const CurveKeys curve = curveOf({{0.0, 0.0F, kSpline}, {1.0, 10.0F, kSpline}, {3.0, 14.0F, kSpline}});
    expectSlope(curve, 1, 14.0 / 3.0);
}

TEST(CurveTangents, AreTheOnlyChordAtTheEnds) {
    for (const std::uint32_t flags : {kAuto, kSpline, kClamped}) {
        const CurveKeys curve = curveOf({{0.0, 0.0F, flags}, {1.0, 10.0F, flags}, {3.0, 14.0F, flags}});
        EXPECT_NEAR(detail::rightSlope(curve, 0), 10.0, kTolerance) << flags;
        EXPECT_NEAR(detail::leftSlope(curve, 2), 2.0, kTolerance) << flags;
    }
}

TEST(CurveTangents, AreFlatAtTheEndsWithTheProgressiveClamp) {
    const CurveKeys curve =
        curveOf({{0.0, 0.0F, kProgressive}, {1.0, 10.0F, kProgressive}, {3.0, 14.0F, kProgressive}});
    EXPECT_EQ(detail::rightSlope(curve, 0), 0.0);
    EXPECT_EQ(detail::leftSlope(curve, 2), 0.0);
}

TEST(CurveTangents, AreFlatBesideAnEqualNeighbourWhenClamped) {
    const CurveKeys curve =
        curveOf({{0.0, 0.0F, kClamped}, {1.0, 5.0F, kClamped}, {2.0, 5.0F, kClamped}, {3.0, 9.0F, kClamped}});
    expectSlope(curve, 1, 0.0);
    expectSlope(curve, 2, 0.0);
    const CurveKeys moving = curveOf({{0.0, 0.0F, kClamped}, {1.0, 5.0F, kClamped}, {2.0, 6.0F, kClamped}});
    expectSlope(moving, 1, 3.0);
}

TEST(CurveTangents, DoNotPassTheNeighbourWithTheProgressiveClamp) {
    const auto middle = [](float before, float value, float after) {
        return curveOf({{0.0, before, kProgressive}, {1.0, value, kProgressive}, {2.0, after, kProgressive}});
    };
    expectSlope(middle(0.0F, 1.0F, 10.0F), 1, 3.0); // handle of a third of a second, rise 1
    expectSlope(middle(0.0F, 9.0F, 10.0F), 1, 3.0); // the same on the other side
    expectSlope(middle(0.0F, 5.0F, 10.0F), 1, 5.0); // nothing to limit
    expectSlope(middle(0.0F, -1.0F, -10.0F), 1, -3.0);
    expectSlope(middle(0.0F, 10.0F, 0.0F), 1, 0.0); // a peak
    expectSlope(middle(0.0F, 10.0F, 3.0F), 1, 0.0); // the chord falls, the segment before rose
    expectSlope(middle(0.0F, 0.0F, 10.0F), 1, 0.0);
}

TEST(CurveTangents, MeasureTheProgressiveClampByTheWeights) {
    const std::uint32_t weighted = kProgressive | KeyFlag::weightedRight | KeyFlag::weightedNextLeft;
    const CurveKeys curve =
        curveOf({{0.0, 0.0F, weighted, 0.0F, 0.0F, kThird, 0.5F}, {1.0, 1.0F, weighted}, {2.0, 10.0F, weighted}});
    expectSlope(curve, 1, 2.0);
}

TEST(CurveTangents, LeanTowardTheirOwnSideByTheBias) {
    // MotionBuilder keeps a smooth key's bias with opposite signs on its two sides
    const auto biased = [](float left, float right) {
        return curveOf({{0.0, 0.0F, kAuto, 0.0F, left}, {1.0, 10.0F, kAuto, right, 0.0F}, {2.0, 12.0F}});
    };
    expectSlope(biased(0.0F, 0.0F), 1, 6.0);
    expectSlope(biased(-100.0F, 100.0F), 1, 2.0);
    expectSlope(biased(100.0F, -100.0F), 1, 10.0);
    expectSlope(biased(-25.0F, 25.0F), 1, 5.0);
    expectSlope(biased(500.0F, -500.0F), 1, 26.0);
}

TEST(CurveTangents, AddAnAbsoluteAmountBeyondABiasOf500) {
    const auto between = [](float before, float after, float bias) {
        return curveOf({{0.0, before, kAuto, 0.0F, -bias}, {1.0, 0.0F, kAuto, bias, 0.0F}, {2.0, after}});
    };
    expectSlope(between(0.0F, 0.0F, 500.0F), 1, 0.0);
    expectSlope(between(0.0F, 0.0F, 800.0F), 1, 360.0);
    expectSlope(between(0.0F, 0.0F, -800.0F), 1, -360.0);
    // the direction is that from the left chord to the right one
    EXPECT_LT(detail::rightSlope(between(-0.0001F, -0.0002F, 800.0F), 1), -359.0);
    EXPECT_GT(detail::rightSlope(between(-0.0001F, -0.0002F, -800.0F), 1), 359.0);
}

// Four tangents of a MotionBuilder file whose handles end at round values: -2.5, 1, 2 and, next to a peak, -1.
TEST(CurveTangents, PutTheHandlesOfAMotionBuilderFileWhereItsUserDraggedThem) {
    constexpr double kFrame = 1.0 / 24.0;
    const CurveKeys curve = curveOf({{0.0, 0.0F, kAuto, -570.711F, 0.0F},
                                     {6 * kFrame, 10.0F, kAuto, 0.0F, -578.443F},
                                     {12 * kFrame, 0.0F, kAuto, 578.443F, 0.0F},
                                     {18 * kFrame, -10.0F, kAuto, 0.0F, 589.443F},
                                     {24 * kFrame, 0.0F, kAuto, -589.443F, 8.33333F},
                                     {30 * kFrame, 10.0F, kAuto, -8.33333F, 0.0F},
                                     {36 * kFrame, -10.0F}});
    const auto handle = [&](std::size_t key, double weight) {
        return detail::rightSlope(curve, key) * weight * 6 * kFrame;
    };
    constexpr double kHandleTolerance = 2.0e-3; // of weights in units of 1/9999
    EXPECT_NEAR(handle(0, 0.4), 2.0, kHandleTolerance);
    EXPECT_NEAR(handle(2, 0.65), -2.5, kHandleTolerance);
    EXPECT_NEAR(handle(4, 0.5), 1.0, kHandleTolerance);
    EXPECT_NEAR(handle(5, 0.266627), -1.0, kHandleTolerance);
    for (const std::size_t smooth : {2U, 4U, 5U})
        EXPECT_NEAR(detail::leftSlope(curve, smooth), detail::rightSlope(curve, smooth), 1.0e-3) << smooth;
}

TEST(CurveTangents, HaveNoBiasWhenIndependentOfTime) {
    // Maya stores the slope itself there, MotionBuilder the shift that the flag represents
    const CurveKeys curve =
        curveOf({{0.0, 0.0F, kSpline, 0.0F, 61.7143F}, {1.0, 45.0F, kSpline}, {3.0, 90.0F, kSpline}});
    expectSlope(curve, 1, 30.0);
}

TEST(CurveTangents, AreFlatWhenClampedWhateverTheBias) {
    const CurveKeys curve =
        curveOf({{0.0, 0.0F, kClamped, 0.0F, 2000.0F}, {1.0, 0.0F, kClamped, 2000.0F}, {2.0, 0.0F}});
    expectSlope(curve, 1, 0.0);
}

TEST(CurveTangents, TakeTheirOwnKeysModeOnTheLeftToo) {
    const CurveKeys autoThenUser = curveOf({{0.0, 0.0F, kAuto, 0.0F, 7.0F}, {1.0, 10.0F, kUser, 1.0F}, {2.0, 0.0F}});
    EXPECT_EQ(detail::leftSlope(autoThenUser, 1), 7.0);
    const CurveKeys userThenAuto = curveOf({{0.0, 0.0F, kUser, 0.0F, 0.0F}, {1.0, 10.0F, kAuto}, {2.0, 14.0F}});
    EXPECT_NEAR(detail::leftSlope(userThenAuto, 1), 7.0, kTolerance);
}

TEST(CurveTangents, AreStoredOnesAtAConstantKey) {
    // the bit of auto tangents means "next" there
    const std::uint32_t next = KeyFlag::constant | KeyFlag::constantNext;
    const CurveKeys curve = curveOf({{0.0, 0.0F, kUser, 0.0F, 2.5F}, {1.0, 10.0F, next}, {2.0, 0.0F}});
    EXPECT_EQ(detail::leftSlope(curve, 1), 2.5);
    EXPECT_EQ(detail::rightSlope(curve, 1), 0.0);
}

TEST(CurveTangents, AreChordsOnLinearSegments) {
    const CurveKeys curve = curveOf({{0.0, 0.0F, kLinear}, {1.0, 10.0F, kLinear}, {3.0, 14.0F, kLinear}});
    EXPECT_NEAR(detail::rightSlope(curve, 0), 10.0, kTolerance);
    EXPECT_NEAR(detail::leftSlope(curve, 1), 10.0, kTolerance);
    EXPECT_NEAR(detail::rightSlope(curve, 1), 2.0, kTolerance);
    EXPECT_EQ(detail::rightSlope(curve, 2), 0.0);
}

TEST(CurveTangents, AreThoseOfKochanekAndBartels) {
    const auto tcb = [](float tension, float continuity, float bias) {
        return curveOf({{0.0, 0.0F, kTcb}, {1.0, 10.0F, kTcb, tension, continuity, bias}, {3.0, 14.0F, kTcb}});
    };
    expectSlope(tcb(0.0F, 0.0F, 0.0F), 1, 6.0);
    expectSlope(tcb(1.0F, 0.0F, 0.0F), 1, 0.0);
    expectSlope(tcb(-1.0F, 0.0F, 0.0F), 1, 12.0);
    expectSlope(tcb(0.0F, 0.0F, 1.0F), 1, 10.0);
    expectSlope(tcb(0.0F, 0.0F, -1.0F), 1, 2.0);
    EXPECT_NEAR(detail::leftSlope(tcb(0.0F, -1.0F, 0.0F), 1), 10.0, kTolerance);
    EXPECT_NEAR(detail::rightSlope(tcb(0.0F, -1.0F, 0.0F), 1), 2.0, kTolerance);
}

TEST(CurveTangents, TakeTheOnlyChordInFullAtTheEndsOfTcbCurves) {
    const CurveKeys curve = curveOf({{0.0, 0.0F, kTcb, 0.0F, 0.0F, 0.0F}, {1.0, 10.0F, kTcb, 0.0F, 0.0F, 0.0F}});
    EXPECT_NEAR(detail::rightSlope(curve, 0), 10.0, kTolerance);
    EXPECT_NEAR(detail::leftSlope(curve, 1), 10.0, kTolerance);
}

TEST(CurveTangents, DoNotTakeTheContinuityOfATcbKeyForASlope) {
    const CurveKeys user = curveOf({{0.0, 0.0F, kTcb, 0.0F, 0.5F, 0.5F}, {1.0, 10.0F, kUser, 3.0F}, {2.0, 0.0F}});
    EXPECT_EQ(detail::leftSlope(user, 1), 3.0);
}

TEST(CurveTangents, AreNeverInfiniteOrNoNumber) {
    for (const float odd : {HUGE_VALF, -HUGE_VALF, std::nanf("")}) {
        for (const std::uint32_t flags : {kUser, kAuto, kTcb, kProgressive, kClamped}) {
            const CurveKeys curve = curveOf(
                {{0.0, 0.0F, flags, odd, odd, odd, odd}, {1.0, 1.0F, flags, odd, odd, odd, odd}, {1.0, 2.0F, flags}});
            for (std::size_t key = 0; key < 3; ++key) {
                EXPECT_TRUE(std::isfinite(detail::leftSlope(curve, key)));
                EXPECT_TRUE(std::isfinite(detail::rightSlope(curve, key)));
            }
        }
    }
}

// every mode next to every other one: which number is a slope depends on the key it belongs to
TEST(MultiplyValues, MultipliesTheCurveAtEveryTime) {
    const std::uint32_t modes[] = {kUser, kAuto, kSpline, kClamped, kProgressive, kTcb, kLinear, KeyFlag::constant};
    std::vector<Key> keys;
    float value = 1.0F;
    for (const std::uint32_t first : modes) {
        for (const std::uint32_t second : modes) {
            for (const std::uint32_t flags : {first, second}) {
                value = -value + 0.5F;
                keys.push_back({0.5 * static_cast<double>(keys.size()), value, flags, 0.3F, -0.8F, 0.2F});
            }
        }
    }
    keys[2].flags = kAuto;
    keys[2].data0 = 700.0F;
    keys[1].data1 = -900.0F;
    const CurveKeys original = curveOf(keys);

    for (const float factor : {-1.0F, 100.0F, 0.01F}) {
        CurveKeys multiplied = original;
        detail::multiplyValues(multiplied, factor);
        for (double seconds = 0.0; seconds < 64.0; seconds += 0.07) {
            const std::int64_t ticks = std::llround(seconds * 46186158000.0);
            const float expected = detail::evaluate(original, ticks) * factor;
            ASSERT_NEAR(detail::evaluate(multiplied, ticks), expected, 1.0e-4F * std::abs(factor)) << seconds;
        }
    }
}

TEST(MultiplyValues, KeepsSharedAttributesShared) {
    CurveKeys curve = curveOf({{0.0, 1.0F, kLinear}, {1.0, 2.0F, kLinear}, {2.0, 3.0F, kLinear}});
    curve.defaultValue = 4.0F;
    detail::multiplyValues(curve, 2.0F);
    EXPECT_EQ(curve.attributes.size(), 1U);
    EXPECT_EQ(curve.values, (std::vector<float>{2.0F, 4.0F, 6.0F}));
    EXPECT_EQ(curve.defaultValue, 8.0F);
    CurveKeys empty;
    detail::multiplyValues(empty, 2.0F);
    EXPECT_EQ(empty.keyCount(), 0U);
}

} // namespace
