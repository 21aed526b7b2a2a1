// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The affine matrix: its storage, composition and decomposition, products and inverses.
#include <cmath>
#include <limits>
#include <random>
#include <type_traits>

#include <gtest/gtest.h>

#include <fbxsdk/FbxAMatrix.h>

namespace {

using namespace fbxsdk;

constexpr double kTolerance = 1.0e-12;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

void expectNear(const FbxDouble4& actual, const FbxDouble4& expected, double tolerance = kTolerance) {
    for (int i = 0; i < 4; ++i)
        EXPECT_NEAR(actual[i], expected[i], tolerance) << i;
}

void expectNear(const FbxAMatrix& actual, const FbxAMatrix& expected, double tolerance = kTolerance) {
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j < 4; ++j)
            EXPECT_NEAR(actual[i][j], expected[i][j], tolerance) << i << ' ' << j;
}

const FbxVector4 kTranslation(1.0, -2.0, 3.0);
const FbxVector4 kRotation(20.0, -35.0, 110.0);
const FbxVector4 kScale(2.0, 0.5, 3.0);

TEST(FbxAMatrix, IsSixteenContiguousDoubles) {
    static_assert(std::is_standard_layout_v<FbxAMatrix> && std::is_trivially_copyable_v<FbxAMatrix>);
    FbxAMatrix matrix;
    double* raw = matrix;

    for (int i = 0; i < 16; ++i)
        raw[i] = i;

    for (int i = 0; i < 4; ++i) {
        for (int j = 0; j < 4; ++j) {
            EXPECT_EQ(matrix[i][j], 4 * i + j);
            EXPECT_EQ(matrix.Get(i, j), 4 * i + j);
        }
    }
    expectNear(matrix.GetRow(2), FbxDouble4(8.0, 9.0, 10.0, 11.0));
    expectNear(matrix.GetColumn(2), FbxDouble4(2.0, 6.0, 10.0, 14.0));
}

TEST(FbxAMatrix, IsTheIdentityAtFirst) {
    const FbxAMatrix matrix;
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j < 4; ++j)
            EXPECT_EQ(matrix[i][j], i == j ? 1.0 : 0.0);
    EXPECT_TRUE(matrix.IsIdentity());
    for (int j = 0; j < 3; ++j)
        EXPECT_FALSE(std::signbit(matrix.GetR()[j]));
}

TEST(FbxAMatrix, StoresScaledAxesInRowsAndTheTranslationInTheLast) {
    const FbxAMatrix matrix(kTranslation, kRotation, kScale);
    const double cx = std::cos(20.0 * FBXSDK_PI_DIV_180);
    const double sx = std::sin(20.0 * FBXSDK_PI_DIV_180);
    const double cy = std::cos(-35.0 * FBXSDK_PI_DIV_180);
    const double sy = std::sin(-35.0 * FBXSDK_PI_DIV_180);
    const double cz = std::cos(110.0 * FBXSDK_PI_DIV_180);
    const double sz = std::sin(110.0 * FBXSDK_PI_DIV_180);

    expectNear(matrix.GetRow(0), FbxVector4(cy * cz, cy * sz, -sy, 0.0) * 2.0);
    expectNear(matrix.GetRow(1), FbxVector4(sx * sy * cz - cx * sz, sx * sy * sz + cx * cz, sx * cy, 0.0) * 0.5);
    expectNear(matrix.GetRow(2), FbxVector4(cx * sy * cz + sx * sz, cx * sy * sz - sx * cz, cx * cy, 0.0) * 3.0);
    expectNear(matrix.GetRow(3), FbxDouble4(1.0, -2.0, 3.0, 1.0));
}

TEST(FbxAMatrix, TurnsXToYByAQuarterAboutZWithoutNoise) {
    FbxAMatrix matrix;
    matrix.SetR(FbxVector4(0.0, 0.0, 90.0));
    const FbxVector4 y = matrix.MultT(FbxVector4(1.0, 0.0, 0.0));
    EXPECT_EQ(y, FbxVector4(0.0, 1.0, 0.0));
    matrix.SetR(FbxVector4(-90.0, 0.0, 0.0));
    EXPECT_EQ(matrix.MultT(FbxVector4(1.0, 2.0, 3.0)), FbxVector4(1.0, 3.0, -2.0));
}

