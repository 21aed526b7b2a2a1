// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Sampling: which frames an animated property is sampled over, and the samples.
#include "sdk/SampleRange.h"

#include "TnFbxError.h"

#include "support/MemoryLimitScope.h"
#include "support/SceneBuilders.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <limits>
#include <string>
#include <utility>

namespace Tarnell::Fbx {
namespace {

using test::TestScene;
using test::timeOfFrame;
using Transform = TnFbxTransform;
using Samples = std::vector<float>;

constexpr int kHighest = std::numeric_limits<int>::max();
constexpr int kLowest = std::numeric_limits<int>::min();

TnFbxTime timeRecord(int startFrame, int endFrame) {
    TnFbxTime time;
    time.setTime(0.0f, startFrame, endFrame, 24.0f);
    return time;
}

/// The local transform of a node, sampled over the stack's range or the one given.
Transform localTransform(TestScene& scene, fbxsdk::FbxNode* node, TnFbxTime time, bool useSampleRate = false,
                         float sampleRate = 0.0f) {
    Transform transform;
    EXPECT_TRUE(scene.sdk.setTransformValues(node, time, useSampleRate, sampleRate, &transform));
    return transform;
}

TEST(SampleRange, SubtractsWithWrapAround) {
    EXPECT_EQ(detail::wrappingSubtract(10, 3), 7);
    EXPECT_EQ(detail::wrappingSubtract(kLowest, kHighest), 1);
    EXPECT_EQ(detail::wrappingSubtract(kHighest, kLowest), -1);
    EXPECT_EQ(detail::wrappingSubtract(0, kLowest), kLowest);
}

TEST(SampleRange, NarrowsFramesToTheirLow32Bits) {
    EXPECT_EQ(detail::narrowFrame(-5), -5);
    EXPECT_EQ(detail::narrowFrame(std::int64_t{1} << 32), 0);
    EXPECT_EQ(detail::narrowFrame(std::int64_t{1} << 31), kLowest);
}

TEST(SampleRange, ConvertsFramesByDividingFirstAndTruncatesTowardZero) {
    EXPECT_EQ(detail::convertFrame(10, 24.0f, 48.0f), 20);
    EXPECT_EQ(detail::convertFrame(1, 24.0f, 25.0f), 1);
    EXPECT_EQ(detail::convertFrame(7, 24.0f, 25.0f), 7);
    EXPECT_EQ(detail::convertFrame(-7, 24.0f, 25.0f), -7);
    EXPECT_EQ(detail::convertFrame(kHighest, 24.0f, 48.0f), kHighest);
    EXPECT_EQ(detail::convertFrame(1, 24.0f, std::numeric_limits<float>::infinity()), kHighest);
    EXPECT_EQ(detail::convertFrame(0, 24.0f, std::numeric_limits<float>::infinity()), kLowest);
}

TEST(SampleRange, RoundsToSinglePrecisionAfterEveryStepOfTheConversion) {
    EXPECT_EQ(detail::convertFrame(63, 30.0f, 60.0f), 125);  // 126 in double precision or multiplied first
    EXPECT_EQ(detail::convertFrame(123, 30.0f, 60.0f), 246); // 245 in double precision
    EXPECT_EQ(detail::convertFrame(120, 24.0f, 25.0f), 125); // 124 times the quotient of the rates
    EXPECT_EQ(detail::convertFrame(50, 24.0f, 60.0f), 124);  // 125 in double precision or multiplied first
}

TEST(SampleRange, UntouchedCountsAsAnAnimationWithoutFrames) {
    const detail::SampleRange range;

    EXPECT_TRUE(range.isAnimation());
    EXPECT_EQ(range.first, 2147483647);
    EXPECT_EQ(range.last, -2147483647 - 1);
}

TEST(SampleRange, UntouchedReachesBackwardsOverAllFramesAtNoRate) {
    test::expectRange(detail::sampledTime(detail::SampleRange(), 24.0f), 2147483647, -2147483647 - 1, 0.0f);
}

TEST(SampleRange, WithFramesHasTheRateOfTheScene) {
    detail::SampleRange range;
    range.include(-3, 7);
    const TnFbxTime time = detail::sampledTime(range, 24.0f);
    test::expectRange(time, -3, 7, 24.0f);
    EXPECT_EQ(time.getFrame(), 0.0f);
}

TEST(SampleRange, OfOneFrameIsNoAnimation) {
    detail::SampleRange range;
    range.include(5, 5);
    EXPECT_FALSE(range.isAnimation());
    range.include(4, 4);
    EXPECT_TRUE(range.isAnimation());
    EXPECT_EQ(range.first, 4);
    EXPECT_EQ(range.last, 5);
}

TEST(SampleRange, OfHalfTheIntegersIsNoAnimation) {
    detail::SampleRange range;
    range.include(kLowest, 0);
    EXPECT_FALSE(range.isAnimation());
}

TEST(PropertySampling, KeepsTheStaticValueOfAPropertyWithoutCurves) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("still");
    node->LclTranslation.Set({1.5, -2.0, 3.25});

