// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Samples of one direction: weights of control points, parameters, seams.
#include "geometry/tessellation/TessellationBasis.h"

#include <cmath>
#include <limits>
#include <numeric>

#include <gtest/gtest.h>

namespace fbxsdk::detail {
namespace {

const std::vector<double> kBezierKnots{0, 0, 0, 0, 1, 1, 1, 1};

std::vector<double> weightsAt(const SampledDirection& sampled, int sample) {
    std::vector<double> weights(static_cast<std::size_t>(sampled.points));
    for (const BasisTerm& term : sampled.termsOf(sample))
        weights[static_cast<std::size_t>(term.point)] += term.weight;
    return weights;
}

void expectWeights(const SampledDirection& sampled, int sample, const std::vector<double>& expected) {
    const auto weights = weightsAt(sampled, sample);
    ASSERT_EQ(weights.size(), expected.size());
    for (std::size_t i = 0; i < expected.size(); ++i)
        EXPECT_NEAR(weights[i], expected[i], 1e-15) << "point " << i << " of sample " << sample;
}

FbxPatch::Direction patchDirection(FbxPatch::EType type, int count, bool closed = false) {
    FbxPatch::Direction direction;
    direction.type = type;
    direction.count = count;
    direction.closed = closed;
    return direction;
}

/// Weights add up to one and slopes to zero, or the surface would not move with its points.
void expectPartitionOfUnity(const SampledDirection& sampled) {
    for (int sample = 0; sample < sampled.sampleCount(); ++sample) {
        double weight = 0.0, slope = 0.0;
        for (const BasisTerm& term : sampled.termsOf(sample)) {
            weight += term.weight;
            slope += term.slope;
        }
        EXPECT_NEAR(weight, 1.0, 1e-14);
        EXPECT_NEAR(slope, 0.0, 1e-13);
    }
}

TEST(TessellationBasis, GivesBernsteinPolynomialsForBezierKnots) {
    const auto sampled = sampleDirection(KnotDirection{4, 4, kBezierKnots}, 2);
    ASSERT_TRUE(sampled);
    EXPECT_EQ(sampled->places, (std::vector<double>{0, 0.5, 1}));
    expectWeights(*sampled, 0, {1, 0, 0, 0});
    expectWeights(*sampled, 1, {0.125, 0.375, 0.375, 0.125});
    expectWeights(*sampled, 2, {0, 0, 0, 1});
    EXPECT_NEAR(sampled->termsOf(1)[0].slope, -0.75, 1e-15);
    EXPECT_NEAR(sampled->termsOf(1)[3].slope, 0.75, 1e-15);
    EXPECT_FALSE(sampled->joined);
}

TEST(TessellationBasis, SamplesEverySpanInEqualStepsWhateverItsLength) {
    const std::vector<double> knots{0, 0, 1, 5, 5};
    const auto sampled = sampleDirection(KnotDirection{3, 2, knots}, 4);
    ASSERT_TRUE(sampled);
    EXPECT_EQ(sampled->places, (std::vector<double>{0, 0.05, 0.1, 0.15, 0.2, 0.4, 0.6, 0.8, 1}));
    expectWeights(*sampled, 4, {0, 1, 0});
    expectPartitionOfUnity(*sampled);
}

TEST(TessellationBasis, SkipsSpansWithoutLength) {
    const std::vector<double> knots{0, 0, 0, 1, 1, 2, 2, 2};
    const KnotDirection direction{5, 3, knots};
    EXPECT_EQ(spanCount(direction), 2);
    const auto sampled = sampleDirection(direction, 3);
    ASSERT_TRUE(sampled);
    EXPECT_EQ(sampled->sampleCount(), 7);
    expectWeights(*sampled, 3, {0, 0, 1, 0, 0});
}

TEST(TessellationBasis, JoinsTheEndsOfAPeriodicDirection) {
    const std::vector<double> knots{-3, -2, -1, 0, 1, 2, 3, 4, 5, 6, 7}; // four points, the first three of them again
    const auto sampled = sampleDirection(KnotDirection{4, 4, knots}, 2);
    ASSERT_TRUE(sampled);
    EXPECT_EQ(sampled->sampleCount(), 9);
    EXPECT_TRUE(sampled->joined);
    EXPECT_EQ(sampled->distinctCount(), 8);
    expectWeights(*sampled, 0, {1 / 6.0, 4 / 6.0, 1 / 6.0, 0});
    expectWeights(*sampled, 2, {0, 1 / 6.0, 4 / 6.0, 1 / 6.0});
    expectWeights(*sampled, 6, {4 / 6.0, 1 / 6.0, 0, 1 / 6.0});
    expectPartitionOfUnity(*sampled);
}

TEST(TessellationBasis, JoinsTheEndsOfAClosedDirectionWhoseFirstPointComesAgain) {
    const std::vector<double> knots{0, 0, 1, 2, 3, 3};
    const auto sampled = sampleDirection(KnotDirection{3, 2, knots}, 1);
    ASSERT_TRUE(sampled);
    EXPECT_EQ(sampled->sampleCount(), 4);
    EXPECT_TRUE(sampled->joined);
    expectWeights(*sampled, 3, {1, 0, 0});
}

TEST(TessellationBasis, RefusesNumbersThatDoNotFitTogether) {
    constexpr double kNan = std::numeric_limits<double>::quiet_NaN(),
                     kInfinite = std::numeric_limits<double>::infinity();
    const auto spans = [](int points, int order, const std::vector<double>& knots) {
        EXPECT_FALSE(sampleDirection(KnotDirection{points, order, knots}, 4)) << points << " " << order;
        return spanCount(KnotDirection{points, order, knots});
    };
    EXPECT_EQ(spans(4, 1, {0, 0, 0, 0, 1}), 0);
    EXPECT_EQ(spans(4, 5, {0, 0, 0, 0, 0, 1, 1, 1, 1}), 0);
    EXPECT_EQ(spans(4, 4, {0, 0, 0, 0, 1, 1, 1}), 0);
    EXPECT_EQ(spans(4, 4, {0, 0, 0, 0, 1, 1, 1, 1, 1, 1, 1, 1}), 0);
    EXPECT_EQ(spans(4, 4, {}), 0);
    EXPECT_EQ(spans(0, 4, {0, 0, 0, 0}), 0);
    EXPECT_EQ(spans(4, 4, {1, 1, 1, 1, 0, 0, 0, 0}), 0);
    EXPECT_EQ(spans(4, 4, {2, 2, 2, 2, 2, 2, 2, 2}), 0);
    EXPECT_EQ(spans(4, 4, {0, 0, 0, 0, kNan, 1, 1, 1}), 0);
    EXPECT_EQ(spans(4, 4, {0, 0, 0, 0, kInfinite, kInfinite, kInfinite, kInfinite}), 0);
    EXPECT_EQ(spans(4, 4, {-1e308, -1e308, -1e308, -1e308, 1e308, 1e308, 1e308, 1e308}), 0);
    std::vector<double> many(165);
    std::iota(many.begin(), many.end(), 0.0);
    EXPECT_EQ(spans(100, kHighestOrder + 1, many), 0);
    EXPECT_EQ(spanCount(KnotDirection{101, kHighestOrder, many}), 38);
}

TEST(TessellationBasis, TakesTheHighestOrder) {
    std::vector<double> knots(2 * kHighestOrder, 0.0);
    std::fill(knots.begin() + kHighestOrder, knots.end(), 1.0);
    const auto sampled = sampleDirection(KnotDirection{kHighestOrder, kHighestOrder, knots}, 4);
    ASSERT_TRUE(sampled);
    for (int sample = 0; sample < sampled->sampleCount(); ++sample) {
        const auto weights = weightsAt(*sampled, sample);
        EXPECT_NEAR(std::accumulate(weights.begin(), weights.end(), 0.0), 1.0, 1e-12);
    }
}

TEST(TessellationBasis, BezierPatchesReachEveryThirdPoint) {
    const auto direction = patchDirection(FbxPatch::eBezier, 7);
    EXPECT_EQ(segmentCount(direction), 2);
    const auto sampled = sampleDirection(direction, 2);
    ASSERT_TRUE(sampled);
    expectWeights(*sampled, 0, {1, 0, 0, 0, 0, 0, 0});
    expectWeights(*sampled, 1, {0.125, 0.375, 0.375, 0.125, 0, 0, 0});
    expectWeights(*sampled, 2, {0, 0, 0, 1, 0, 0, 0});
    expectWeights(*sampled, 4, {0, 0, 0, 0, 0, 0, 1});
    expectPartitionOfUnity(*sampled);
}

TEST(TessellationBasis, QuadricPatchesReachEverySecondPoint) {
    const auto sampled = sampleDirection(patchDirection(FbxPatch::eBezierQuadric, 5), 2);
    ASSERT_TRUE(sampled);
    expectWeights(*sampled, 1, {0.25, 0.5, 0.25, 0, 0});
    expectWeights(*sampled, 2, {0, 0, 1, 0, 0});
    expectWeights(*sampled, 4, {0, 0, 0, 0, 1});
    expectPartitionOfUnity(*sampled);
}

TEST(TessellationBasis, CardinalPatchesGoThroughAllTheirPoints) {
    for (const int count : {2, 3, 5}) {
        const auto sampled = sampleDirection(patchDirection(FbxPatch::eCardinal, count), 1);
        ASSERT_TRUE(sampled);
        ASSERT_EQ(sampled->sampleCount(), count);
        for (int point = 0; point < count; ++point) {
            std::vector<double> expected(static_cast<std::size_t>(count));
            expected[static_cast<std::size_t>(point)] = 1.0;
            expectWeights(*sampled, point, expected);
        }
        expectPartitionOfUnity(*sampled);
    }
}

TEST(TessellationBasis, CardinalPatchesKeepStraightLinesStraight) {
    const auto sampled = sampleDirection(patchDirection(FbxPatch::eCardinal, 4), 4);
    ASSERT_TRUE(sampled);
    for (int sample = 0; sample < sampled->sampleCount(); ++sample) {
        double place = 0.0, slope = 0.0;
        for (const BasisTerm& term : sampled->termsOf(sample)) {
            place += term.weight * term.point;
            slope += term.slope * term.point;
        }
        EXPECT_NEAR(place, 0.25 * sample, 1e-14);
        EXPECT_NEAR(slope, 1.0, 1e-14);
    }
}

TEST(TessellationBasis, OpenBSplinePatchesStayShortOfTheirOuterPoints) {
    const auto sampled = sampleDirection(patchDirection(FbxPatch::eBSpline, 5), 1);
    ASSERT_TRUE(sampled);
    ASSERT_EQ(sampled->sampleCount(), 3);
    expectWeights(*sampled, 0, {1 / 6.0, 4 / 6.0, 1 / 6.0, 0, 0});
    expectWeights(*sampled, 2, {0, 0, 1 / 6.0, 4 / 6.0, 1 / 6.0});
    expectPartitionOfUnity(*sampled);
}

TEST(TessellationBasis, ClosedPatchesRunOnToTheirFirstPoint) {
    const struct {
        FbxPatch::EType type;
        int count, segments;
    } kCases[] = {{FbxPatch::eLinear, 4, 4},
                  {FbxPatch::eBezier, 6, 2},
                  {FbxPatch::eBezierQuadric, 6, 3},
                  {FbxPatch::eCardinal, 3, 3},
                  {FbxPatch::eBSpline, 5, 5}};
    for (const auto& each : kCases) {
        const auto direction = patchDirection(each.type, each.count, true);
        EXPECT_EQ(segmentCount(direction), each.segments);
        const auto sampled = sampleDirection(direction, 2);
        ASSERT_TRUE(sampled);
        EXPECT_EQ(sampled->sampleCount(), 2 * each.segments + 1);
        EXPECT_TRUE(sampled->joined) << each.type;
        expectPartitionOfUnity(*sampled);
    }
}

TEST(TessellationBasis, LeavesOutBezierPointsThatMakeNoSegment) {
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eBezier, 6)), 1);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eBezierQuadric, 6)), 2);
}

TEST(TessellationBasis, FindsNoSegmentInTooFewPoints) {
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eBezier, 3)), 0);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eBezierQuadric, 2)), 0);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eBSpline, 3)), 0);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eCardinal, 1)), 0);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eLinear, 1)), 0);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eLinear, 0)), 0);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eLinear, 2, true)), 0);
    EXPECT_EQ(segmentCount(patchDirection(FbxPatch::eBezier, 0, true)), 0);
    EXPECT_FALSE(sampleDirection(patchDirection(FbxPatch::eLinear, 1), 4));
}

} // namespace
} // namespace fbxsdk::detail
