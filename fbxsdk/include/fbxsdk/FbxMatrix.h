// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A general 4×4 matrix, stored as FbxAMatrix is.
#pragma once

#include <fbxsdk/FbxAMatrix.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxMatrix : public FbxDouble4x4 {
public:
    FbxMatrix() { SetIdentity(); }
    FbxMatrix(const FbxAMatrix& pMatrix) : FbxDouble4x4(pMatrix) {}
    FbxMatrix(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS) { SetTRS(pT, pR, pS); }

    [[nodiscard]] double Get(int pY, int pX) const { return mData[pY][pX]; }
    void Set(int pY, int pX, double pValue) { mData[pY][pX] = pValue; }
    [[nodiscard]] FbxVector4 GetRow(int pY) const { return mData[pY]; }
    void SetRow(int pY, const FbxVector4& pRow) { mData[pY] = pRow; }
    [[nodiscard]] FbxVector4 GetColumn(int pX) const;
    void SetColumn(int pX, const FbxVector4& pColumn);

    void SetIdentity() { *this = FbxAMatrix(); }
    void SetTRS(const FbxVector4& pT, const FbxVector4& pR, const FbxVector4& pS) { *this = FbxAMatrix(pT, pR, pS); }

    /// The right matrix acts first.
    FbxMatrix operator*(const FbxMatrix& pOther) const;
    FbxMatrix& operator*=(const FbxMatrix& pOther) { return *this = *this * pOther; }

    /// The inverse of the whole matrix; the identity when there is none.
    [[nodiscard]] FbxMatrix Inverse() const;
    [[nodiscard]] FbxMatrix Transpose() const;
    /// The transformed point, divided by its w; undivided when that is 0.
    [[nodiscard]] FbxVector4 MultNormalize(const FbxVector4& pVector) const;

    /// Equal when no element differs by more than FBXSDK_TOLERANCE.
    bool operator==(const FbxMatrix& pOther) const;
    bool operator!=(const FbxMatrix& pOther) const { return !(*this == pOther); }

    operator double*() { return mData[0].mData; }
    operator const double*() const { return mData[0].mData; }
    using FbxDouble4x4::operator[];
};

FBXSDK_NAMESPACE_END
