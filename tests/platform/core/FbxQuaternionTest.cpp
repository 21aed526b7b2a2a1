// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Quaternion arithmetic.
#include <gtest/gtest.h>

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxQuaternion.h>

namespace {

using namespace fbxsdk;

constexpr double kTolerance = 1.0e-12;

void expectNear(const FbxDouble4& actual, const FbxDouble4& expected) {
    for (int i = 0; i < 4; ++i)
        EXPECT_NEAR(actual[i], expected[i], kTolerance) << i;
}

TEST(FbxQuaternion, IsTheIdentityAtFirst) { expectNear(FbxQuaternion(), FbxDouble4(0.0, 0.0, 0.0, 1.0)); }

TEST(FbxQuaternion, TurnsAboutAnAxisByTheRightHandRule) {
    const FbxQuaternion q(FbxVector4(0.0, 0.0, 5.0), 90.0);
    FbxAMatrix matrix;
    matrix.SetQ(q);
    expectNear(matrix.MultT(FbxVector4(1.0, 0.0, 0.0)), FbxDouble4(0.0, 1.0, 0.0, 1.0));
    expectNear(FbxQuaternion(FbxVector4(0.0, 0.0, 0.0), 90.0), FbxQuaternion());
}

TEST(FbxQuaternion, AppliesTheRightFactorFirst) {
    FbxQuaternion aboutX;
    FbxQuaternion aboutZ;
    aboutX.ComposeSphericalXYZ(FbxVector4(30.0, 0.0, 0.0));
    aboutZ.ComposeSphericalXYZ(FbxVector4(0.0, 0.0, 40.0));

    expectNear((aboutZ * aboutX).DecomposeSphericalXYZ(), FbxDouble4(30.0, 0.0, 40.0, 1.0));
}

TEST(FbxQuaternion, IsUndoneByItsInverse) {
    const FbxQuaternion q(1.0, -2.0, 3.0, 4.0);
    FbxQuaternion inverse = q;
    inverse.Inverse();
    expectNear(q * inverse, FbxQuaternion());
    FbxQuaternion zero(0.0, 0.0, 0.0, 0.0);
    zero.Inverse();
    expectNear(zero, FbxQuaternion());
}

TEST(FbxQuaternion, NormalizesToLengthOne) {
    FbxQuaternion q(1.0, 1.0, 1.0, 1.0);
    q.Normalize();
    expectNear(q, FbxDouble4(0.5, 0.5, 0.5, 0.5));
    FbxQuaternion zero(0.0, 0.0, 0.0, 0.0);
    zero.Normalize();
    expectNear(zero, FbxQuaternion());
}

TEST(FbxQuaternion, ComesBackToItsAngles) {
    FbxQuaternion q;
    q.ComposeSphericalXYZ(FbxVector4(11.0, -22.0, 33.0, 7.0));
    expectNear(q.DecomposeSphericalXYZ(), FbxDouble4(11.0, -22.0, 33.0, 1.0));
    expectNear(FbxQuaternion().Slerp(q, 1.0), q);
}

TEST(FbxQuaternion, DoesArithmeticOnAllComponents) {
    const FbxQuaternion a(1.0, 2.0, 3.0, 4.0);
    expectNear(a + a, FbxDouble4(2.0, 4.0, 6.0, 8.0));
    expectNear(a - FbxQuaternion(1.0, 1.0, 1.0, 1.0), FbxDouble4(0.0, 1.0, 2.0, 3.0));
    expectNear(a * 2.0 / 4.0, FbxDouble4(0.5, 1.0, 1.5, 2.0));
    expectNear(-a, FbxDouble4(-1.0, -2.0, -3.0, -4.0));
    EXPECT_EQ(a.DotProduct(a), 30.0);
}

} // namespace
