// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The affine matrix: composed from translation, rotation and scale, and decomposed, by core/Rotation.h.
#include <fbxsdk/FbxAMatrix.h>

#include <algorithm>
#include <cfloat>
#include <cmath>

#include "core/MatrixArithmetic.h"
#include "core/Rotation.h"

FBXSDK_NAMESPACE_BEGIN
namespace {

using detail::Axes;

/// Rows are normalised to size 1: a determinant no larger than this is rounding noise of a singular matrix.
constexpr double kSingularDeterminant = 16.0 * DBL_EPSILON;

/// Writes axes times scale into the upper left 3×3 part.
template <typename Scale>
void storeAxes(FbxAMatrix& matrix, const Axes& axes, const Scale& scale) {
    for (size_t i = 0; i < 3; ++i)
        for (size_t j = 0; j < 3; ++j)
            matrix.mData[i].mData[j] = axes[i][j] * scale[static_cast<int>(i)];
}

/// The inverse by cofactors; false when there is none.
bool invertUnitRows(const double (&m)[3][3], double (&inverse)[3][3]) {
    for (size_t i = 0; i < 3; ++i) {
        for (size_t j = 0; j < 3; ++j) {
            const size_t r1 = (j + 1) % 3;
            const size_t r2 = (j + 2) % 3;
            const size_t c1 = (i + 1) % 3;
            const size_t c2 = (i + 2) % 3;
            inverse[i][j] = m[r1][c1] * m[r2][c2] - m[r1][c2] * m[r2][c1];
        }
    }
    const double determinant = m[0][0] * inverse[0][0] + m[0][1] * inverse[1][0] + m[0][2] * inverse[2][0];
    if (!(std::abs(determinant) > kSingularDeterminant))
        return false; // NaN too
    for (auto& row : inverse)
        for (double& element : row)
            element /= determinant;
    return true;
}

/// Inverts the upper left 3×3 part. Rows are first brought to size 1 by powers of two, which costs no precision and
/// keeps very small and very large scales within the range of doubles.
bool invertAxes(const FbxAMatrix& matrix, double (&inverse)[3][3]) {
    double rows[3][3];
    int exponents[3];
    for (size_t i = 0; i < 3; ++i) {
        const double* row = matrix.mData[i].mData;
        const double largest = std::max({std::abs(row[0]), std::abs(row[1]), std::abs(row[2])});
        if (!(largest > 0.0) || std::isinf(largest))
            return false;
        exponents[i] = std::ilogb(largest);
        for (size_t j = 0; j < 3; ++j)
            rows[i][j] = std::scalbn(row[j], -exponents[i]);
    }
    if (!invertUnitRows(rows, inverse))
        return false;
    for (auto& row : inverse)
        for (size_t j = 0; j < 3; ++j)
            row[j] = std::scalbn(row[j], -exponents[j]);
    return true;
}

} // namespace

FbxVector4 FbxAMatrix::GetColumn(int pX) const { return {mData[0][pX], mData[1][pX], mData[2][pX], mData[3][pX]}; }

FbxVector4 FbxAMatrix::GetT() const { return {mData[3][0], mData[3][1], mData[3][2]}; }

FbxVector4 FbxAMatrix::GetR() const { return detail::eulerFromMatrix(*this, FbxEuler::eOrderXYZ); }

FbxVector4 FbxAMatrix::GetS() const {
    const auto scale = detail::decompose(*this).scale;
    return {scale[0], scale[1], scale[2]};
}

FbxQuaternion FbxAMatrix::GetQ() const { return detail::quaternionFromAxes(detail::decompose(*this).axes); }

void FbxAMatrix::SetIdentity() {
    for (int i = 0; i < 4; ++i)
        for (int j = 0; j < 4; ++j)
            mData[i][j] = i == j ? 1.0 : 0.0;
}

void FbxAMatrix::SetT(const FbxVector4& pT) {
    for (int j = 0; j < 3; ++j)
        mData[3][j] = pT[j];
}

