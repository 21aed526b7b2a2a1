// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Rates, frames and the span of a shot are read back from files of every version, as ASCII and as binary.
#include "RoundTripFixture.h"
#include "support/FacadeReads.h"
#include "support/SceneBuilders.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Tarnell::Fbx {
namespace {

using namespace test;
using testing::ElementsAre;
using testing::Pointwise;

using TimeRoundTrip = test::RoundTripFixture;
INSTANTIATE_TEST_SUITE_P(EveryFile, TimeRoundTrip, test::everyVariant(), test::variantName);

TEST_P(TimeRoundTrip, OfAnimationAtEveryRateKeepsFramesAndValues) {
    for (const float rate : {23.976f, 24.0f, 25.0f, 30.0f, 48.0f, 50.0f, 60.0f, 100.0f, 120.0f, 1000.0f}) {
        TnFbxNull null;
        null.setName("null");
        Samples samples;
        for (int i = 0; i < 100; ++i)
            samples.push_back(static_cast<float>(i * i));
        null.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(0, samples.size(), rate), samples);
        WrittenObjects objects;
        objects.nulls = {&null};
        TnFbxWriteInfo options = info();
        options.setFPS(rate);
        write(objects, options);

        FacadeRead<TnFbxNull> nulls(file());
        EXPECT_EQ(nulls["null"].getTransformTime(Transform::kFbxTransformPositionX).getFrameRate(), rate);
        EXPECT_THAT(samplesOf(nulls["null"], Transform::kFbxTransformPositionX),
                    Pointwise(testing::FloatNear(0.05f), samples))
            << rate;
    }
}

TEST_P(TimeRoundTrip, SamplesEveryPropertyOverTheSpanOfAllKeys) {
    TnFbxNull early, late;
    early.setName("early");
    late.setName("late");
    early.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(1, 2), {1.0f, 2.0f});
    late.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(3, 2), {3.0f, 4.0f});
    WrittenObjects objects;
    objects.nulls = {&early, &late};
    write(objects);

    FacadeRead<TnFbxNull> nulls(file());
    EXPECT_THAT(samplesOf(nulls["early"], Transform::kFbxTransformPositionX), ElementsAre(1.0f, 2.0f, 2.0f, 2.0f));
    EXPECT_THAT(samplesOf(nulls["late"], Transform::kFbxTransformPositionX), ElementsAre(3.0f, 3.0f, 3.0f, 4.0f));
    test::expectRange(nulls["late"].getTransformTime(Transform::kFbxTransformPositionX), 1, 4, 24.0f);
}

TEST_P(TimeRoundTrip, OfFramesBeforeZero) {
    TnFbxNull null;
    null.setName("null");
    null.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(-2, 3), {1.0f, 2.0f, 4.0f});
    WrittenObjects objects;
    objects.nulls = {&null};
    write(objects);

    FacadeRead<TnFbxNull> nulls(file());
    EXPECT_THAT(samplesOf(nulls["null"], Transform::kFbxTransformPositionX), ElementsAre(1.0f, 2.0f, 4.0f));
    test::expectRange(nulls["null"].getTransformTime(Transform::kFbxTransformPositionX), -2, 0, 24.0f);
}

// ---- The span of time ----

/// The frames of the file's stack, at the rate of the file.
TnFbxTime framesOf(const std::string& file) {
    FbxSdk sdk;
    TnFbxTime time;
    EXPECT_TRUE(Fbx().loadScene(file, sdk)) << lastError();
    EXPECT_TRUE(sdk.getGlobalAnimationStackTime(time, 0.0f, /*useSampleFPS*/ false, 0.0f));
    return time;
}

TnFbxNull keyedBetween(int first, int last, float rate = 24.0f) {
    const auto count = static_cast<std::size_t>(last - first + 1);
    TnFbxNull null;
    null.setName("null");
    null.setTransformValueAt(Transform::kFbxTransformPositionX, timeOf(first, count, rate), Samples(count, 1.5f));
    return null;
}

struct SpanRow {
    int firstKey, lastKey;
    float start, end;
    int first, last;
};

