// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves as objects: operations on keys, default values, extrapolation as set and got. The arithmetic of evaluation is
// tested with CurveEvaluation.
#include <climits>
#include <cmath>
#include <cstdint>
#include <random>
#include <vector>

#include <fbxsdk/extensions/CurveSamples.h>

#include "AnimationFixture.h"

namespace {

using namespace fbxsdk;
using Def = FbxAnimCurveDef;

class FbxAnimCurveTest : public AnimationFixture {
protected:
    FbxAnimCurve* curve = FbxAnimCurve::Create(scene, "curve");

    std::vector<std::int64_t> times() const {
        std::vector<std::int64_t> ticks;
        for (int i = 0; i < curve->KeyGetCount(); ++i)
            ticks.push_back(curve->KeyGetTime(i).Get());
        return ticks;
    }
    std::vector<float> values() const {
        std::vector<float> list;
        for (int i = 0; i < curve->KeyGetCount(); ++i)
            list.push_back(curve->KeyGetValue(i));
        return list;
    }
    /// A linear key at that many ticks.
    int key(std::int64_t ticks, float value) {
        const int index = curve->KeyAdd(FbxTime(ticks));
        curve->KeySet(index, FbxTime(ticks), value, Def::eInterpolationLinear);
        return index;
    }
};

using Ticks = std::vector<std::int64_t>;
using Values = std::vector<float>;

TEST_F(FbxAnimCurveTest, StartsWithoutKeys) {
    FbxTimeSpan span(FbxTime(1), FbxTime(2));

    EXPECT_EQ(curve->KeyGetCount(), 0);
    EXPECT_EQ(curve->Evaluate(seconds(1)), 0.0F);
    EXPECT_EQ(curve->EvaluateIndex(3.0), 0.0F);
    EXPECT_FALSE(curve->GetTimeInterval(span));
    EXPECT_EQ(span.GetStart(), FbxTime(1));
    EXPECT_EQ(curve->GetScene(), scene);
}

TEST_F(FbxAnimCurveTest, KeepsItsKeysInOrderOfTime) {
    EXPECT_EQ(key(10, 1), 0);
    EXPECT_EQ(key(30, 3), 1);
    EXPECT_EQ(key(20, 2), 1);
    EXPECT_EQ(key(-5, 0), 0);

    EXPECT_EQ(times(), (Ticks{-5, 10, 20, 30}));
    EXPECT_EQ(values(), (Values{0, 1, 2, 3}));
}

TEST_F(FbxAnimCurveTest, HasOneKeyPerTime) {
    key(10, 1);
    int last = -1;

    EXPECT_EQ(curve->KeyAdd(FbxTime(10), &last), 0);
    EXPECT_EQ(last, 0);
    EXPECT_EQ(curve->KeyAdd(FbxTime(11), &last), 1); // exact on ticks
    EXPECT_EQ(last, 1);
    EXPECT_EQ(curve->KeyGetCount(), 2);
    EXPECT_EQ(curve->KeyGetValue(0), 1.0F);
}

TEST_F(FbxAnimCurveTest, HasTheSameKeysWhenManyAreAddedTogether) {
    std::mt19937 random(3);
    for (int round = 0; round < 50; ++round) {
        std::vector<FbxTime> keyTimes;
        std::vector<float> keyValues;
        std::int64_t ticks = 0;
        for (int i = 0; i < 40; ++i) {
            ticks += static_cast<int>(random() % 12) - (round % 3); // now and then at the same time, or back
            keyTimes.emplace_back(ticks);
            keyValues.push_back(static_cast<float>(random() % 100));
        }
        FbxAnimCurve* other = FbxAnimCurve::Create(scene, "other");
        for (FbxAnimCurve* each : {curve, other}) {
            each->KeyClear();
            each->KeySet(each->KeyAdd(FbxTime(25)), FbxTime(25), 7.0F, Def::eInterpolationCubic, Def::eTangentUser,
                         3.0F);
        }
        for (std::size_t i = 0; i < keyTimes.size(); ++i)
            key(keyTimes[i].Get(), keyValues[i]);

        extensions::addLinearKeys(*other, keyTimes.data(), keyValues.data(), 40);

        ASSERT_EQ(other->KeyGetCount(), curve->KeyGetCount());
        for (int i = 0; i < curve->KeyGetCount(); ++i) {
            EXPECT_EQ(other->KeyGetTime(i), curve->KeyGetTime(i));
            EXPECT_EQ(other->KeyGetValue(i), curve->KeyGetValue(i));
            EXPECT_EQ(other->KeyGetInterpolation(i), curve->KeyGetInterpolation(i));
            EXPECT_EQ(other->KeyGetTangentMode(i), curve->KeyGetTangentMode(i));
        }
    }
    extensions::addLinearKeys(*curve, nullptr, nullptr, 0);
}

TEST_F(FbxAnimCurveTest, AddsAKeyWithNothingButItsTime) {
    curve->KeyAdd(FbxTime(10));

    EXPECT_EQ(curve->KeyGetValue(0), 0.0F);
    EXPECT_EQ(curve->KeyGetInterpolation(0), Def::eInterpolationCubic);
    EXPECT_EQ(curve->KeyGetTangentMode(0), Def::eTangentAuto);
    EXPECT_EQ(curve->KeyGetData(0, Def::eRightSlope), 0.0F);
    EXPECT_EQ(curve->KeyGetData(0, Def::eRightWeight), Def::sDEFAULT_WEIGHT);
}

TEST_F(FbxAnimCurveTest, SetsEverythingOfAKey) {
    curve->KeyAdd(FbxTime(10));

    curve->KeySet(0, FbxTime(10), 4.5F, Def::eInterpolationCubic, Def::eTangentUser, 1.0F, 2.0F, Def::eWeightedAll,
                  0.25F, 0.75F, 0.5F, 0.625F);

    EXPECT_EQ(curve->KeyGetValue(0), 4.5F);
    EXPECT_EQ(curve->KeyGetInterpolation(0), Def::eInterpolationCubic);
    EXPECT_EQ(curve->KeyGetTangentMode(0), Def::eTangentUser);
    EXPECT_EQ(curve->KeyGetData(0, Def::eRightSlope), 1.0F);
    EXPECT_EQ(curve->KeyGetData(0, Def::eNextLeftSlope), 2.0F);
    EXPECT_EQ(curve->KeyGetData(0, Def::eRightWeight), 0.25F);
    EXPECT_EQ(curve->KeyGetData(0, Def::eNextLeftWeight), 0.75F);
    EXPECT_EQ(curve->KeyGetData(0, Def::eRightVelocity), 0.5F);
    EXPECT_EQ(curve->KeyGetData(0, Def::eNextLeftVelocity), 0.625F);
}

TEST_F(FbxAnimCurveTest, MovesAKeyWhoseTimeIsSet) {
    key(10, 1);
    key(20, 2);
    key(30, 3);

    curve->KeySet(0, FbxTime(25), 9, Def::eInterpolationConstant);

    EXPECT_EQ(times(), (Ticks{20, 25, 30}));
    EXPECT_EQ(values(), (Values{2, 9, 3}));
    EXPECT_EQ(curve->KeyGetInterpolation(1), Def::eInterpolationConstant);
    EXPECT_EQ(curve->KeyGetInterpolation(0), Def::eInterpolationLinear);

    curve->KeySetTime(2, FbxTime(-1));
    EXPECT_EQ(times(), (Ticks{-1, 20, 25}));
    EXPECT_EQ(values(), (Values{3, 2, 9}));
}

TEST_F(FbxAnimCurveTest, ReplacesTheKeyAtTheTimeToWhichAnotherIsMoved) {
    key(10, 1);
    key(20, 2);

    curve->KeySetTime(0, FbxTime(20));

    EXPECT_EQ(times(), (Ticks{20}));
    EXPECT_EQ(values(), (Values{1}));
}

TEST_F(FbxAnimCurveTest, IgnoresKeysThatAreNotThere) {
    key(10, 1);
    for (const int index : {-1, 1, INT_MIN, INT_MAX}) {
        curve->KeySet(index, FbxTime(99), 9);
        curve->KeySetTime(index, FbxTime(99));
        curve->KeySetValue(index, 9);
        curve->KeySetInterpolation(index, Def::eInterpolationCubic);
        curve->KeySetTangentMode(index, Def::eTangentUser);
        curve->KeySetConstantMode(index, Def::eConstantNext);
        curve->KeySetData(index, Def::eRightSlope, 9);
        EXPECT_FALSE(curve->KeyRemove(index)) << index;
        EXPECT_EQ(curve->KeyGetTime(index), FbxTime(0)) << index;
        EXPECT_EQ(curve->KeyGetValue(index), 0.0F) << index;
        EXPECT_EQ(curve->KeyGetData(index, Def::eRightSlope), 0.0F) << index;
    }
    EXPECT_EQ(times(), (Ticks{10}));
    EXPECT_EQ(values(), (Values{1}));
}

TEST_F(FbxAnimCurveTest, ChangesOneAttributeOfOneKeyOnly) {
    key(10, 1);
    key(20, 2); // shares its attributes with the first

    curve->KeySetInterpolation(1, Def::eInterpolationCubic);
    curve->KeySetTangentMode(1, Def::eTangentUser);
    curve->KeySetData(1, Def::eNextLeftWeight, 0.5F);

    EXPECT_EQ(curve->KeyGetInterpolation(0), Def::eInterpolationLinear);
    EXPECT_EQ(curve->KeyGetTangentMode(0), Def::eTangentAuto);
    EXPECT_EQ(curve->KeyGetData(0, Def::eNextLeftWeight), Def::sDEFAULT_WEIGHT);
    EXPECT_EQ(curve->KeyGetInterpolation(1), Def::eInterpolationCubic);
    EXPECT_EQ(curve->KeyGetTangentMode(1), Def::eTangentUser);
    EXPECT_EQ(curve->KeyGetData(1, Def::eNextLeftWeight), 0.5F);
}

TEST_F(FbxAnimCurveTest, HoldsTheNextValueInTheConstantModeThatSaysSo) {
    key(0, 1);
    key(100, 2);
    curve->KeySetInterpolation(0, Def::eInterpolationConstant);

    EXPECT_EQ(curve->Evaluate(FbxTime(50)), 1.0F);
    curve->KeySetConstantMode(0, Def::eConstantNext);
    EXPECT_EQ(curve->Evaluate(FbxTime(50)), 2.0F);
}

TEST_F(FbxAnimCurveTest, HoldsItsOwnValueWhenKeyedConstant) {
    for (int i = 0; i < 2; ++i)
        curve->KeySet(curve->KeyAdd(FbxTime(i * 100)), FbxTime(i * 100), 1.0F + static_cast<float>(i),
                      Def::eInterpolationConstant); // the tangent mode is the default one

    EXPECT_EQ(curve->Evaluate(FbxTime(50)), 1.0F);
    EXPECT_EQ(curve->KeyGetConstantMode(0), Def::eConstantStandard);
}

TEST_F(FbxAnimCurveTest, HasTangentsOrAConstantModeButNotBoth) {
    key(0, 1);
    curve->KeySetTangentMode(0, Def::eTangentUser);
    curve->KeySetConstantMode(0, Def::eConstantNext); // of no meaning for a linear key
    EXPECT_EQ(curve->KeyGetTangentMode(0), Def::eTangentUser);
    EXPECT_EQ(curve->KeyGetConstantMode(0), Def::eConstantStandard);

    curve->KeySetInterpolation(0, Def::eInterpolationConstant);
    EXPECT_EQ(curve->KeyGetConstantMode(0), Def::eConstantStandard);
    curve->KeySetConstantMode(0, Def::eConstantNext);
    curve->KeySetTangentMode(0, Def::eTangentUser);
    EXPECT_EQ(curve->KeyGetConstantMode(0), Def::eConstantNext);
    EXPECT_EQ(curve->KeyGetTangentMode(0), Def::eTangentAuto);

    curve->KeySetInterpolation(0, Def::eInterpolationCubic);
    EXPECT_EQ(curve->KeyGetTangentMode(0), Def::eTangentAuto);
}

TEST_F(FbxAnimCurveTest, LosesOneKeyOrAll) {
    key(10, 1);
    key(20, 2);
    key(30, 3);

    EXPECT_TRUE(curve->KeyRemove(1));
    EXPECT_EQ(times(), (Ticks{10, 30}));
    curve->KeyClear();
    EXPECT_EQ(curve->KeyGetCount(), 0);
    key(5, 7);
    EXPECT_EQ(curve->Evaluate(FbxTime(0)), 7.0F);
}

TEST_F(FbxAnimCurveTest, MayBeEditedWithOrWithoutBrackets) {
    curve->KeyModifyBegin();
    curve->KeyModifyEnd();
    EXPECT_EQ(curve->KeyGetCount(), 0);

    curve->KeyModifyBegin();
    key(10, 1);
    curve->KeyModifyEnd();
    key(20, 2);
    EXPECT_EQ(curve->KeyGetCount(), 2);
}

TEST_F(FbxAnimCurveTest, SpansFromTheFirstKeyToTheLast) {
    key(30, 0);
    FbxTimeSpan span;

    EXPECT_TRUE(curve->GetTimeInterval(span));
    EXPECT_EQ(span.GetStart(), FbxTime(30));
    EXPECT_EQ(span.GetStop(), FbxTime(30));
    key(-30, 0);
    EXPECT_TRUE(curve->GetTimeInterval(span));
    EXPECT_EQ(span.GetStart(), FbxTime(-30));
    EXPECT_EQ(span.GetStop(), FbxTime(30));
}

TEST_F(FbxAnimCurveTest, EvaluatesAgainAfterEveryChange) {
    key(0, 0);
    key(10, 10);
    for (int i = 0; i < 2; ++i)
        curve->KeySetInterpolation(i, FbxAnimCurveDef::eInterpolationCubic);
    const float before = curve->Evaluate(FbxTime(5));
    EXPECT_EQ(curve->Evaluate(FbxTime(5)), before);

    curve->KeySetValue(1, 30);
    EXPECT_EQ(curve->Evaluate(FbxTime(5)), 3 * before);
    curve->KeyMultValue(2);
    EXPECT_EQ(curve->Evaluate(FbxTime(5)), 6 * before);
    curve->KeySetInterpolation(0, FbxAnimCurveDef::eInterpolationConstant);
    EXPECT_EQ(curve->Evaluate(FbxTime(5)), 0);
}

TEST_F(FbxAnimCurveTest, EvaluatesTheSameWithAnyHint) {
    for (int i = 0; i < 10; ++i)
        key(i * 10, static_cast<float>(i));
    for (int wrong : {-7, 0, 3, 9, 10, INT_MAX}) {
        EXPECT_EQ(curve->Evaluate(FbxTime(45), &wrong), 4.5F);
        EXPECT_EQ(wrong, 4);
    }
}

TEST_F(FbxAnimCurveTest, EvaluatesBetweenKeysByIndex) {
    key(0, 10);
    key(100, 20);
    key(1000, 40);

    EXPECT_EQ(curve->EvaluateIndex(0.0), 10.0F);
    EXPECT_EQ(curve->EvaluateIndex(0.5), 15.0F);
    EXPECT_EQ(curve->EvaluateIndex(1.0), 20.0F);
    EXPECT_EQ(curve->EvaluateIndex(1.5), 30.0F);
    EXPECT_EQ(curve->EvaluateIndex(2.0), 40.0F);
    for (const double before : {-1.0, -1e300, static_cast<double>(NAN)})
        EXPECT_EQ(curve->EvaluateIndex(before), 10.0F);
    for (const double after : {2.5, 1e300, static_cast<double>(INFINITY)})
        EXPECT_EQ(curve->EvaluateIndex(after), 40.0F);
}

TEST_F(FbxAnimCurveTest, EvaluatesByIndexOverTheWholeRangeOfTime) {
    key(INT64_MIN, 0);
    key(INT64_MAX, 1);

    EXPECT_NEAR(curve->EvaluateIndex(0.5), 0.5F, 1e-6F);
    EXPECT_NEAR(curve->EvaluateIndex(0.999), 0.999F, 1e-6F);
}

// Extrapolation as a setting.

TEST_F(FbxAnimCurveTest, IsHeldConstantOutsideByDefault) {
    EXPECT_EQ(curve->GetPreExtrapolation(), FbxAnimCurveBase::eConstant);
    EXPECT_EQ(curve->GetPostExtrapolation(), FbxAnimCurveBase::eConstant);
    key(0, 1);
    key(10, 2);
    EXPECT_EQ(curve->Evaluate(FbxTime(-100)), 1.0F);
    EXPECT_EQ(curve->Evaluate(FbxTime(100)), 2.0F);
}

TEST_F(FbxAnimCurveTest, KeepsTheExtrapolationsOfBothSidesApart) {
    curve->SetPreExtrapolation(FbxAnimCurveBase::eMirrorRepetition);
    curve->SetPostExtrapolation(FbxAnimCurveBase::eKeepSlope);
    curve->SetPreExtrapolationCount(3);
    curve->SetPostExtrapolationCount(0);

    EXPECT_EQ(curve->GetPreExtrapolation(), FbxAnimCurveBase::eMirrorRepetition);
    EXPECT_EQ(curve->GetPostExtrapolation(), FbxAnimCurveBase::eKeepSlope);
    EXPECT_EQ(curve->GetPreExtrapolationCount(), 3UL);
    EXPECT_EQ(curve->GetPostExtrapolationCount(), 0UL);
}

TEST_F(FbxAnimCurveTest, RepeatsWithoutEndWhenTheCountIsZero) {
    key(0, 0);
    key(100, 10);
    curve->SetPostExtrapolation(FbxAnimCurveBase::eRepetition);
    curve->SetPreExtrapolation(FbxAnimCurveBase::eMirrorRepetition);
    for (const unsigned long count : {0UL, ULONG_MAX}) {
        curve->SetPostExtrapolationCount(count);
        curve->SetPreExtrapolationCount(count);
        EXPECT_FLOAT_EQ(curve->Evaluate(FbxTime(1'000'030)), 3.0F) << count;
        EXPECT_FLOAT_EQ(curve->Evaluate(FbxTime(-30)), 3.0F) << count;
    }
    curve->SetPostExtrapolationCount(2);
    EXPECT_FLOAT_EQ(curve->Evaluate(FbxTime(130)), 3.0F);
    EXPECT_FLOAT_EQ(curve->Evaluate(FbxTime(1'000'030)), 10.0F);
}

TEST_F(FbxAnimCurveTest, KeepsItsSlopeOrItsRise) {
    key(0, 0);
    key(100, 10);
    curve->SetPostExtrapolation(FbxAnimCurveBase::eKeepSlope);
    EXPECT_FLOAT_EQ(curve->Evaluate(FbxTime(250)), 25.0F);
    curve->SetPostExtrapolation(FbxAnimCurveBase::eRelativeRepetition);
    EXPECT_FLOAT_EQ(curve->Evaluate(FbxTime(250)), 25.0F);
}

// Default values.

TEST_F(FbxAnimCurveTest, SetsTheDefaultOfTheChannelItDrives) {
    FbxAnimCurveNode* drives = set(node->LclTranslation, layer, 1, 2, 3);
    FbxAnimCurve* y = drives->CreateCurve("", 1U);

    EXPECT_EQ(y->GetValue(), 2.0F);
    y->SetValue(7.0F);
    EXPECT_EQ(drives->GetChannelValue(1U, 0.0), 7.0);
    EXPECT_EQ(drives->GetChannelValue(0U, 0.0), 1.0);
    EXPECT_EQ(y->Evaluate(seconds(3)), 7.0F);
    EXPECT_EQ(y->KeyGetCount(), 0);
}

TEST_F(FbxAnimCurveTest, KnowsTheChannelOfEachCurveNodeItDrives) {
    FbxNode* other = FbxNode::Create(scene, "other");
    FbxAnimCurveNode* first = set(node->LclTranslation, layer, 1, 2, 3);
    FbxAnimCurveNode* second = set(other->LclScaling, layer, 4, 5, 6);
    first->ConnectToChannel(curve, "X");
    second->ConnectToChannel(curve, "Z");

    EXPECT_EQ(curve->GetValue(0), 1.0F);
    EXPECT_EQ(curve->GetValue(1), 6.0F);
    curve->SetValue(9.0F, 1);
    EXPECT_EQ(second->GetChannelValue(2U, 0.0), 9.0);
    EXPECT_EQ(first->GetChannelValue(0U, 0.0), 1.0);
}

TEST_F(FbxAnimCurveTest, KeepsADefaultOfItsOwnWhenItDrivesNothing) {
    curve->SetValue(5.0F);

    EXPECT_EQ(curve->GetValue(), 5.0F);
    EXPECT_EQ(curve->GetValue(17), 5.0F);
    EXPECT_EQ(curve->GetValue(-1), 5.0F);
    EXPECT_EQ(curve->Evaluate(seconds(1)), 5.0F);
}

TEST_F(FbxAnimCurveTest, LeavesKeysAloneWhenItsDefaultIsSet) {
    key(10, 1);

    curve->SetValue(5.0F);

    EXPECT_EQ(values(), (Values{1}));
    EXPECT_EQ(curve->Evaluate(FbxTime(10)), 1.0F);
}

TEST_F(FbxAnimCurveTest, MultipliesValuesAndTheDefault) {
    key(10, 2);
    key(20, -3);

    curve->KeyMultValue(-2.0F);

    EXPECT_EQ(values(), (Values{-4, 6}));
}

TEST_F(FbxAnimCurveTest, HoldsATenthOfAMillionKeysAddedBackwards) {
    for (int i = 100'000; i > 0; --i)
        curve->KeyAdd(FbxTime(i));

    EXPECT_EQ(curve->KeyGetCount(), 100'000);
    EXPECT_EQ(curve->KeyGetTime(0), FbxTime(1));
    EXPECT_EQ(curve->KeyGetTime(99'999), FbxTime(100'000));
}

} // namespace