void FbxAMatrix::SetR(const FbxVector4& pR) {
    storeAxes(*this, detail::axesFromEuler(pR, FbxEuler::eOrderXYZ), GetS());
}

void FbxAMatrix::SetQ(const FbxQuaternion& pQ) { storeAxes(*this, detail::axesFromQuaternion(pQ), GetS()); }

void FbxAMatrix::SetS(const FbxVector4& pS) { storeAxes(*this, detail::decompose(*this).axes, pS); }

void FbxAMatrix::SetTRS(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS) {
    SetIdentity();
    SetT(pT);
    storeAxes(*this, detail::axesFromEuler(pR, FbxEuler::eOrderXYZ), pS);
}

void FbxAMatrix::SetTQS(const FbxVector4& pT, const FbxQuaternion& pQ, const FbxVector4& pS) {
    SetIdentity();
    SetT(pT);
    storeAxes(*this, detail::axesFromQuaternion(pQ), pS);
}

FbxVector4 FbxAMatrix::MultT(const FbxVector4& pVector) const {
    const auto component = [&](int j) {
        return pVector[0] * mData[0][j] + pVector[1] * mData[1][j] + pVector[2] * mData[2][j] + mData[3][j];
    };
    return {component(0), component(1), component(2), pVector[3]};
}

FbxVector4 FbxAMatrix::MultR(const FbxVector4& pVector) const {
    const FbxAMatrix rotation = detail::rotationMatrix(detail::decompose(*this).axes);
    return (rotation * FbxAMatrix(FbxVector4(), pVector, FbxVector4(1.0, 1.0, 1.0))).GetR();
}

FbxVector4 FbxAMatrix::MultS(const FbxVector4& pVector) const {
    const FbxVector4 scale = GetS();
    return {pVector[0] * scale[0], pVector[1] * scale[1], pVector[2] * scale[2], pVector[3]};
}

FbxAMatrix FbxAMatrix::operator*(const FbxAMatrix& pOther) const { return detail::product<FbxAMatrix>(*this, pOther); }

FbxAMatrix FbxAMatrix::operator*(double pValue) const {
    FbxAMatrix result = *this;
    for (FbxDouble4& row : result.mData)
        for (double& element : row.mData)
            element *= pValue;
    return result;
}

FbxAMatrix FbxAMatrix::operator/(double pValue) const {
    FbxAMatrix result = *this;
    for (FbxDouble4& row : result.mData)
        for (double& element : row.mData)
            element /= pValue;
    return result;
}

FbxAMatrix FbxAMatrix::Inverse() const {
    double axes[3][3];
    FbxAMatrix inverse;
    if (!invertAxes(*this, axes))
        return inverse;
    const FbxDouble4& t = mData[3];
    for (int j = 0; j < 3; ++j) {
        for (int i = 0; i < 3; ++i)
            inverse.mData[i][j] = axes[i][j];
        inverse.mData[3][j] = 0.0 - (t[0] * axes[0][j] + t[1] * axes[1][j] + t[2] * axes[2][j]);
    }
    return inverse;
}

FbxAMatrix FbxAMatrix::Transpose() const { return detail::transposed<FbxAMatrix>(*this); }

FbxAMatrix FbxAMatrix::Slerp(const FbxAMatrix& pOther, double pWeight) const {
    const auto between = [pWeight](const FbxVector4& a, const FbxVector4& b) {
        return a * (1.0 - pWeight) + b * pWeight;
    };
    FbxAMatrix result;
    result.SetTQS(between(GetT(), pOther.GetT()), detail::slerp(GetQ(), pOther.GetQ(), pWeight),
                  between(GetS(), pOther.GetS()));
    return result;
}

bool FbxAMatrix::operator==(const FbxAMatrix& pOther) const {
    return detail::equalWithin(*this, pOther, FBXSDK_TOLERANCE);
}

bool FbxAMatrix::IsIdentity(const double pThreshold) const {
    return detail::equalWithin(*this, FbxAMatrix(), pThreshold);
}

FBXSDK_NAMESPACE_END