    const Transform transform = localTransform(scene, node, scene.time());

    EXPECT_FALSE(transform.getTransformAnimated(Transform::kFbxTransformPositionX));
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionX), 1.5f);
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionY), -2.0f);
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionZ), 3.25f);
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformScaleX), 1.0f);
}

TEST(PropertySampling, LeavesTheSamplesOfAnObjectAloneWhenThePropertyHasNone) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("still");
    Transform transform;
    transform.setTransformValueAt(Transform::kFbxTransformPositionX, timeRecord(3, 4), {7.0f, 8.0f});
    TnFbxTime time = scene.time();

    scene.sdk.setTransformValues(node, time, false, 0.0f, &transform);

    EXPECT_EQ(test::samplesOf(transform, Transform::kFbxTransformPositionX), Samples({7.0f, 8.0f}));
}

// A layer with a curve node, one component of which has a curve and none a key.
TEST(PropertySampling, TakesCurvesWithoutKeysForNone) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("still");
    node->LclTranslation.Set({1.5, -2.0, 3.25});
    auto* layer = scene.scene->GetCurrentAnimationStack()->GetMember<fbxsdk::FbxAnimLayer>(0);
    ASSERT_NE(node->LclTranslation.GetCurve(layer, "X", /*pCreate*/ true), nullptr);

    const Transform transform = localTransform(scene, node, scene.time());

    for (int i = 0; i < 3; ++i) {
        const auto channel = static_cast<Transform::EFbxTransformChannelType>(Transform::kFbxTransformPositionX + i);
        EXPECT_FALSE(transform.getTransformAnimated(channel));
        EXPECT_EQ(transform.getTransformValue(channel), static_cast<float>(node->LclTranslation.Get()[i]));
    }
}

TEST(PropertySampling, SamplesEveryFrameOfTheRequestedRangeWhenTheKeysLieInside) {
    TestScene scene(0, 6);
    fbxsdk::FbxNode* node = scene.addNode("moving");
    scene.key(node->LclTranslation, "X", {{2, 10.0f}, {4, 20.0f}});

    const Transform transform = localTransform(scene, node, scene.time());

    test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionX), 0, 6, 24.0f);
    EXPECT_EQ(test::samplesOf(transform, Transform::kFbxTransformPositionX),
              Samples({10.0f, 10.0f, 10.0f, 15.0f, 20.0f, 20.0f, 20.0f}));
    EXPECT_FALSE(transform.getTransformAnimated(Transform::kFbxTransformPositionY));
}

TEST(PropertySampling, ReachesToTheKeysBeyondTheRequestedRange) {
    TestScene scene(2, 3);
    fbxsdk::FbxNode* node = scene.addNode("moving");
    scene.key(node->LclTranslation, "Y", {{-1, -1.0f}, {4, 4.0f}});

    const Transform transform = localTransform(scene, node, scene.time());

    test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionY), -1, 4, 24.0f);
    EXPECT_EQ(test::samplesOf(transform, Transform::kFbxTransformPositionY),
              Samples({-1.0f, 0.0f, 1.0f, 2.0f, 3.0f, 4.0f}));
}

TEST(PropertySampling, TakesASingleFrameForNoAnimation) {
    TestScene scene(5, 5);
    fbxsdk::FbxNode* node = scene.addNode("posed");
    scene.key(node->LclTranslation, "X", {{5, 10.0f}});

    const Transform transform = localTransform(scene, node, scene.time());

    EXPECT_FALSE(transform.getTransformAnimated(Transform::kFbxTransformPositionX));
    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionX), 0.0f);
}

TEST(PropertySampling, TakesOneKeyInALongerRangeForAnAnimation) {
    TestScene scene(5, 7);
    fbxsdk::FbxNode* node = scene.addNode("posed");
    scene.key(node->LclTranslation, "X", {{5, 10.0f}});

    const Transform transform = localTransform(scene, node, scene.time());

    EXPECT_EQ(test::samplesOf(transform, Transform::kFbxTransformPositionX), Samples({10.0f, 10.0f, 10.0f}));
}

