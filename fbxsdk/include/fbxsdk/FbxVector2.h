// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxTypes.h>

FBXSDK_NAMESPACE_BEGIN

/// A point or direction in a plane; texture coordinates.
class FBXSDK_DLL FbxVector2 : public FbxDouble2 {
public:
    constexpr FbxVector2() = default;                                      ///< Zeros.
    constexpr FbxVector2(const FbxDouble2& pOther) : FbxDouble2(pOther) {} ///< The same numbers.
    constexpr FbxVector2(double pX, double pY) : FbxDouble2(pX, pY) {}     ///< The numbers in their order.

    void Set(double pX, double pY) { *this = FbxVector2(pX, pY); } ///< Replaces both numbers.

    FbxVector2 operator-() const { return {-mData[0], -mData[1]}; } ///< The opposite direction.
    /// Component by component.
    FbxVector2 operator+(const FbxVector2& pVector) const {
        return {mData[0] + pVector.mData[0], mData[1] + pVector.mData[1]};
    }
    /// Component by component.
    FbxVector2 operator-(const FbxVector2& pVector) const {
        return {mData[0] - pVector.mData[0], mData[1] - pVector.mData[1]};
    }
    /// Multiplied by the number.
    FbxVector2 operator*(double pValue) const { return {mData[0] * pValue, mData[1] * pValue}; }
    /// Divided by the number; by 0 infinite or NaN.
    FbxVector2 operator/(double pValue) const { return {mData[0] / pValue, mData[1] / pValue}; }
    FbxVector2& operator+=(const FbxVector2& pVector) { return *this = *this + pVector; } ///< Component by component.
    FbxVector2& operator-=(const FbxVector2& pVector) { return *this = *this - pVector; } ///< Component by component.
    FbxVector2& operator*=(double pValue) { return *this = *this * pValue; }              ///< Multiplied by the number.
    FbxVector2& operator/=(double pValue) { return *this = *this / pValue; }              ///< Divided by the number.

    /// The sum of the products of the components.
    [[nodiscard]] double DotProduct(const FbxVector2& pVector) const {
        return mData[0] * pVector.mData[0] + mData[1] * pVector.mData[1];
    }
    /// The square of the length, which needs no square root.
    [[nodiscard]] double SquareLength() const { return DotProduct(*this); }
    [[nodiscard]] double Length() const; ///< Never negative.
    /// Normalises to length 1; a vector of length 0 is unchanged.
    void Normalize();
};

FBXSDK_NAMESPACE_END