TEST(FbxAMatrix, AppliesTheRightFactorFirst) {
    const FbxAMatrix a(kTranslation, kRotation, kScale);
    const FbxAMatrix b(FbxVector4(-4.0, 5.0, 0.5), FbxVector4(-80.0, 15.0, 33.0), FbxVector4(1.0, -2.0, 0.25));
    const FbxVector4 point(0.3, -0.7, 11.0);

    expectNear((a * b).MultT(point), a.MultT(b.MultT(point)));

    FbxAMatrix product = a;
    product *= b;
    expectNear(product, a * b, 0.0);
}

TEST(FbxAMatrix, MultipliesAllSixteenElements) {
    FbxAMatrix a;
    FbxAMatrix b;
    for (int i = 0; i < 16; ++i) {
        static_cast<double*>(a)[i] = i + 1;
        static_cast<double*>(b)[i] = 20 - i;
    }

    const FbxAMatrix product = a * b;

    for (int i = 0; i < 4; ++i) {
        for (int j = 0; j < 4; ++j) {
            double expected = 0.0;
            for (int k = 0; k < 4; ++k)
                expected += a[k][j] * b[i][k];
            EXPECT_EQ(product[i][j], expected) << i << ' ' << j;
        }
    }
}

TEST(FbxAMatrix, IsTranslationTimesRotationTimesScale) {
    FbxAMatrix t;
    FbxAMatrix r;
    FbxAMatrix s;
    t.SetT(kTranslation);
    r.SetR(kRotation);
    s.SetS(kScale);

    expectNear(FbxAMatrix(kTranslation, kRotation, kScale), t * r * s);
}

TEST(FbxAMatrix, TransformsPointsWithoutDividingByWAndHandsWOn) {
    FbxAMatrix matrix(kTranslation, FbxVector4(), FbxVector4(1.0, 1.0, 1.0));
    matrix[0][3] = 7.0;
    matrix[3][3] = 5.0;
    expectNear(matrix.MultT(FbxVector4(1.0, 1.0, 1.0, 9.0)), FbxDouble4(2.0, -1.0, 4.0, 9.0));
}

TEST(FbxAMatrix, ReplacesOnlyThePartThatIsSet) {
    FbxAMatrix matrix(kTranslation, kRotation, kScale);

    matrix.SetT(FbxVector4(9.0, 8.0, 7.0));
    expectNear(matrix, FbxAMatrix(FbxVector4(9.0, 8.0, 7.0), kRotation, kScale));
    matrix.SetR(FbxVector4(1.0, 2.0, 3.0));
    expectNear(matrix, FbxAMatrix(FbxVector4(9.0, 8.0, 7.0), FbxVector4(1.0, 2.0, 3.0), kScale));
    matrix.SetS(FbxVector4(4.0, 5.0, 6.0));
    expectNear(matrix, FbxAMatrix(FbxVector4(9.0, 8.0, 7.0), FbxVector4(1.0, 2.0, 3.0), FbxVector4(4.0, 5.0, 6.0)));
}

TEST(FbxAMatrix, IsTheSameSetInPartsAndAtOnce) {
    FbxAMatrix matrix;
    matrix.SetT(kTranslation);
    matrix.SetR(kRotation);
    matrix.SetS(kScale);
    expectNear(matrix, FbxAMatrix(kTranslation, kRotation, kScale));
}

TEST(FbxAMatrix, GivesBackWhatItIsMadeOf) {
    const FbxAMatrix matrix(kTranslation, kRotation, kScale);
    expectNear(matrix.GetT(), FbxDouble4(1.0, -2.0, 3.0, 1.0));
    expectNear(matrix.GetR(), FbxDouble4(20.0, -35.0, 110.0, 1.0));
    expectNear(matrix.GetS(), FbxDouble4(2.0, 0.5, 3.0, 1.0));
}

