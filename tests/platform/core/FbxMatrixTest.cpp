// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The general matrix.
#include <random>

#include <gtest/gtest.h>

#include <fbxsdk/FbxMatrix.h>

namespace {

using namespace fbxsdk;

TEST(FbxMatrix, TakesOverAnAffineMatrix) {
    const FbxAMatrix affine(FbxVector4(1.0, 2.0, 3.0), FbxVector4(10.0, 20.0, 30.0), FbxVector4(2.0, 2.0, 2.0));
    const FbxMatrix matrix(affine);
    for (int i = 0; i < 16; ++i)
        EXPECT_EQ(static_cast<const double*>(matrix)[i], static_cast<const double*>(affine)[i]);
}

TEST(FbxMatrix, IsUndoneByItsInverse) {
    std::mt19937_64 random(5);
    std::uniform_real_distribution<double> element(-1.0, 1.0);
    for (int n = 0; n < 1000; ++n) {
        FbxMatrix matrix;
        for (int i = 0; i < 4; ++i)
            matrix.SetRow(i, FbxVector4(element(random), element(random), element(random), element(random)));
        EXPECT_EQ(matrix * matrix.Inverse(), FbxMatrix());
    }
}

TEST(FbxMatrix, HasTheIdentityForItsInverseWhenSingular) {
    FbxMatrix matrix;
    matrix.Set(2, 2, 0.0);
    EXPECT_EQ(matrix.Inverse(), FbxMatrix());
}

TEST(FbxMatrix, DividesPointsByTheirW) {
    FbxMatrix matrix;
    matrix.Set(3, 3, 2.0);
    EXPECT_EQ(matrix.MultNormalize(FbxVector4(2.0, 4.0, 6.0)), FbxVector4(1.0, 2.0, 3.0));
    matrix.Set(3, 3, 0.0);
    EXPECT_EQ(matrix.MultNormalize(FbxVector4(2.0, 4.0, 6.0)), FbxVector4(2.0, 4.0, 6.0));
}

TEST(FbxMatrix, ReturnsRowsAndColumns) {
    FbxMatrix matrix;
    matrix.SetColumn(1, FbxVector4(1.0, 2.0, 3.0, 4.0));
    EXPECT_EQ(matrix.GetColumn(1), FbxVector4(1.0, 2.0, 3.0, 4.0));
    EXPECT_EQ(matrix.GetRow(3), FbxVector4(0.0, 4.0, 0.0, 1.0));
    EXPECT_EQ(matrix.Transpose().GetRow(1), FbxVector4(1.0, 2.0, 3.0, 4.0));
}

} // namespace
