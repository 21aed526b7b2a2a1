// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Vectors, colours and the plain templates below them.
#include <cmath>

#include <gtest/gtest.h>

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxTypes.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>

namespace {

using namespace fbxsdk;

TEST(FbxVectorTemplates, AreZeroAtFirstAndComparedExactly) {
    const FbxDouble3 zero;
    EXPECT_EQ(zero, FbxDouble3(0.0, 0.0, 0.0));
    EXPECT_NE(zero, FbxDouble3(0.0, 0.0, 1.0e-300));
    EXPECT_EQ(FbxDouble2(3.0), FbxDouble2(3.0, 3.0));
    EXPECT_EQ(FbxDouble4x4()[3][3], 0.0);
    static_assert(sizeof(FbxDouble4x4) == 16 * sizeof(double));
}

TEST(FbxVectorTemplates, HandOutTheirElements) {
    FbxDouble4 vector(1.0, 2.0, 3.0, 4.0);
    vector[2] = 7.0;
    EXPECT_EQ(vector.mData[2], 7.0);
    EXPECT_EQ(vector.Buffer()[3], 4.0);
}

TEST(EFbxType, HasTheDocumentedNumbers) {
    EXPECT_EQ(eFbxBool, 9);
    EXPECT_EQ(eFbxDouble, 12);
    EXPECT_EQ(eFbxDouble3, 14);
    EXPECT_EQ(eFbxDouble4x4, 16);
    EXPECT_EQ(eFbxEnum, 17);
    EXPECT_EQ(eFbxEnumM, -17);
    EXPECT_EQ(eFbxString, 18);
    EXPECT_EQ(eFbxTypeCount, 24);
}

TEST(FbxVector2, DoesArithmetic) {
    FbxVector2 v(3.0, 4.0);
    EXPECT_EQ(FbxVector2(), FbxVector2(0.0, 0.0));
    EXPECT_EQ(v.Length(), 5.0);
    EXPECT_EQ(v + v - FbxVector2(1.0, 1.0), FbxVector2(5.0, 7.0));
    EXPECT_EQ(-v * 2.0 / 4.0, FbxVector2(-1.5, -2.0));
    v.Normalize();
    EXPECT_EQ(v, FbxVector2(0.6, 0.8));
    FbxVector2 zero;
    zero.Normalize();
    EXPECT_EQ(zero, FbxVector2());
}

TEST(FbxVector4, IsZeroWithWOneAtFirst) {
    EXPECT_EQ(FbxVector4(), FbxVector4(0.0, 0.0, 0.0, 1.0));
    EXPECT_EQ(FbxVector4(1.0, 2.0, 3.0)[3], 1.0);
    EXPECT_EQ(FbxVector4(FbxDouble3(1.0, 2.0, 3.0)), FbxVector4(1.0, 2.0, 3.0, 1.0));
    const double values[4] = {1.0, 2.0, 3.0, 4.0};
    EXPECT_EQ(FbxVector4(values), FbxVector4(1.0, 2.0, 3.0, 4.0));
}

TEST(FbxVector4, DoesArithmeticOnAllFourComponents) {
    FbxVector4 a(1.0, 2.0, 3.0, 4.0);
    const FbxVector4 b(4.0, 3.0, 2.0, 2.0);
    EXPECT_EQ(a + b, FbxVector4(5.0, 5.0, 5.0, 6.0));
    EXPECT_EQ(a - b, FbxVector4(-3.0, -1.0, 1.0, 2.0));
    EXPECT_EQ(a * b, FbxVector4(4.0, 6.0, 6.0, 8.0));
    EXPECT_EQ(a / b, FbxVector4(0.25, 2.0 / 3.0, 1.5, 2.0));
    EXPECT_EQ(a + 1.0, FbxVector4(2.0, 3.0, 4.0, 5.0));
    EXPECT_EQ(2.0 * a, a * 2.0);
    EXPECT_EQ(a * 2, FbxVector4(2.0, 4.0, 6.0, 8.0));
    EXPECT_EQ(-a, FbxVector4(-1.0, -2.0, -3.0, -4.0));
    a += b;
    a -= b;
    a *= 2.0;
    a /= 2.0;
    EXPECT_EQ(a, FbxVector4(1.0, 2.0, 3.0, 4.0));
}

TEST(FbxVector4, MeasuresXYZOnly) {
    const FbxVector4 v(2.0, 3.0, 6.0, 100.0);
    EXPECT_EQ(v.Length(), 7.0);
    EXPECT_EQ(v.SquareLength(), 49.0);
    EXPECT_EQ(v.DotProduct(FbxVector4(1.0, 1.0, 1.0, 9.0)), 11.0);
    EXPECT_EQ(v.Distance(FbxVector4()), 7.0);
    EXPECT_EQ(FbxVector4(1.0, 0.0, 0.0).CrossProduct(FbxVector4(0.0, 1.0, 0.0)), FbxVector4(0.0, 0.0, 1.0));
}

TEST(FbxVector4, NormalizesXYZOnly) {
    FbxVector4 v(0.0, 3.0, 4.0, 9.0);
    v.Normalize();
    EXPECT_EQ(v, FbxVector4(0.0, 0.6, 0.8, 9.0));
    FbxVector4 zero(0.0, 0.0, 0.0, 2.0);
    zero.Normalize();
    EXPECT_EQ(zero, FbxVector4(0.0, 0.0, 0.0, 2.0));
}

TEST(FbxVector4, ConvertsToAPointerToItsFourDoubles) {
    FbxVector4 v(1.0, 2.0, 3.0, 4.0);
    double* raw = v;
    raw[1] = 20.0;
    v[2] = 30.0;
    EXPECT_EQ(v, FbxVector4(1.0, 20.0, 30.0, 4.0));
}

TEST(FbxColor, IsOpaqueBlackAtFirst) {
    const FbxColor black;
    EXPECT_EQ(black, FbxColor(0.0, 0.0, 0.0, 1.0));
    EXPECT_EQ(FbxColor(FbxDouble3(0.1, 0.2, 0.3)), FbxColor(0.1, 0.2, 0.3, 1.0));
    EXPECT_EQ(FbxColor(FbxDouble4(0.1, 0.2, 0.3, 0.4)), FbxColor(0.1, 0.2, 0.3, 0.4));
}

TEST(FbxColor, ReturnsComponentsByIndex) {
    FbxColor color;
    for (int i = 0; i < 4; ++i)
        color[i] = i;
    EXPECT_EQ(color, FbxColor(0.0, 1.0, 2.0, 3.0));
    EXPECT_EQ(color[99], 3.0);
    EXPECT_EQ(color[-1], 3.0);
}

TEST(FbxColor, IsValidFromZeroToOne) {
    EXPECT_TRUE(FbxColor(0.0, 1.0, 0.5).IsValid());
    EXPECT_FALSE(FbxColor(0.0, 1.5, 0.5).IsValid());
    EXPECT_FALSE(FbxColor(std::nan(""), 0.0, 0.0).IsValid());
}

} // namespace
