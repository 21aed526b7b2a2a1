// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Animation of hand-written files. All keys are multiples of four frames apart, at 24 frames per second unless
// stated otherwise.
//
// Within a segment, at its part u, the Hermite cubic between two values a and b is
//
//     a + (b − a)(3u² − 2u³) + r(u³ − 2u² + u) + l(u³ − u²)
//
// where r and l are the slopes at its ends, in value per segment. At u = ¼, ½, ¾ the three factors are
//
//     10/64  1/2  54/64     of b − a
//      9/64  1/8   3/64     of r
//     −3/64 −1/8  −9/64     of l
#include "FixtureFiles.h"

namespace Tarnell::Fbx {
namespace {

using test::expectRange;
using test::FacadeRead;
using test::fixture;
using test::isNear;
using test::Samples;
using test::samplesOf;
using test::worldRead;
using testing::ElementsAre;
using testing::FloatNear;
using Transform = TnFbxTransform;

constexpr auto kX = Transform::kFbxTransformPositionX;
constexpr auto kY = Transform::kFbxTransformPositionY;
constexpr auto kZ = Transform::kFbxTransformPositionZ;

/// The first frames of a channel.
Samples firstSamples(const Transform& object, Transform::EFbxTransformChannelType channel, std::size_t count) {
    Samples samples = samplesOf(object, channel);
    EXPECT_GE(samples.size(), count);
    samples.resize(count);
    return samples;
}

// ---- Interpolation ----

TEST(CurvesFixture, GivesConstantAndLinearKeys) {
    FacadeRead<TnFbxNull> nulls(fixture("curves_7400_ascii.fbx"));
    const TnFbxNull& node = nulls["straight"];

    EXPECT_EQ(samplesOf(node, kX), Samples({0, 0, 0, 0, 4, 4, 4, 4, 8})); // the key before
    EXPECT_EQ(samplesOf(node, kY), Samples({0, 4, 4, 4, 4, 8, 8, 8, 8})); // the key behind
    EXPECT_EQ(samplesOf(node, kZ), Samples({0, 1, 2, 3, 4, 3, 2, 1, 0}));
}

// X goes from 0 to 32 with flat tangents: 32 times 10/64, 1/2 and 54/64.
// Y begins and ends at 0 with the slopes ±192 per second, ±32 per segment of 1/6 s: 32 times 12/64, 1/4 and 12/64.
TEST(CurvesFixture, GivesCubicKeysWithTangentsOfTheUser) {
    FacadeRead<TnFbxNull> nulls(fixture("curves_7400_ascii.fbx"));
    const TnFbxNull& node = nulls["cubic"];

    EXPECT_THAT(samplesOf(node, kX), isNear({0, 5, 16, 27, 32, 32, 32, 32, 32}));
    EXPECT_THAT(samplesOf(node, kY), isNear({0, 6, 8, 6, 0, 0, 0, 0, 0}));
}

// The weights wr = 1000/9999 and wl = 7666/9999 bring the parameter ½ to the time
// 3/8 wr + 3/8 (1 − wl) + 1/8 = 1/2 + 3/8 (wr − wl) = 1/4: the curve is half way up at the first frame already.
TEST(CurvesFixture, GivesCubicKeysWithWeightedTangents) {
    FacadeRead<TnFbxNull> nulls(fixture("curves_7400_ascii.fbx"));

    const Samples samples = firstSamples(nulls["cubic"], kZ, 5);
    EXPECT_THAT(samples[1], FloatNear(16.0f, 1e-4f));
    EXPECT_EQ(samples[4], 32.0f);
}

TEST(CurvesFixture, HasTheRangeOfTheStack) {
    FacadeRead<TnFbxNull> nulls(fixture("curves_7400_ascii.fbx"));

    expectRange(nulls["cubic"].getTransformTime(kX), 0, 8, 24.0f);
}

// The keys are 0, 16, 16. An end has the slope of its segment, 16 and 0; the key between has half of both, 8:
// 16·10/64 + 16·9/64 − 8·3/64 = 280/64 …, then 16 + 8·9/64 = 17.125 …
TEST(AutoCurvesFixture, GivesAutomaticTangents) {
    FacadeRead<TnFbxNull> nulls(fixture("auto_curves_7400_ascii.fbx"));

    EXPECT_THAT(samplesOf(nulls["auto"], kX), isNear({0, 4.375f, 9, 13.125f, 16, 17.125f, 17, 16.375f, 16}));
}

// The same keys, but the tangent between two equal values is flat: 16·10/64 + 16·9/64 = 4.75 …
TEST(AutoCurvesFixture, GivesClampedTangents) {
    FacadeRead<TnFbxNull> nulls(fixture("auto_curves_7400_ascii.fbx"));

    EXPECT_THAT(samplesOf(nulls["auto"], kY), isNear({0, 4.75f, 10, 14.25f, 16, 16, 16, 16, 16}));
}

// The keys are 0, 2, 20. The ends are flat. The slope between, 20 in two segments, is limited so that its handle, a
// third of a segment, does not leave the value of the key before: 2 = slope / 3, 6 per segment. The first segment then
// is 2u³, the second 2 + 18·10/64 + 6·9/64 …
TEST(AutoCurvesFixture, GivesProgressivelyClampedTangents) {
    FacadeRead<TnFbxNull> nulls(fixture("auto_curves_7400_ascii.fbx"));

    EXPECT_THAT(samplesOf(nulls["auto"], kZ),
                isNear({0, 0.03125f, 0.25f, 0.84375f, 2, 5.65625f, 11.75f, 17.46875f, 20}));
}

// The keys are 0, 16, 16, with chords of 16 and 0 per segment. Slopes per segment by Kochanek and Bartels:
// tension ½:    8 out of the first key, 4 through the second;
// bias ½:       8, then (1.5·16 + 0.5·0)/2 = 12 through the second;
// continuity ½: 8, then 0.5·16/2 = 4 into the second and 1.5·16/2 = 12 out of it.
TEST(AutoCurvesFixture, GivesTangentsByTensionBiasAndContinuity) {
    FacadeRead<TnFbxNull> nulls(fixture("auto_curves_7400_ascii.fbx"));
    const TnFbxNull& node = nulls["tcb"];

    EXPECT_THAT(samplesOf(node, kX), isNear({0, 3.4375f, 8.5f, 13.3125f, 16, 16.5625f, 16.5f, 16.1875f, 16}));
    EXPECT_THAT(samplesOf(node, kY), isNear({0, 3.0625f, 7.5f, 12.1875f, 16, 17.6875f, 17.5f, 16.5625f, 16}));
    EXPECT_THAT(samplesOf(node, kZ), isNear({0, 3.4375f, 8.5f, 13.3125f, 16, 17.6875f, 17.5f, 16.5625f, 16}));
}

// ---- Extrapolation ----

// The keys are 0 at frame 4 and 4 at frame 8. Where one repetition ends the next one begins.
TEST(ExtrapolationFixture, RepeatsMirrorsOrGoesOn) {
    FacadeRead<TnFbxNull> nulls(fixture("extrapolation_7400_ascii.fbx"));
    const TnFbxNull& node = nulls["endless"];

    EXPECT_EQ(samplesOf(node, kX), Samples({0, 1, 2, 3, 0, 1, 2, 3, 4, 1, 2, 3, 0, 1, 2, 3, 0}));
    EXPECT_EQ(samplesOf(node, kY), Samples({4, 3, 2, 1, 0, 1, 2, 3, 4, 3, 2, 1, 0, 1, 2, 3, 4}));
    EXPECT_THAT(samplesOf(node, kZ), isNear({-4, -3, -2, -1, 0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12}));
}

// X goes from 0 to 32 with flat tangents (5, 16, 27 between); each repetition begins where the one before ends.
TEST(ExtrapolationFixture, RepeatsRelatively) {
    FacadeRead<TnFbxNull> nulls(fixture("extrapolation_7400_ascii.fbx"));

    EXPECT_THAT(samplesOf(nulls["other"], kX),
                isNear({-32, -27, -16, -5, 0, 5, 16, 27, 32, 37, 48, 59, 64, 69, 80, 91, 96}));
}

TEST(ExtrapolationFixture, HoldsWhenItsRepetitionsAreUsedUpOrThereAreNone) {
    FacadeRead<TnFbxNull> nulls(fixture("extrapolation_7400_ascii.fbx"));
    const TnFbxNull& node = nulls["other"];

    EXPECT_EQ(samplesOf(node, kY), Samples({0, 0, 0, 0, 0, 1, 2, 3, 4, 1, 2, 3, 4, 4, 4, 4, 4}));
    EXPECT_EQ(samplesOf(node, kZ), Samples({1, 1, 1, 1, 1, 1.5f, 2, 2.5f, 3, 3, 3, 3, 3, 3, 3, 3, 3}));
}

// ---- Older and newer spellings ----

class TakesOfEachGeneration : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(Files, TakesOfEachGeneration, testing::Values("takes_5800_ascii.fbx", "takes_6100_ascii.fbx"));

TEST_P(TakesOfEachGeneration, GivesConstantAndLinearKeys) {
    FacadeRead<TnFbxNull> nulls(fixture(GetParam()));

    // 0 until the key at frame 4, then that at frame 8, then down to 0 at frame 12
    EXPECT_EQ(samplesOf(nulls["node"], kX), Samples({0, 0, 0, 0, 4, 8, 8, 8, 8, 6, 4, 2, 0}));
    expectRange(nulls["node"].getTransformTime(kX), 0, 12, 24.0f);
}

// The segments of "cubic" in curves_7400_ascii.fbx: slopes of ±32 per segment, flat, flat and weighted.
TEST_P(TakesOfEachGeneration, GivesCubicKeysWithTangentsOfTheUser) {
    FacadeRead<TnFbxNull> nulls(fixture(GetParam()));

    Samples samples = samplesOf(nulls["node"], kY);
    ASSERT_EQ(samples.size(), 13U);
    EXPECT_THAT(samples[9], FloatNear(32.0f + 16.0f, 1e-4f)); // half way at the first frame
    samples.resize(9);
    EXPECT_THAT(samples, isNear({0, 6, 8, 6, 0, 5, 16, 27, 32}));
}

// The curves of "auto" and "tcb" in auto_curves_7400_ascii.fbx, but the automatic tangents of both ends are flat, as
// 3ds Max shows its own 6.1 files. The keys are 0, 16, 16; the one between has the slope 8, half of both chords:
// 16·10/64 − 8·3/64 = 2.125 …
TEST_P(TakesOfEachGeneration, GivesAutomaticTangentsAndThoseByTension) {
    FacadeRead<TnFbxNull> nulls(fixture(GetParam()));

    EXPECT_THAT(firstSamples(nulls["smooth"], kX, 9), isNear({0, 2.125f, 7, 12.375f, 16, 17.125f, 17, 16.375f, 16}));
    EXPECT_THAT(firstSamples(nulls["smooth"], kY, 9),
                isNear({0, 3.4375f, 8.5f, 13.3125f, 16, 16.5625f, 16.5f, 16.1875f, 16}));
}

TEST_P(TakesOfEachGeneration, GivesTheValueOfAChannelWithoutKeys) {
    FacadeRead<TnFbxNull> nulls(fixture(GetParam()));

    EXPECT_EQ(nulls["node"].getTransformValue(kZ), 7.0f);
    EXPECT_FALSE(nulls["node"].getTransformAnimated(kZ));
    FacadeRead<TnFbxNull> inTheWorld(worldRead(GetParam()));
    EXPECT_EQ(samplesOf(inTheWorld["node"], kZ), Samples(13, 7.0f));
}

TEST(TakesFixture, ExtrapolatesInOldFilesToo) {
    FacadeRead<TnFbxNull> mirrored(fixture("takes_6100_ascii.fbx")), repeated(fixture("takes_5800_ascii.fbx"));

    EXPECT_EQ(samplesOf(mirrored["smooth"], kZ), Samples({4, 3, 2, 1, 0, 1, 2, 3, 4, 3, 2, 1, 0}));
    EXPECT_EQ(samplesOf(repeated["smooth"], kZ), Samples({0, 1, 2, 3, 0, 1, 2, 3, 4, 1, 2, 3, 0}));
}

TEST(TakesFixture, PlacesAChildOfTheOldestLayoutInItsParent) {
    FacadeRead<TnFbxNull> nulls(worldRead("takes_5800_ascii.fbx"));

    // frame 4: 4, 0 and 7 of the parent, 16, 16 and 0 of the child
    EXPECT_THAT(nulls.names(), ElementsAre("node", "smooth"));
    EXPECT_THAT(nulls["smooth"].getTransformValueAt(kX, 4.0f), FloatNear(20.0f, 1e-5f));
    EXPECT_THAT(nulls["smooth"].getTransformValueAt(kY, 4.0f), FloatNear(16.0f, 1e-5f));
    EXPECT_THAT(nulls["smooth"].getTransformValueAt(kZ, 4.0f), FloatNear(7.0f, 1e-5f));
}

// Y of "cubic" in curves_7400_ascii.fbx; its attributes as fractions, and its times in other ticks.
TEST(CurveSpellings, GiveTheSameCurve) {
    for (const char* file : {"curve_7100_ascii.fbx", "ticks_7700_ascii.fbx"}) {
        FacadeRead<TnFbxNull> nulls(fixture(file));

        EXPECT_THAT(samplesOf(nulls["node"], kX), isNear({0, 6, 8, 6, 0})) << file;
        expectRange(nulls["node"].getTransformTime(kX), 0, 4, 24.0f);
    }
}

// ---- Layers ----

// Frames 0 to 2 of the base layer: 10, 12, 14, and of the layer above it: 4, 6, 8, or 10 and 4 throughout.
TEST(LayersFixture, CombineInTheWorld) {
    FacadeRead<TnFbxNull> nulls(worldRead("layers_7400_ascii.fbx"));

    EXPECT_THAT(samplesOf(nulls["added"], kX), isNear({12, 15, 18}));          // with half of the layer
    EXPECT_THAT(samplesOf(nulls["overridden"], kX), isNear({4, 4, 4}));        // whatever the weight
    EXPECT_THAT(samplesOf(nulls["passed"], kX), isNear({8.5f, 10.5f, 12.5f})); // a quarter of the layer
    EXPECT_THAT(samplesOf(nulls["muted"], kX), isNear({10, 10, 10}));
}

TEST(LayersFixture, MultiplyScalesByThePowerOfTheirWeight) {
    FacadeRead<TnFbxNull> nulls(worldRead("layers_7400_ascii.fbx"));

    EXPECT_THAT(test::scaleOf(nulls["scaled"]), isNear({2.0f * 2.0f, 1, 1})); // 2 · 4^½
}

// kept: local samples are the sum of all curves, whatever their layers say
TEST(LayersFixture, AddUpWhenReadLocally) {
    FacadeRead<TnFbxNull> nulls(fixture("layers_7400_ascii.fbx"));

    EXPECT_EQ(samplesOf(nulls["added"], kX), Samples({14, 18, 22}));
    EXPECT_EQ(samplesOf(nulls["passed"], kX), Samples({14, 18, 22}));
    EXPECT_FALSE(nulls["muted"].getTransformAnimated(kX)); // values without curves
}

// ---- Stacks and rates ----

TEST(TwoStacksFixture, AreBothNamed) {
    test::Names stacks, nodes;
    ASSERT_TRUE(Fbx().getAnimationStackNodeNames(fixture("two_stacks_7400_ascii.fbx").c_str(), 0x4000, stacks, nodes));

    EXPECT_THAT(stacks, ElementsAre("walk", "run"));
    EXPECT_THAT(nodes, ElementsAre("node"));
}

TEST(TwoStacksFixture, GiveTheFirstOneFromItsFrameOn) {
    for (const TnFbxReadInfo& info :
         {test::localRead(fixture("two_stacks_7400_ascii.fbx")), worldRead("two_stacks_7400_ascii.fbx")}) {
        FacadeRead<TnFbxNull> nulls(info);

        EXPECT_EQ(samplesOf(nulls["node"], kX), Samples({1, 3, 5}));
        expectRange(nulls["node"].getTransformTime(kX), 1001, 1003, 24.0f);
    }
}

TEST(TwoStacksFixture, GiveTheFirstOneAlsoWhenTheSecondIsRequested) {
    for (TnFbxReadInfo info :
         {test::localRead(fixture("two_stacks_7400_ascii.fbx")), worldRead("two_stacks_7400_ascii.fbx")}) {
        info.setAnimationStackName("run");
        FacadeRead<TnFbxNull> nulls(info);

        EXPECT_EQ(samplesOf(nulls["node"], kX), Samples({1, 3, 5}));
        expectRange(nulls["node"].getTransformTime(kX), 1001, 1003, 24.0f);
    }
}

TEST(TwoStacksFixture, HaveTheRangeOfTheFirstOne) {
    float start = 0.0f, end = 0.0f;
    ASSERT_TRUE(Fbx().getAnimationFrameRange(fixture("two_stacks_7400_ascii.fbx").c_str(), start, end));

    EXPECT_EQ(start, 1001.0f / 24.0f);
    EXPECT_EQ(end, 1003.0f / 24.0f);
}

// The curve rises by 1 per frame of 1001/24000 s from frame 1001 on; the samples are 1/23.976 s apart.
TEST(FilmRateFixture, CountsFramesAtTheRateOfFilm) {
    constexpr float kRate = 23.976f;
    const auto valueAt = [](int frame) {
        return static_cast<float>(frame / static_cast<double>(kRate) * 24000.0 / 1001.0 - 1001.0);
    };
    FacadeRead<TnFbxNull> nulls(fixture("film_rate_7400_ascii.fbx"));

    expectRange(nulls["node"].getTransformTime(kX), 1001, 1003, kRate);
    EXPECT_THAT(samplesOf(nulls["node"], kX), isNear({valueAt(1001), valueAt(1002), 2})); // held after the last key
}

TEST(CustomRateFixture, CountsFramesAtTheRateOfTheFile) {
    FacadeRead<TnFbxNull> nulls(fixture("custom_rate_7400_ascii.fbx"));

    expectRange(nulls["node"].getTransformTime(kX), 2, 5, 12.5f);
    EXPECT_THAT(samplesOf(nulls["node"], kX), isNear({0, 1, 2, 3}));
}

TEST(CustomRateFixture, IsReadAtAnotherRate) {
    TnFbxReadInfo info = worldRead("custom_rate_7400_ascii.fbx");
    info.setUseSampleFPS(true);
    info.setSampleFPS(25.0f);
    FacadeRead<TnFbxNull> nulls(info);

    expectRange(nulls["node"].getTransformTime(kX), 4, 10, 25.0f);
    EXPECT_THAT(samplesOf(nulls["node"], kX), isNear({0, 0.5f, 1, 1.5f, 2, 2.5f, 3}));
}

} // namespace
} // namespace Tarnell::Fbx
