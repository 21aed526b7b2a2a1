// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The common part of FbxAMatrix and FbxMatrix: element-wise operations on the sixteen doubles.
#pragma once

#include <cmath>

#include <fbxsdk/FbxTypes.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// a after b: in storage terms (a*b)[i][j] is the sum over k of a[k][j] * b[i][k].
template <typename Matrix>
[[nodiscard]] Matrix product(const FbxDouble4x4& a, const FbxDouble4x4& b) {
    Matrix result;
    for (int i = 0; i < 4; ++i) {
        for (int j = 0; j < 4; ++j) {
            result.mData[i][j] = a.mData[0][j] * b.mData[i][0] + a.mData[1][j] * b.mData[i][1] +
                                 a.mData[2][j] * b.mData[i][2] + a.mData[3][j] * b.mData[i][3];
        }
    }
    return result;
}

template <typename Matrix>
[[nodiscard]] Matrix transposed(const FbxDouble4x4& matrix) {
    Matrix result;
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j < 4; ++j)
            result.mData[i][j] = matrix.mData[j][i];
    return result;
}

/// False as soon as an element differs by more than the threshold, or is NaN.
[[nodiscard]] inline bool equalWithin(const FbxDouble4x4& a, const FbxDouble4x4& b, double threshold) {
    for (int i = 0; i < 4; ++i) {
        for (int j = 0; j < 4; ++j) {
            const double left = a.mData[i][j];
            const double right = b.mData[i][j];
            if (left != right && !(std::abs(left - right) <= threshold))
                return false;
        }
    }
    return true;
}

} // namespace detail
FBXSDK_NAMESPACE_END
