// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The general matrix; its inverse by elimination with row pivots.
#include <fbxsdk/FbxMatrix.h>

#include <cmath>
#include <utility>

#include "core/MatrixArithmetic.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

/// The row at or below the diagonal whose element in the column is largest.
int pivotRow(const FbxMatrix& matrix, int column) {
    int best = column;
    for (int row = column + 1; row < 4; ++row)
        if (std::abs(matrix.mData[row][column]) > std::abs(matrix.mData[best][column]))
            best = row;
    return best;
}

void addRow(FbxDouble4& row, const FbxDouble4& other, double factor) {
    for (int j = 0; j < 4; ++j)
        row[j] += other[j] * factor;
}

void divideRow(FbxDouble4& row, double divisor) {
    for (double& element : row.mData)
        element /= divisor;
}

} // namespace

FbxVector4 FbxMatrix::GetColumn(int pX) const { return {mData[0][pX], mData[1][pX], mData[2][pX], mData[3][pX]}; }

void FbxMatrix::SetColumn(int pX, const FbxVector4& pColumn) {
    for (int i = 0; i < 4; ++i)
        mData[i][pX] = pColumn[i];
}

FbxMatrix FbxMatrix::operator*(const FbxMatrix& pOther) const { return detail::product<FbxMatrix>(*this, pOther); }

FbxMatrix FbxMatrix::Inverse() const {
    FbxMatrix rest = *this;
    FbxMatrix inverse;
    for (int column = 0; column < 4; ++column) {
        const int pivot = pivotRow(rest, column);
        const double divisor = rest.mData[pivot][column];
        if (!(std::abs(divisor) > 0.0))
            return {}; // NaN too
        std::swap(rest.mData[pivot], rest.mData[column]);
        std::swap(inverse.mData[pivot], inverse.mData[column]);
        divideRow(rest.mData[column], divisor);
        divideRow(inverse.mData[column], divisor);
        for (int row = 0; row < 4; ++row) {
            const double factor = row == column ? 0.0 : -rest.mData[row][column];
            addRow(rest.mData[row], rest.mData[column], factor);
            addRow(inverse.mData[row], inverse.mData[column], factor);
        }
    }
    return inverse;
}

FbxMatrix FbxMatrix::Transpose() const { return detail::transposed<FbxMatrix>(*this); }

FbxVector4 FbxMatrix::MultNormalize(const FbxVector4& pVector) const {
    const auto component = [&](int j) {
        return pVector[0] * mData[0][j] + pVector[1] * mData[1][j] + pVector[2] * mData[2][j] + mData[3][j];
    };
    const double w = component(3);
    const double divisor = w == 0.0 ? 1.0 : w;
    return {component(0) / divisor, component(1) / divisor, component(2) / divisor, 1.0};
}

bool FbxMatrix::operator==(const FbxMatrix& pOther) const {
    return detail::equalWithin(*this, pOther, FBXSDK_TOLERANCE);
}

FBXSDK_NAMESPACE_END
