// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN

/// A rotation as four numbers: x, y, z are the axis times the sine of half the angle, w its cosine. Rotations have
/// length 1, which is not enforced.
class FBXSDK_DLL FbxQuaternion : public FbxDouble4 {
public:
    constexpr FbxQuaternion() : FbxDouble4(0.0, 0.0, 0.0, 1.0) {} ///< The identity (0, 0, 0, 1).
    /// The numbers in their order.
    constexpr FbxQuaternion(double pX, double pY, double pZ, double pW = 1.0) : FbxDouble4(pX, pY, pZ, pW) {}
    constexpr FbxQuaternion(const FbxDouble4& pValue) : FbxDouble4(pValue) {} ///< The same numbers.
    /// The rotation about an axis of any length, by the right-hand rule; the identity for an axis of length 0.
    FbxQuaternion(const FbxVector4& pAxis, double pDegree);

    using FbxDouble4::operator[];
    operator double*() { return mData; }             ///< The four numbers as an array.
    operator const double*() const { return mData; } ///< The same for reading.

    /// Replaces all four numbers.
    void Set(double pX, double pY, double pZ, double pW = 1.0) { *this = FbxQuaternion(pX, pY, pZ, pW); }

    /// All four negated: the same rotation.
    FbxQuaternion operator-() const { return {-mData[0], -mData[1], -mData[2], -mData[3]}; }
    FbxQuaternion operator+(const FbxQuaternion& pOther) const; ///< Component by component.
    FbxQuaternion operator-(const FbxQuaternion& pOther) const; ///< Component by component.
    FbxQuaternion operator*(double pValue) const;               ///< All four multiplied by the number.
    FbxQuaternion operator/(double pValue) const;               ///< All four divided by it; by 0 infinite or NaN.
    /// The quaternion product: as a rotation, the right one first.
    FbxQuaternion operator*(const FbxQuaternion& pOther) const;
    /// The quaternion product; the argument acts first.
    FbxQuaternion& operator*=(const FbxQuaternion& pOther) { return *this = *this * pOther; }

    /// Exact, in all four; a rotation and its negative differ.
    bool operator==(const FbxQuaternion& pOther) const { return FbxDouble4::operator==(pOther); }
    bool operator!=(const FbxQuaternion& pOther) const { return !(*this == pOther); } ///< The opposite.

    [[nodiscard]] double DotProduct(const FbxQuaternion& pOther) const; ///< The sum of the products of all four.
    [[nodiscard]] double Length() const;                                ///< Of all four; 1 for a rotation.
    /// Normalises to length 1; a quaternion of length 0 becomes the identity.
    void Normalize();
    void Conjugate(); ///< Negates x, y and z: the opposite rotation of a unit quaternion.
    /// The multiplicative inverse; of a quaternion of length 0 the identity.
    void Inverse();
    /// Interpolates from this rotation (weight 0) to the other one (weight 1) on the shorter arc, at constant speed.
    [[nodiscard]] FbxQuaternion Slerp(const FbxQuaternion& pOther, double pWeight) const;

    /// Sets the rotation from Euler XYZ angles in degrees; w of the argument is ignored.
    void ComposeSphericalXYZ(const FbxVector4& pEuler);
    /// Euler XYZ angles in degrees, w = 1.
    [[nodiscard]] FbxVector4 DecomposeSphericalXYZ() const;
};

FBXSDK_NAMESPACE_END
