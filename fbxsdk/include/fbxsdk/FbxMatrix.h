// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxAMatrix.h>

FBXSDK_NAMESPACE_BEGIN

/// Any four by four matrix, stored and multiplied as FbxAMatrix is.
class FBXSDK_DLL FbxMatrix : public FbxDouble4x4 {
public:
    FbxMatrix() { SetIdentity(); }                                  ///< The identity.
    FbxMatrix(const FbxAMatrix& pMatrix) : FbxDouble4x4(pMatrix) {} ///< The same elements.
    /// Translation, Euler angles in degrees (XYZ) and scale.
    FbxMatrix(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS) { SetTRS(pT, pR, pS); }

    /// Row pY, column pX, 0 to 3 each; not checked.
    [[nodiscard]] double Get(int pY, int pX) const { return mData[pY][pX]; }
    /// Row pY, column pX, 0 to 3 each; not checked.
    void Set(int pY, int pX, double pValue) { mData[pY][pX] = pValue; }
    [[nodiscard]] FbxVector4 GetRow(int pY) const { return mData[pY]; } ///< 0 to 3; not checked.
    void SetRow(int pY, const FbxVector4& pRow) { mData[pY] = pRow; }   ///< 0 to 3; not checked.
    [[nodiscard]] FbxVector4 GetColumn(int pX) const;                   ///< 0 to 3; not checked.
    void SetColumn(int pX, const FbxVector4& pColumn);                  ///< 0 to 3; not checked.

    void SetIdentity() { *this = FbxAMatrix(); } ///< Ones on the diagonal.
    /// Scales first, then rotates by Euler angles in degrees (XYZ), then translates.
    void SetTRS(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS) { *this = FbxAMatrix(pT, pR, pS); }

    /// The right matrix acts first.
    FbxMatrix operator*(const FbxMatrix& pOther) const;
    FbxMatrix& operator*=(const FbxMatrix& pOther) { return *this = *this * pOther; } ///< The argument acts first.

    /// The inverse of the whole matrix; the identity when there is none.
    [[nodiscard]] FbxMatrix Inverse() const;
    [[nodiscard]] FbxMatrix Transpose() const; ///< Rows become columns.
    /// The transformed point, divided by its w; undivided when that is 0.
    [[nodiscard]] FbxVector4 MultNormalize(const FbxVector4& pVector) const;

    /// Equal when no element differs by more than FBXSDK_TOLERANCE.
    bool operator==(const FbxMatrix& pOther) const;
    bool operator!=(const FbxMatrix& pOther) const { return !(*this == pOther); } ///< The opposite.

    operator double*() { return mData[0].mData; }             ///< The sixteen elements, row by row.
    operator const double*() const { return mData[0].mData; } ///< The same for reading.
    using FbxDouble4x4::operator[];
};

FBXSDK_NAMESPACE_END
