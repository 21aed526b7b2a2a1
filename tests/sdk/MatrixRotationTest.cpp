// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The results of `extractMatrixRotation` for matrices with scale, mirroring or large angles: when the angles are those
// of the rotation, and when the lengths of the axes falsify them. All matrices and angles are computed by hand.
#include "FbxSdk.h"

#include <gtest/gtest.h>

#include <array>

using namespace Tarnell::Fbx;

namespace {

using Vector = std::array<double, 3>;

/// The images of the three axes.
struct Axes {
    Vector x, y, z;

    [[nodiscard]] Axes scaled(double a, double b, double c) const { return {times(x, a), times(y, b), times(z, c)}; }

    /// Without negative zeros, which would change the sign of a half turn.
    static Vector times(const Vector& v, double factor) {
        return {v[0] * factor + 0.0, v[1] * factor + 0.0, v[2] * factor + 0.0};
    }
};

const Axes kUnturned = {{1, 0, 0}, {0, 1, 0}, {0, 0, 1}};
const Axes kX37 = {{1, 0, 0}, {0, 0.8, 0.6}, {0, -0.6, 0.8}};     ///< 36.87 degrees about X
const Axes kY37 = {{0.8, 0, -0.6}, {0, 1, 0}, {0.6, 0, 0.8}};     ///< the same about Y
const Axes kZ37 = {{0.8, 0.6, 0}, {-0.6, 0.8, 0}, {0, 0, 1}};     ///< and about Z
const Axes kX143 = {{1, 0, 0}, {0, -0.8, 0.6}, {0, -0.6, -0.8}};  ///< 143.13 degrees about X
const Axes kX90Z37 = {{0.8, 0, 0.6}, {-0.6, 0, 0.8}, {0, -1, 0}}; ///< Z first, then a right angle about X
constexpr float kAngle = 36.8698976f;                             ///< the arc sine of 0.6
constexpr float kTolerance = 2e-5f;                               ///< degrees; adjacent floats at 180 are 1.5e-5 apart

void expectAngles(const Axes& axes, float x, float y, float z) {
    fbxsdk::FbxAMatrix matrix;
    const std::array rows = {axes.x, axes.y, axes.z};
    for (int row = 0; row < 3; ++row) {
        const Vector& axis = rows[static_cast<std::size_t>(row)];
        matrix[row] = fbxsdk::FbxDouble4(axis[0], axis[1], axis[2], 0.0);
    }
    FbxSdk sdk;
    float angleX = 7.0f, angleY = 7.0f, angleZ = 7.0f;
    EXPECT_TRUE(sdk.extractMatrixRotation(matrix, angleX, angleY, angleZ));
    EXPECT_NEAR(angleX, x, kTolerance);
    EXPECT_NEAR(angleY, y, kTolerance);
    EXPECT_NEAR(angleZ, z, kTolerance);
}

} // namespace

TEST(ExtractMatrixRotation, IsRightForOneAngleBelowARightAngle) {
    expectAngles(kX37, kAngle, 0, 0);
    expectAngles(kY37, 0, kAngle, 0);
    expectAngles(kZ37, 0, 0, kAngle);
}

TEST(ExtractMatrixRotation, TurnsOneAngleAboutXBeyondARightAngleIntoThree) {
    // Z, X, Y: half a turn, 37 degrees, half a turn. In the order X, Y, Z the same three are another rotation.
    expectAngles(kX143, kAngle, 180, 180);
}

TEST(ExtractMatrixRotation, IsNotFalsifiedByTheSameScaleOnAllAxes) {
    for (const double scale : {0.01, 0.5, 3.0, 1000.0}) {
        SCOPED_TRACE(scale);
        expectAngles(kX37.scaled(scale, scale, scale), kAngle, 0, 0);
        expectAngles(kY37.scaled(scale, scale, scale), 0, kAngle, 0);
        expectAngles(kZ37.scaled(scale, scale, scale), 0, 0, kAngle);
        expectAngles(kUnturned.scaled(scale, scale, scale), 0, 0, 0);
    }
}

TEST(ExtractMatrixRotation, TakesAScaledAxisOfThatVeryLengthForGimbalLock) {
    // 0.6 · 5/3 is 1: a right angle, as if the axis were not scaled
    expectAngles(kX37.scaled(5.0 / 3.0, 5.0 / 3.0, 5.0 / 3.0), 90, 0, 0);
    expectAngles(kX37.scaled(1, 1, -5.0 / 3.0), -90, 0, 0);
}

TEST(ExtractMatrixRotation, LosesTheOtherAnglesAtGimbalLockOfAScaledAxis) {
    expectAngles(kX90Z37, 90, 0, kAngle);
    expectAngles(kX90Z37.scaled(2, 2, 2), 90, 0, 0); // −2 is not −1, and all lengths of the rest are 0
}

TEST(ExtractMatrixRotation, BendsTheAngleAboutZWhereXAndYAreScaledDifferently) {
    expectAngles(kZ37.scaled(2, 1, 1), 0, 0, 56.3099325f); // atan2(1.2, 0.8)
    expectAngles(kZ37.scaled(1, 2, 1), 0, 0, 20.5560452f); // atan2(0.6, 1.6)
    expectAngles(kX37.scaled(2, 1, 1), kAngle, 0, 0);      // nothing to falsify
    expectAngles(kY37.scaled(1, 2, 1), 0, kAngle, 0);      //
    expectAngles(kZ37.scaled(1, 1, 2), 0, 0, kAngle);      // Z alone falsifies nothing
    expectAngles(kY37.scaled(1, 1, 2), 0, kAngle, 0);      //
    expectAngles(kX37.scaled(1, 1, 2), kAngle, 0, 0);      //
}

TEST(ExtractMatrixRotation, TakesAMirroredAxisForATurn) {
    expectAngles(kUnturned.scaled(-1, 1, 1), 0, 0, 0);   // not detected
    expectAngles(kUnturned.scaled(1, -1, 1), 0, 0, 180); // atan2(0, −1)
    expectAngles(kUnturned.scaled(1, 1, -1), 0, 180, 0); // atan2(0, −1)
    expectAngles(kUnturned.scaled(-1, -1, -1), 0, 180, 180);
    expectAngles(kZ37.scaled(-1, 1, 1), 0, 0, -kAngle);      // atan2(−0.6, 0.8)
    expectAngles(kZ37.scaled(1, -1, 1), 0, 0, 180 - kAngle); // atan2(0.6, −0.8)
    expectAngles(kX37.scaled(1, 1, -1), -kAngle, 180, 0);
    expectAngles(kY37.scaled(1, 1, -1), 0, kAngle - 180, 0); // atan2(−0.6, −0.8)
}

TEST(ExtractMatrixRotation, TakesAnAxisWithoutLengthForUnturned) {
    expectAngles(kX37.scaled(1, 1, 0), 0, 0, 0);  // every product is 0
    expectAngles(kZ37.scaled(0, 1, 1), 0, 0, 0);  // atan2(0, 0.8)
    expectAngles(kZ37.scaled(1, 0, 1), 0, 0, 90); // atan2(0.6, 0)
}