TEST_P(TimeRoundTrip, OfAShotKeepsItsFirstAndLastFrame) {
    const SpanRow rows[] = {
        {1001, 1048, 1.0f, 1.0f, 1001, 1048},       // no frames are given: those of the keys
        {1001, 1048, 1001.0f, 1048.0f, 1001, 1048}, //
        {1010, 1020, 1001.0f, 1048.9f, 1001, 1048}, // the frames reach further than the keys
        {990, 1060, 1001.0f, 1048.0f, 990, 1060},   // and vice versa: nothing is truncated
        {-20, -10, -24.0f, -5.0f, -24, -5},         //
        {1001, 1048, 1100.0f, 1000.0f, 1001, 1048}, // an invalid range
    };
    for (const SpanRow& row : rows) {
        TnFbxNull null = keyedBetween(row.firstKey, row.lastKey);
        WrittenObjects objects;
        objects.nulls = {&null};
        TnFbxWriteInfo options = info();
        options.setStartFrame(row.start);
        options.setEndFrame(row.end);
        write(objects, options);

        const TnFbxTime time = framesOf(file());
        EXPECT_EQ(time.getStartFrame(), row.first);
        EXPECT_EQ(time.getEndFrame(), row.last);
        const TnFbxTime sampled =
            FacadeRead<TnFbxNull>(file())["null"].getTransformTime(Transform::kFbxTransformPositionX);
        EXPECT_EQ(sampled.getStartFrame(), row.first);
        EXPECT_EQ(sampled.getEndFrame(), row.last);
    }
}

TEST_P(TimeRoundTrip, OfAShotWithPointCachesAloneKeepsItsFrames) {
    const auto mesh = test::movingMesh("mesh", 48);
    WrittenObjects objects;
    objects.meshes = {mesh.get()};
    for (const bool maya : {true, false}) {
        TnFbxWriteInfo options = info();
        options.setAnimateMeshVertices(true);
        options.setMayaVertexCacheFormat(maya);
        options.setStartFrame(1001.0f);
        options.setEndFrame(1048.0f);
        write(objects, options);

        EXPECT_EQ(framesOf(file()).getStartFrame(), 1001);
        EXPECT_EQ(framesOf(file()).getEndFrame(), 1048);
        for (const int frame : {1001, 1002, 1048}) {
            TnFbxReadInfo read = test::localRead(file());
            read.setFrame(static_cast<float>(frame));
            float x = 0.0f, y = 0.0f, z = -1.0f;
            EXPECT_TRUE(FacadeRead<TnFbxMesh>(read)["mesh"].getControlPoint(1, x, y, z));
            EXPECT_EQ(z, static_cast<float>(frame - 1001));
        }
    }
}

TEST_P(TimeRoundTrip, OfAShotKeepsItsFramesAtEveryRateThatFilesTell) {
    for (const float rate : {23.976f, 24.0f, 25.0f, 29.9700262f, 30.0f, 48.0f, 50.0f, 60.0f, 100.0f, 120.0f, 1000.0f}) {
        TnFbxWriteInfo options = info();
        options.setFPS(rate);
        options.setStartFrame(1001.0f);
        options.setEndFrame(1048.0f);
        write({}, options);

        EXPECT_EQ(framesOf(file()).getStartFrame(), 1001) << rate;
        EXPECT_EQ(framesOf(file()).getEndFrame(), 1048) << rate;
    }
}

TEST_P(TimeRoundTrip, OfNothingHasOneSecond) {
    write({});

    EXPECT_EQ(framesOf(file()).getStartFrame(), 0);
    EXPECT_EQ(framesOf(file()).getEndFrame(), 24);
}

TEST_P(TimeRoundTrip, StatesTheSameSpanAsTheTimeline) {
    TnFbxWriteInfo options = info();
    options.setStartFrame(1001.0f);
    options.setEndFrame(1048.0f);
    write({}, options);

    FbxSdk sdk;
    ASSERT_TRUE(Fbx().loadScene(file(), sdk)) << lastError();
    fbxsdk::FbxTimeSpan timeline;
    sdk.getScene()->GetGlobalSettings().GetTimelineDefaultTimeSpan(timeline);
    const auto* stack = sdk.getScene()->GetSrcObject<fbxsdk::FbxAnimStack>(0);
    EXPECT_EQ(timeline.GetStart().GetFrameCount(fbxsdk::FbxTime::eFrames24), 1001);
    EXPECT_EQ(timeline.GetStop().GetFrameCount(fbxsdk::FbxTime::eFrames24), 1048);
    EXPECT_EQ(stack->GetLocalTimeSpan(), timeline);
    EXPECT_EQ(stack->GetReferenceTimeSpan(), timeline);
}

} // namespace
} // namespace Tarnell::Fbx