TEST(PropertySampling, AddsTheCurvesOfAllLayers) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = scene.addNode("layered");
    scene.key(node->LclTranslation, "X", {{0, 1.0f}, {2, 3.0f}});
    scene.key(node->LclTranslation, "X", {{0, 10.0f}, {4, 50.0f}}, scene.addLayer());

    const Transform transform = localTransform(scene, node, scene.time());

    test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionX), 0, 4, 24.0f);
    EXPECT_EQ(test::samplesOf(transform, Transform::kFbxTransformPositionX),
              Samples({11.0f, 22.0f, 33.0f, 43.0f, 53.0f}));
}

TEST(PropertySampling, AddsNothingForALayerWithoutACurve) {
    TestScene scene(0, 2);
    fbxsdk::FbxNode* node = scene.addNode("layered");
    node->LclTranslation.Set({100.0, 0.0, 0.0});
    scene.key(node->LclTranslation, "X", {{0, 10.0f}, {2, 50.0f}}, scene.addLayer());

    const Transform transform = localTransform(scene, node, scene.time());

    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionX), 100.0f);
    EXPECT_EQ(test::samplesOf(transform, Transform::kFbxTransformPositionX), Samples({10.0f, 30.0f, 50.0f}));
}

TEST(PropertySampling, SamplesAConvertedRangeAtTheRateOfTheScene) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("moving");
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {10, 10.0f}});

    const Transform transform = localTransform(scene, node, timeRecord(0, 0), true, 48.0f);

    test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionX), 0, 20, 24.0f);
    const Samples samples = test::samplesOf(transform, Transform::kFbxTransformPositionX);
    ASSERT_EQ(samples.size(), 21u);
    EXPECT_EQ(samples[5], 5.0f);
    EXPECT_EQ(samples[10], 10.0f);
    EXPECT_EQ(samples[20], 10.0f);
}

TEST(PropertySampling, ConvertsOnlyToARateAboveZero) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("moving");
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {10, 10.0f}});

    for (const float rate : {0.0f, -48.0f, std::numeric_limits<float>::quiet_NaN()}) {
        const Transform transform = localTransform(scene, node, timeRecord(0, 0), true, rate);
        test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionX), 0, 10, 24.0f);
    }
}

TEST(PropertySampling, NeverMakesACurve) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("still");

    localTransform(scene, node, scene.time());

    EXPECT_EQ(scene.scene->GetSrcObjectCount<fbxsdk::FbxAnimCurve>(), 0);
    EXPECT_EQ(scene.scene->GetSrcObjectCount<fbxsdk::FbxAnimCurveNode>(), 0);
}

TEST(PropertySampling, FailsWhereTheSamplesWouldTakeMoreThanTheLimit) {
    const support::MemoryLimitScope limit(1 << 20);
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("moving");
    node->LclTranslation.Set({3.0, 0.0, 0.0});
    scene.key(node->LclTranslation, "X", {{0, 0.0f}, {10, 10.0f}});

    for (const int last : {1 << 18, 2000000000, kHighest - 1}) {
        Transform transform;
        TnFbxTime time = timeRecord(0, last);
        EXPECT_FALSE(scene.sdk.setTransformValues(node, time, false, 0.0f, &transform));
        EXPECT_NE(lastError().find("frames 0 to " + std::to_string(last) + " at 24"), std::string::npos) << lastError();
        EXPECT_NE(lastError().find("the limit is 1.0 MiB"), std::string::npos) << lastError();
        EXPECT_FALSE(transform.getTransformAnimated(Transform::kFbxTransformPositionX));
        EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionX), 3.0f);
    }
    const Transform transform = localTransform(scene, node, timeRecord(0, (1 << 18) - 1)); // exactly the limit
    test::expectRange(transform.getTransformTime(Transform::kFbxTransformPositionX), 0, (1 << 18) - 1, 24.0f);
}

TEST(PropertySampling, TakesNoMemoryPerFrameForWhatDoesNotChange) {
    const support::MemoryLimitScope limit(1024);
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("still");
    scene.key(node->LclTranslation, "X", {{0, 2.0f}});
    scene.key(node->LclTranslation, "Y", {{0, 4.0f}, {10, 4.0f}});

    Transform transform = localTransform(scene, node, timeRecord(0, 2000000000));

    for (const auto& [channel, value] :
         {std::pair(Transform::kFbxTransformPositionX, 2.0f), std::pair(Transform::kFbxTransformPositionY, 4.0f)}) {
        test::expectRange(transform.getTransformTime(channel), 0, 2000000000, 24.0f);
        EXPECT_TRUE(transform.getTransformChannel(channel)->isConstant());
        EXPECT_EQ(transform.getTransformValueAt(channel, 1e9f), value);
    }
}

