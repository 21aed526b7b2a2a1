// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A vector of two doubles.
#pragma once

#include <fbxsdk/FbxTypes.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxVector2 : public FbxDouble2 {
public:
    constexpr FbxVector2() = default;
    constexpr FbxVector2(const FbxDouble2& pOther) : FbxDouble2(pOther) {}
    constexpr FbxVector2(double pX, double pY) : FbxDouble2(pX, pY) {}

    void Set(double pX, double pY) { *this = FbxVector2(pX, pY); }

    FbxVector2 operator-() const { return {-mData[0], -mData[1]}; }
    FbxVector2 operator+(const FbxVector2& pVector) const {
        return {mData[0] + pVector.mData[0], mData[1] + pVector.mData[1]};
    }
    FbxVector2 operator-(const FbxVector2& pVector) const {
        return {mData[0] - pVector.mData[0], mData[1] - pVector.mData[1]};
    }
    FbxVector2 operator*(double pValue) const { return {mData[0] * pValue, mData[1] * pValue}; }
    FbxVector2 operator/(double pValue) const { return {mData[0] / pValue, mData[1] / pValue}; }
    FbxVector2& operator+=(const FbxVector2& pVector) { return *this = *this + pVector; }
    FbxVector2& operator-=(const FbxVector2& pVector) { return *this = *this - pVector; }
    FbxVector2& operator*=(double pValue) { return *this = *this * pValue; }
    FbxVector2& operator/=(double pValue) { return *this = *this / pValue; }

    [[nodiscard]] double DotProduct(const FbxVector2& pVector) const {
        return mData[0] * pVector.mData[0] + mData[1] * pVector.mData[1];
    }
    [[nodiscard]] double SquareLength() const { return DotProduct(*this); }
    [[nodiscard]] double Length() const;
    /// To length 1; a vector of length 0 stays as it is.
    void Normalize();
};

FBXSDK_NAMESPACE_END
