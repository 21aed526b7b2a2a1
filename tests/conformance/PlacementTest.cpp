// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Products, inverses and the two decompositions, against numbers computed by hand.
#include "Placement.h"

#include <gtest/gtest.h>

using namespace conformance;

namespace {

constexpr double kTolerance = 1e-12;
constexpr double kSingle = 1e-5; ///< degrees, of an angle in single precision

void expectMatrix(const Matrix12& actual, const Matrix12& expected, double tolerance = kTolerance) {
    for (std::size_t i = 0; i < expected.size(); ++i)
        EXPECT_NEAR(actual[i], expected[i], tolerance) << "number " << i;
}

void expectPoint(const Point& actual, const Point& expected, double tolerance = kTolerance) {
    for (std::size_t i = 0; i < expected.size(); ++i)
        EXPECT_NEAR(actual[i], expected[i], tolerance) << "axis " << i;
}

} // namespace

TEST(Matrices, MoveAPointByAxesAndTranslation) {
    expectPoint(moved({0, 2, 0, -1, 0, 0, 0, 0, 3, 10, 20, 30}, {1, 2, 3}), {8, 22, 39});
}

TEST(Matrices, ApplyTheInnerOneFirst) {
    const Matrix12 shift = shifted({1, 0, 0}), scale = scaled({2, 2, 2});
    expectPoint(moved(product(scale, shift), {1, 0, 0}), {4, 0, 0});
    expectPoint(moved(product(shift, scale), {1, 0, 0}), {3, 0, 0});
}

TEST(Matrices, TurnFromOneAxisToTheNext) {
    expectPoint(moved(turned({90, 0, 0}), {0, 1, 0}), {0, 0, 1});
    expectPoint(moved(turned({0, 90, 0}), {0, 0, 1}), {1, 0, 0});
    expectPoint(moved(turned({0, 0, 90}), {1, 0, 0}), {0, 1, 0});
    expectPoint(moved(turned({90, 0, 90}), {0, 1, 0}), {0, 0, 1}); // X first
}

TEST(Matrices, HaveAnInverseUnlessAnAxisHasNoLength) {
    const Matrix12 matrix = product(shifted({1, 2, 3}), product(turned({20, 30, 40}), scaled({2, -3, 0.5})));
    ASSERT_TRUE(inverse(matrix).has_value());
    expectMatrix(product(*inverse(matrix), matrix), scaled({1, 1, 1}));
    EXPECT_FALSE(inverse(scaled({1, 0, 1})).has_value());
}

TEST(Matrices, AreTheSameWithinTheSizeOfAxesAndOfTranslation) {
    const Matrix12 matrix = {1, 0, 0, 0, 1, 0, 0, 0, 1, 1000, 0, 0};
    Matrix12 other = matrix;
    other[9] += 0.009;
    EXPECT_TRUE(sameMatrix(other, matrix, 1e-5));
    other[9] += 0.002;
    EXPECT_FALSE(sameMatrix(other, matrix, 1e-5));
    other = matrix;
    other[1] += 1e-4; // of axes of length 1
    EXPECT_FALSE(sameMatrix(other, matrix, 1e-5));
}

TEST(Placement, BesideTheOriginIsThatOfTheMatrix) {
    const Placement placement{{1, 2, 3}, {20, 30, 40}, {2, 3, 0.5}};
    const Placement found = placementBesideOrigin(rebuilt(placement));
    expectPoint(found.position, placement.position);
    expectPoint(found.rotation, placement.rotation);
    expectPoint(found.scale, placement.scale);
}

TEST(Placement, OfAMirroredMatrixHasThreeNegativeScales) {
    const Matrix12 matrix = product(shifted({1, 2, 3}), product(turned({20, 30, 40}), scaled({-2, 3, 0.5})));
    const Placement found = placementBesideOrigin(matrix);
    expectPoint(found.scale, {-2, -3, -0.5});
    expectMatrix(rebuilt(found), matrix);
}

TEST(Placement, AtTheOriginHasTheAnglesOfTheOrderZXY) {
    const Matrix12 matrix = product(turned({0, 30, 0}), product(turned({20, 0, 0}), turned({0, 0, 40})));
    expectPoint(placementAtOrigin(matrix).rotation, {20, 30, 40}, kSingle);
    expectPoint(placementAtOrigin(turned({90, 0, 0})).rotation, {90, 0, 0}, kSingle);
    expectPoint(placementAtOrigin(turned({-90, 0, 0})).rotation, {-90, 0, 0}, kSingle);
    expectPoint(placementAtOrigin(turned({120, 0, 0})).rotation, {60, 180, 180}, kSingle);
}

TEST(Placement, AtTheOriginHasAnglesThatScalesBend) {
    const Matrix12 matrix = product(turned({0, 0, 45}), scaled({2, 1, 1}));
    expectPoint(placementAtOrigin(matrix).rotation, {0, 0, 63.4349488229}, kSingle); // atan2(2, 1)
    expectPoint(placementAtOrigin(matrix).scale, {2, 1, 1});
    const Matrix12 doubled = product(turned({30, 0, 0}), scaled({2, 2, 2}));
    expectPoint(placementAtOrigin(doubled).rotation, {90, 0, 0}, kSingle); // 2 · 0.5 is 1
}

TEST(Placement, IsReturnedAsAHostRebuildsIt) {
    const Matrix12 matrix = product(turned({0, 0, 45}), scaled({2, 1, 1}));
    expectMatrix(handedOut(matrix, false), matrix);
    expectMatrix(handedOut(matrix, true), product(turned({0, 0, 63.4349488229}), scaled({2, 1, 1})), 1e-6);
    const Matrix12 flat = product(shifted({1, 2, 3}), product(turned({20, 30, 40}), scaled({2, 0, 1})));
    expectMatrix(handedOut(flat, false), flat);
}
