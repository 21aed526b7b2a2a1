// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxTypes.h>

FBXSDK_NAMESPACE_BEGIN

/// A point, direction, set of angles or scale, with a fourth number that is 1 unless said otherwise.
///
/// Arithmetic works on all four components; lengths and products with a geometric meaning on x, y, z.
class FBXSDK_DLL FbxVector4 : public FbxDouble4 {
public:
    constexpr FbxVector4() : FbxDouble4(0.0, 0.0, 0.0, 1.0) {} ///< (0, 0, 0, 1).
    /// The numbers in their order.
    constexpr FbxVector4(const double pX, const double pY, const double pZ, const double pW = 1.0)
        : FbxDouble4(pX, pY, pZ, pW) {}
    /// Four numbers of an array.
    constexpr FbxVector4(const double pValue[4]) : FbxDouble4(pValue[0], pValue[1], pValue[2], pValue[3]) {}
    /// Three numbers and 1.
    constexpr FbxVector4(const FbxDouble3& pValue) : FbxDouble4(pValue[0], pValue[1], pValue[2], 1.0) {}
    constexpr FbxVector4(const FbxDouble4& pValue) : FbxDouble4(pValue) {} ///< The same numbers.

    /// Replaces all four numbers.
    void Set(const double pX, const double pY, const double pZ, const double pW = 1.0) {
        *this = FbxVector4(pX, pY, pZ, pW);
    }

    using FbxDouble4::operator[];
    operator double*() { return mData; }             ///< The four numbers as an array.
    operator const double*() const { return mData; } ///< The same for reading.

    /// Exact, in all four.
    bool operator==(const FbxVector4& pVector) const { return FbxDouble4::operator==(pVector); }
    bool operator!=(const FbxVector4& pVector) const { return !(*this == pVector); } ///< The opposite.

    FbxVector4 operator-() const { return {-mData[0], -mData[1], -mData[2], -mData[3]}; } ///< All four negated.
    /// Added to all four.
    FbxVector4 operator+(double pValue) const { return *this + FbxVector4(pValue, pValue, pValue, pValue); }
    /// Subtracted from all four.
    FbxVector4 operator-(double pValue) const { return *this - FbxVector4(pValue, pValue, pValue, pValue); }
    /// All four multiplied by the number.
    FbxVector4 operator*(double pValue) const { return *this * FbxVector4(pValue, pValue, pValue, pValue); }
    /// All four divided by it; by 0 infinite or NaN.
    FbxVector4 operator/(double pValue) const { return *this / FbxVector4(pValue, pValue, pValue, pValue); }
    /// Component by component, all four.
    FbxVector4 operator+(const FbxVector4& pVector) const {
        return {mData[0] + pVector.mData[0], mData[1] + pVector.mData[1], mData[2] + pVector.mData[2],
                mData[3] + pVector.mData[3]};
    }
    /// Component by component, all four.
    FbxVector4 operator-(const FbxVector4& pVector) const {
        return {mData[0] - pVector.mData[0], mData[1] - pVector.mData[1], mData[2] - pVector.mData[2],
                mData[3] - pVector.mData[3]};
    }
    /// Component by component, all four.
    FbxVector4 operator*(const FbxVector4& pVector) const {
        return {mData[0] * pVector.mData[0], mData[1] * pVector.mData[1], mData[2] * pVector.mData[2],
                mData[3] * pVector.mData[3]};
    }
    /// Component by component, all four.
    FbxVector4 operator/(const FbxVector4& pVector) const {
        return {mData[0] / pVector.mData[0], mData[1] / pVector.mData[1], mData[2] / pVector.mData[2],
                mData[3] / pVector.mData[3]};
    }
    FbxVector4& operator+=(double pValue) { return *this = *this + pValue; } ///< Added to all four.
    FbxVector4& operator-=(double pValue) { return *this = *this - pValue; } ///< Subtracted from all four.
    FbxVector4& operator*=(double pValue) { return *this = *this * pValue; } ///< All four multiplied by the number.
    FbxVector4& operator/=(double pValue) { return *this = *this / pValue; } ///< All four divided by it.
    /// Component by component, all four.
    FbxVector4& operator+=(const FbxVector4& pVector) { return *this = *this + pVector; }
    /// Component by component, all four.
    FbxVector4& operator-=(const FbxVector4& pVector) { return *this = *this - pVector; }
    /// Component by component, all four.
    FbxVector4& operator*=(const FbxVector4& pVector) { return *this = *this * pVector; }
    /// Component by component, all four.
    FbxVector4& operator/=(const FbxVector4& pVector) { return *this = *this / pVector; }

    /// The sum of the products of x, y and z.
    [[nodiscard]] double DotProduct(const FbxVector4& pVector) const {
        return mData[0] * pVector.mData[0] + mData[1] * pVector.mData[1] + mData[2] * pVector.mData[2];
    }
    /// Perpendicular to both by the right-hand rule; w is 1.
    [[nodiscard]] FbxVector4 CrossProduct(const FbxVector4& pVector) const;
    [[nodiscard]] double SquareLength() const { return DotProduct(*this); } ///< The square of the length of x, y, z.
    [[nodiscard]] double Length() const;                                    ///< Of x, y, z; never negative.
    [[nodiscard]] double Distance(const FbxVector4& pVector) const;         ///< Between both as points x, y, z.
    /// Normalises x, y, z to length 1, w untouched; a vector of length 0 is unchanged.
    void Normalize();
};

/// All four multiplied by the number.
inline FbxVector4 operator*(double pValue, const FbxVector4& pVector) { return pVector * pValue; }

FBXSDK_NAMESPACE_END