TEST(FbxAMatrix, IgnoresTheWOfItsParts) {
    const FbxAMatrix matrix(FbxVector4(1.0, 2.0, 3.0, 4.0), FbxVector4(5.0, 6.0, 7.0, 8.0),
                            FbxVector4(1.0, 1.0, 1.0, 0.0));
    expectNear(matrix, FbxAMatrix(FbxVector4(1.0, 2.0, 3.0), FbxVector4(5.0, 6.0, 7.0), FbxVector4(1.0, 1.0, 1.0)));
}

TEST(FbxAMatrix, NegatesAllScalesWhenItMirrors) {
    const FbxAMatrix matrix(kTranslation, kRotation, FbxVector4(-2.0, 0.5, 3.0));
    expectNear(matrix.GetS(), FbxDouble4(-2.0, -0.5, -3.0, 1.0));
    FbxAMatrix again(matrix.GetT(), matrix.GetR(), matrix.GetS());
    expectNear(again, matrix);
}

TEST(FbxAMatrix, GivesPositiveScalesWhenTwoAxesAreMirrored) {
    const FbxAMatrix matrix(kTranslation, kRotation, FbxVector4(-2.0, -0.5, 3.0));
    expectNear(matrix.GetS(), FbxDouble4(2.0, 0.5, 3.0, 1.0));
    expectNear(FbxAMatrix(matrix.GetT(), matrix.GetR(), matrix.GetS()), matrix);
}

TEST(FbxAMatrix, GivesTheTurnToXAtAPitchOf90Degrees) {
    FbxAMatrix matrix;
    matrix.SetR(FbxVector4(20.0, 90.0, 50.0));
    expectNear(matrix.GetR(), FbxDouble4(-30.0, 90.0, 0.0, 1.0));
    matrix.SetR(FbxVector4(20.0, -90.0, 50.0));
    expectNear(matrix.GetR(), FbxDouble4(70.0, -90.0, 0.0, 1.0));
}

TEST(FbxAMatrix, StaysRegularJustBesideAPitchOf90Degrees) {
    FbxAMatrix matrix;
    matrix.SetR(FbxVector4(20.0, 89.999, 50.0));
    expectNear(matrix.GetR(), FbxDouble4(20.0, 89.999, 50.0, 1.0), 1.0e-9);
}

TEST(FbxAMatrix, KeepsTheRotationWhenOneScaleIsZero) {
    for (int axis = 0; axis < 3; ++axis) {
        FbxVector4 scale(1.0, 2.0, 3.0);
        scale[axis] = 0.0;
        const FbxAMatrix matrix(kTranslation, kRotation, scale);

        expectNear(matrix.GetR(), FbxDouble4(20.0, -35.0, 110.0, 1.0));
        expectNear(matrix.GetS(), scale);
    }
}

TEST(FbxAMatrix, KeepsTheRemainingAxisWhenTwoScalesAreZero) {
    for (int axis = 0; axis < 3; ++axis) {
        FbxVector4 scale(0.0, 0.0, 0.0);
        scale[axis] = 4.0;
        const FbxAMatrix matrix(kTranslation, kRotation, scale);

        FbxAMatrix rotation;
        rotation.SetR(matrix.GetR());

        expectNear(rotation.GetRow(axis), matrix.GetRow(axis) / 4.0);
        expectNear(matrix.GetS(), scale);
    }
}

TEST(FbxAMatrix, HasNoRotationWhenAllScalesAreZero) {
    const FbxAMatrix matrix(kTranslation, kRotation, FbxVector4(0.0, 0.0, 0.0));
    expectNear(matrix.GetR(), FbxDouble4(0.0, 0.0, 0.0, 1.0));
    expectNear(matrix.GetS(), FbxDouble4(0.0, 0.0, 0.0, 1.0));
    expectNear(matrix.GetQ(), FbxQuaternion());
}