TEST(PropertySampling, GivesBackWhatTurnsOutNotToChange) {
    const support::MemoryLimitScope limit(4 * 1000); // two channels one after the other, not both
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("nearly still");
    const float large = 16777216.0f; // a change of less than one is none
    fbxsdk::FbxAnimCurve* curve = scene.key(node->LclTranslation, "X", {{0, large}, {10, large}});
    curve->KeySetInterpolation(0, fbxsdk::FbxAnimCurveDef::eInterpolationCubic);
    scene.key(node->LclTranslation, "Y", {{0, 0.0f}, {999, 1.0f}});

    Transform transform = localTransform(scene, node, timeRecord(0, 999));

    EXPECT_TRUE(transform.getTransformChannel(Transform::kFbxTransformPositionX)->isConstant());
    EXPECT_EQ(transform.getTransformValueAt(Transform::kFbxTransformPositionX, 500.0f), large);
    EXPECT_EQ(transform.getTransformValueAt(Transform::kFbxTransformPositionY, 999.0f), 1.0f);
}

TEST(PropertySampling, GivesTheBitsOfCurvesThatAreLevelAndOfThoseThatSeemSo) {
    TestScene scene(0, 10);
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const std::pair<float, float> ends[] = {{4.0f, 4.0f},  {0.0f, 0.0f}, {-0.0f, -0.0f},
                                            {0.0f, -0.0f}, {nan, nan},   {4.0f, 5.0f}};
    for (const auto& [first, last] : ends) {
        for (const auto interpolation :
             {fbxsdk::FbxAnimCurveDef::eInterpolationLinear, fbxsdk::FbxAnimCurveDef::eInterpolationConstant,
              fbxsdk::FbxAnimCurveDef::eInterpolationCubic}) {
            fbxsdk::FbxNode* node = scene.addNode("node");
            fbxsdk::FbxAnimCurve* curve = scene.key(node->LclTranslation, "X", {{0, first}, {10, last}});
            curve->KeySetInterpolation(0, interpolation);

            const Samples samples =
                test::samplesOf(localTransform(scene, node, scene.time()), Transform::kFbxTransformPositionX);

            ASSERT_EQ(samples.size(), 11u);
            for (int frame = 0; frame <= 10; ++frame) {
                const float expected = 0.0f + curve->Evaluate(timeOfFrame(frame));
                EXPECT_EQ(std::memcmp(&samples[static_cast<std::size_t>(frame)], &expected, sizeof expected), 0)
                    << first << " to " << last << ", " << interpolation << ", frame " << frame;
            }
        }
    }
}

TEST(PropertySampling, SurvivesKeysAtTheEndsOfTime) {
    TestScene scene(0, 10);
    fbxsdk::FbxNode* node = scene.addNode("moving");
    node->LclTranslation.Set({3.0, 0.0, 0.0});
    fbxsdk::FbxAnimCurve* curve = scene.key(node->LclTranslation, "X", {{0, 1.0f}});
    for (const fbxsdk::FbxTime time : {fbxsdk::FBXSDK_TIME_MINUS_INFINITE, fbxsdk::FBXSDK_TIME_INFINITE})
        curve->KeySet(curve->KeyAdd(time), time, 1.0f);

    const Transform transform = localTransform(scene, node, scene.time());

    EXPECT_EQ(transform.getTransformValue(Transform::kFbxTransformPositionX), 3.0f);
}

TEST(PropertySampling, SamplesNothingWithoutAStack) {
    FbxSdk sdk;
    ASSERT_TRUE(sdk.initFbxSdkManager());
    fbxsdk::FbxNode* node = fbxsdk::FbxNode::Create(sdk.getScene(), "node");
    Transform transform;
    TnFbxTime time = timeRecord(0, 10);

    EXPECT_TRUE(sdk.setTransformValues(node, time, false, 0.0f, &transform));

    EXPECT_FALSE(transform.getTransformAnimated(Transform::kFbxTransformPositionX));
}

TEST(PropertySampling, IgnoresANullNodeAndANullTransform) {
    TestScene scene(0, 10);
    TnFbxTime time = scene.time();
    Transform transform;

    EXPECT_TRUE(scene.sdk.setTransformValues(nullptr, time, false, 0.0f, &transform));
    EXPECT_TRUE(scene.sdk.setTransformValues(scene.addNode("node"), time, false, 0.0f, nullptr));
}

} // namespace
} // namespace Tarnell::Fbx
