// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversions between Euler angles, axes and quaternions, for every order.
#include <algorithm>
#include <cmath>
#include <random>
#include <string>

#include <gtest/gtest.h>

#include "core/Rotation.h"

namespace {

using namespace fbxsdk;
using fbxsdk::detail::Axes;

// the six orders and, written out by hand, their axes in order of application
struct OrderRow {
    EFbxRotationOrder order;
    const char* letters;
};
constexpr OrderRow kOrders[] = {
    {eEulerXYZ, "XYZ"}, {eEulerXZY, "XZY"}, {eEulerYZX, "YZX"},   {eEulerYXZ, "YXZ"},
    {eEulerZXY, "ZXY"}, {eEulerZYX, "ZYX"}, {eSphericXYZ, "XYZ"},
};

/// The loss of a conversion and its inverse, in units of the matrix's elements.
constexpr double kRoundTrip = 4.0e-15;

double largestDifference(const Axes& a, const Axes& b) {
    double largest = 0.0;
    for (size_t i = 0; i < 3; ++i)
        for (size_t j = 0; j < 3; ++j)
            largest = std::max(largest, std::abs(a[i][j] - b[i][j]));
    return largest;
}

std::string print(const Axes& axes) {
    std::string text;
    for (const auto& row : axes) {
        for (const double element : row)
            text += std::to_string(element) + ' ';
        text += '\n';
    }
    return text;
}

/// The elementary rotation about one axis.
FbxAMatrix turn(char axis, double degrees) {
    const double c = std::cos(degrees * FBXSDK_PI_DIV_180);
    const double s = std::sin(degrees * FBXSDK_PI_DIV_180);
    FbxAMatrix matrix;
    const int j = (axis - 'X' + 1) % 3;
    const int k = (axis - 'X' + 2) % 3;
    matrix[j][j] = c;
    matrix[j][k] = s;
    matrix[k][j] = -s;
    matrix[k][k] = c;
    return matrix;
}

FbxVector4 randomAngles(std::mt19937_64& random) {
    std::uniform_real_distribution<double> angle(-360.0, 360.0);
    return {angle(random), angle(random), angle(random)};
}

TEST(Rotation, HasTheDocumentedOrderNumbers) {
    for (int i = 0; i < 7; ++i)
        EXPECT_EQ(kOrders[i].order, i);
}

TEST(Rotation, AppliesTheAnglesInTheOrderOfItsLetters) {
    std::mt19937_64 random(1);
    for (const auto& [order, letters] : kOrders) {
        for (int i = 0; i < 100; ++i) {
            const FbxVector4 angles = randomAngles(random);
            const auto angleOf = [&angles, axes = letters](int place) { return angles[axes[place] - 'X']; };
            const FbxAMatrix expected =
                turn(letters[2], angleOf(2)) * turn(letters[1], angleOf(1)) * turn(letters[0], angleOf(0));

            const FbxAMatrix matrix = detail::rotationMatrix(angles, order);

            for (int e = 0; e < 16; ++e) {
                EXPECT_NEAR(static_cast<const double*>(matrix)[e], static_cast<const double*>(expected)[e], 1.0e-13)
                    << letters;
            }
        }
    }
}

TEST(Rotation, ComesBackFromAxesFor100000RotationsInEveryOrder) {
    std::mt19937_64 random(20);
    for (const auto& [order, letters] : kOrders) {
        for (int i = 0; i < 100000; ++i) {
            const Axes axes = detail::axesFromEuler(randomAngles(random), order);
            const FbxVector4 angles = detail::eulerFromAxes(axes, order);
            const Axes again = detail::axesFromEuler(angles, order);

            ASSERT_LE(largestDifference(axes, again), kRoundTrip) << letters << '\n' << print(axes) << print(again);
        }
    }
}

TEST(Rotation, ComesBackToTheSameAnglesWhileTheMiddleOneIsBelow90Degrees) {
    std::mt19937_64 random(3);
    std::uniform_real_distribution<double> outer(-180.0, 180.0);
    std::uniform_real_distribution<double> middle(-89.0, 89.0);
    for (const auto& [order, letters] : kOrders) {
        for (int i = 0; i < 10000; ++i) {
            FbxVector4 angles(outer(random), outer(random), outer(random));
            angles[letters[1] - 'X'] = middle(random);

            const FbxVector4 again = detail::eulerFromAxes(detail::axesFromEuler(angles, order), order);

            for (int j = 0; j < 3; ++j)
                ASSERT_NEAR(again[j], angles[j], 1.0e-11) << letters;
            ASSERT_EQ(again[3], 1.0);
        }
    }
}

TEST(Rotation, IsExactForAllMultiplesOf90Degrees) {
    for (const auto& [order, letters] : kOrders) {
        for (int x = -720; x <= 720; x += 90) {
            for (int y = -720; y <= 720; y += 90) {
                for (int z = -720; z <= 720; z += 90) {
                    const Axes axes = detail::axesFromEuler(FbxVector4(x, y, z), order);
                    for (const auto& row : axes)
                        for (const double element : row)
                            ASSERT_TRUE(element == 0.0 || element == 1.0 || element == -1.0) << print(axes);
                    const FbxVector4 angles = detail::eulerFromAxes(axes, order);
                    for (int j = 0; j < 3; ++j)
                        ASSERT_EQ(std::remainder(angles[j], 90.0), 0.0) << letters << ' ' << angles[j];
                    ASSERT_EQ(detail::axesFromEuler(angles, order), axes) << letters << '\n' << print(axes);
                }
            }
        }
    }
}

TEST(Rotation, GivesTheWholeTurnToTheFirstAngleWhenTheMiddleOneIs90Degrees) {
    for (const auto& [order, letters] : kOrders) {
        for (const double quarter : {90.0, -90.0}) {
            FbxVector4 angles(20.0, 20.0, 20.0);
            angles[letters[1] - 'X'] = quarter;
            const Axes axes = detail::axesFromEuler(angles, order);

            const FbxVector4 again = detail::eulerFromAxes(axes, order);

            EXPECT_EQ(again[letters[2] - 'X'], 0.0) << letters;
            EXPECT_EQ(again[letters[1] - 'X'], quarter) << letters;
            EXPECT_LE(largestDifference(detail::axesFromEuler(again, order), axes), kRoundTrip) << letters;
        }
    }
}

TEST(Rotation, TakesAnOrderThatDoesNotExistForXyz) {
    const FbxVector4 angles(10.0, 20.0, 30.0);
    for (const int number : {-1, 7, 1000}) {
        const auto order = static_cast<EFbxRotationOrder>(number);
        EXPECT_EQ(detail::axesFromEuler(angles, order), detail::axesFromEuler(angles, eEulerXYZ));
    }
}

TEST(SinCosDegrees, IsExactAtQuarterTurns) {
    for (int quarters = -4000; quarters <= 4000; ++quarters) {
        const auto [sine, cosine] = detail::sinCosDegrees(90.0 * quarters);
        const int phase = ((quarters % 4) + 4) % 4;
        EXPECT_EQ(sine, phase == 1 ? 1.0 : phase == 3 ? -1.0 : 0.0) << quarters;
        EXPECT_EQ(cosine, phase == 0 ? 1.0 : phase == 2 ? -1.0 : 0.0) << quarters;
    }
}

TEST(SinCosDegrees, AgreesWithTheRadianFunctions) {
    for (double degrees = -720.0; degrees <= 720.0; degrees += 0.37) {
        const auto [sine, cosine] = detail::sinCosDegrees(degrees);
        EXPECT_NEAR(sine, std::sin(degrees * FBXSDK_PI_DIV_180), 2.0e-15) << degrees;
        EXPECT_NEAR(cosine, std::cos(degrees * FBXSDK_PI_DIV_180), 2.0e-15) << degrees;
    }
}

TEST(SinCosDegrees, KeepsTheSignOfAHalfTurn) {
    EXPECT_EQ(detail::eulerFromAxes(detail::axesFromEuler(FbxVector4(180.0, 0.0, 0.0), eEulerXYZ), eEulerXYZ)[0],
              180.0);
    EXPECT_EQ(detail::eulerFromAxes(detail::axesFromEuler(FbxVector4(-180.0, 0.0, 0.0), eEulerXYZ), eEulerXYZ)[0],
              -180.0);
}

TEST(SinCosDegrees, IsNoNumberForNoAngle) {
    EXPECT_TRUE(std::isnan(detail::sinCosDegrees(std::nan("")).sin));
    EXPECT_TRUE(std::isnan(detail::sinCosDegrees(HUGE_VAL).cos));
}

TEST(RotationQuaternion, ComesBackFromAxes) {
    std::mt19937_64 random(4);
    for (int i = 0; i < 100000; ++i) {
        const Axes axes = detail::axesFromEuler(randomAngles(random), eEulerXYZ);

        const FbxQuaternion quaternion = detail::quaternionFromAxes(axes);

        ASSERT_NEAR(quaternion.Length(), 1.0, kRoundTrip);
        ASSERT_LE(largestDifference(detail::axesFromQuaternion(quaternion), axes), kRoundTrip) << print(axes);
    }
}

TEST(RotationQuaternion, ComesBackFromAllQuarterTurns) {
    for (int x = 0; x < 360; x += 90) {
        for (int y = 0; y < 360; y += 90) {
            for (int z = 0; z < 360; z += 90) {
                const Axes axes = detail::axesFromEuler(FbxVector4(x, y, z), eEulerXYZ);
                const Axes again = detail::axesFromQuaternion(detail::quaternionFromAxes(axes));
                EXPECT_LE(largestDifference(again, axes), kRoundTrip) << print(axes) << print(again);
            }
        }
    }
}

TEST(RotationQuaternion, GivesTheAnglesOfEveryOrder) {
    for (const auto& [order, letters] : kOrders) {
        const FbxVector4 angles(12.0, -34.0, 56.0);
        const FbxVector4 again = detail::eulerFromQuaternion(detail::quaternionFromEuler(angles, order), order);
        for (int j = 0; j < 3; ++j)
            EXPECT_NEAR(again[j], angles[j], 1.0e-12) << letters;
    }
}

TEST(RotationQuaternion, IsTheIdentityWhenZero) {
    const Axes identity = {{{1.0, 0.0, 0.0}, {0.0, 1.0, 0.0}, {0.0, 0.0, 1.0}}};
    EXPECT_EQ(detail::axesFromQuaternion(FbxQuaternion(0.0, 0.0, 0.0, 0.0)), identity);
    EXPECT_EQ(detail::axesFromQuaternion(FbxQuaternion(0.0, 0.0, 0.0, 5.0)), identity);
}

TEST(RotationSlerp, TurnsAtConstantSpeedOnTheShorterWay) {
    const FbxQuaternion none;
    const FbxQuaternion turned = detail::quaternionFromEuler(FbxVector4(0.0, 0.0, 120.0), eEulerXYZ);
    for (const double weight : {0.0, 0.25, 0.5, 1.0}) {
        for (const FbxQuaternion& target : {turned, -turned}) {
            const FbxQuaternion between = detail::slerp(none, target, weight);
            EXPECT_NEAR(between.DecomposeSphericalXYZ()[2], 120.0 * weight, 1.0e-12);
            EXPECT_NEAR(between.Length(), 1.0, kRoundTrip);
        }
    }
}

TEST(RotationSlerp, IsConstantBetweenEqualRotations) {
    const FbxQuaternion q = detail::quaternionFromEuler(FbxVector4(10.0, 20.0, 30.0), eEulerXYZ);
    EXPECT_NEAR((detail::slerp(q, q, 0.3) - q).Length(), 0.0, kRoundTrip);
    EXPECT_NEAR((detail::slerp(q, -q, 0.3) - q).Length(), 0.0, kRoundTrip);
}

} // namespace