TEST(FbxAMatrix, CanBeScaledAgainAfterAScaleOfZero) {
    FbxAMatrix matrix(kTranslation, kRotation, FbxVector4(2.0, 0.0, 3.0));
    matrix.SetS(kScale);
    expectNear(matrix, FbxAMatrix(kTranslation, kRotation, kScale));
}

TEST(FbxAMatrix, SurvivesParallelAxesBesideAZeroOne) {
    FbxAMatrix matrix;
    double* raw = matrix;
    for (int i = 0; i < 16; ++i)
        raw[i] = 0.0;
    matrix[0][0] = 1.0;
    matrix[1][0] = 2.0;
    for (int j = 0; j < 3; ++j) {
        EXPECT_TRUE(std::isfinite(matrix.GetR()[j]));
        EXPECT_TRUE(std::isfinite(matrix.GetQ()[j]));
    }
}

TEST(FbxAMatrix, KeepsVerySmallAndVeryLargeScales) {
    for (const double size : {1.0e-200, 1.0e-160, 1.0e160, 1.0e200}) {
        const FbxAMatrix matrix(kTranslation, kRotation, FbxVector4(size, size, size));
        expectNear(matrix.GetR(), FbxDouble4(20.0, -35.0, 110.0, 1.0));
        EXPECT_NEAR(matrix.GetS()[0] / size, 1.0, kTolerance);
        expectNear(matrix * matrix.Inverse(), FbxAMatrix());
    }
}

TEST(FbxAMatrix, ComesBackFromItsPartsForRandomTransforms) {
    std::mt19937_64 random(7);
    std::uniform_real_distribution<double> angle(-360.0, 360.0);
    std::uniform_real_distribution<double> scale(0.1, 10.0);
    for (int i = 0; i < 20000; ++i) {
        const double sign = i % 2 == 0 ? 1.0 : -1.0;
        const FbxAMatrix matrix(FbxVector4(angle(random), angle(random), angle(random)),
                                FbxVector4(angle(random), angle(random), angle(random)),
                                FbxVector4(scale(random), scale(random), sign * scale(random)));
        const FbxAMatrix again(matrix.GetT(), matrix.GetR(), matrix.GetS());
        ASSERT_EQ(again, matrix);
        ASSERT_TRUE((matrix * matrix.Inverse()).IsIdentity(1.0e-11));
    }
}

TEST(FbxAMatrix, IsUndoneByItsInverse) {
    const FbxAMatrix matrix(kTranslation, kRotation, kScale);
    expectNear(matrix * matrix.Inverse(), FbxAMatrix());
    expectNear(matrix.Inverse() * matrix, FbxAMatrix());
    EXPECT_EQ(matrix.Inverse().GetColumn(3), FbxVector4(0.0, 0.0, 0.0, 1.0));
}

TEST(FbxAMatrix, InvertsShear) {
    FbxAMatrix matrix;
    matrix[0][1] = 2.0;
    matrix[2][0] = -0.5;
    matrix[3][1] = 4.0;
    expectNear(matrix * matrix.Inverse(), FbxAMatrix());
}

TEST(FbxAMatrix, HasTheIdentityForItsInverseWhenSingular) {
    EXPECT_TRUE(FbxAMatrix(kTranslation, kRotation, FbxVector4(1.0, 0.0, 1.0)).Inverse().IsIdentity(0.0));
    FbxAMatrix parallel;
    for (int j = 0; j < 3; ++j) {
        parallel[0][j] = 0.1 * (j + 1);
        parallel[1][j] = 0.3 * (j + 1);
    }
    EXPECT_TRUE(parallel.Inverse().IsIdentity(0.0));
    FbxAMatrix broken;
    broken[1][1] = kNaN;
    EXPECT_TRUE(broken.Inverse().IsIdentity(0.0));
    broken[1][1] = HUGE_VAL;
    EXPECT_TRUE(broken.Inverse().IsIdentity(0.0));
}

TEST(FbxAMatrix, TakesScalarsToAllSixteenElements) {
    const FbxAMatrix matrix(kTranslation, kRotation, kScale);
    const FbxAMatrix doubled = matrix * 2.0;
    for (int i = 0; i < 4; ++i) {
        for (int j = 0; j < 4; ++j) {
            EXPECT_EQ(doubled[i][j], 2.0 * matrix[i][j]);
            EXPECT_EQ((-matrix)[i][j], -matrix[i][j]);
            EXPECT_EQ((doubled / 2.0)[i][j], matrix[i][j]);
        }
    }
    FbxAMatrix changed = matrix;
    changed *= 4.0;
    changed /= 2.0;
    EXPECT_EQ(changed, doubled);
}

TEST(FbxAMatrix, EqualsWithinAMillionth) {
    FbxAMatrix matrix;
    matrix[3][0] = 0.9e-6;
    EXPECT_EQ(matrix, FbxAMatrix());
    EXPECT_TRUE(matrix.IsIdentity());
    matrix[3][0] = 1.1e-6;
    EXPECT_NE(matrix, FbxAMatrix());
    EXPECT_FALSE(matrix.IsIdentity());
    EXPECT_TRUE(matrix.IsIdentity(1.0e-5));
    matrix[3][0] = kNaN;
    EXPECT_NE(matrix, matrix);
}

TEST(FbxAMatrix, TransposesAllSixteenElements) {
    const FbxAMatrix matrix(kTranslation, kRotation, kScale);
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j < 4; ++j)
            EXPECT_EQ(matrix.Transpose()[i][j], matrix[j][i]);
}

TEST(FbxAMatrix, KeepsItsOtherPartsWhenAQuaternionIsSet) {
    FbxQuaternion q;
    q.ComposeSphericalXYZ(kRotation);
    FbxAMatrix matrix(kTranslation, FbxVector4(7.0, 8.0, 9.0), kScale);
    matrix.SetQ(q);
    expectNear(matrix, FbxAMatrix(kTranslation, kRotation, kScale));
    FbxAMatrix atOnce;
    atOnce.SetTQS(kTranslation, q, kScale);
    expectNear(atOnce, matrix);
}

TEST(FbxAMatrix, InterpolatesItsParts) {
    const FbxAMatrix from(FbxVector4(0.0, 0.0, 0.0), FbxVector4(), FbxVector4(1.0, 1.0, 1.0));
    const FbxAMatrix to(FbxVector4(2.0, 4.0, 6.0), FbxVector4(0.0, 80.0, 0.0), FbxVector4(3.0, 1.0, 1.0));
    expectNear(from.Slerp(to, 0.5),
               FbxAMatrix(FbxVector4(1.0, 2.0, 3.0), FbxVector4(0.0, 40.0, 0.0), FbxVector4(2.0, 1.0, 1.0)));
}

TEST(FbxAMatrix, AppliesItsRotationToAnglesAndItsScaleToScales) {
    const FbxAMatrix matrix(kTranslation, FbxVector4(0.0, 0.0, 30.0), kScale);
    expectNear(matrix.MultR(FbxVector4(10.0, 0.0, 0.0)), FbxDouble4(10.0, 0.0, 30.0, 1.0));
    expectNear(matrix.MultS(FbxVector4(1.0, 2.0, 3.0)), FbxDouble4(2.0, 1.0, 9.0, 1.0));
}

TEST(FbxAMatrix, TakesTheElementwiseWorkOfHosts) {
    FbxAMatrix sum;
    const FbxAMatrix weighted = FbxAMatrix(kTranslation, kRotation, kScale) * 0.25;
    double* raw = sum;
    for (int i = 0; i < 16; ++i)
        raw[i] = raw[i] * 0.75 + static_cast<const double*>(weighted)[i];
    EXPECT_NEAR(sum[3][3], 1.0, kTolerance);
    expectNear(sum.MultT(FbxVector4(0.0, 0.0, 0.0)), FbxDouble4(0.25, -0.5, 0.75, 1.0));
}

} // namespace
