// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A quaternion x, y, z, w. A rotation is one of length 1.
#pragma once

#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN

class FBXSDK_DLL FbxQuaternion : public FbxDouble4 {
public:
    constexpr FbxQuaternion() : FbxDouble4(0.0, 0.0, 0.0, 1.0) {}
    constexpr FbxQuaternion(double pX, double pY, double pZ, double pW = 1.0) : FbxDouble4(pX, pY, pZ, pW) {}
    constexpr FbxQuaternion(const FbxDouble4& pValue) : FbxDouble4(pValue) {}
    /// The rotation about an axis of any length, by the right-hand rule; the identity for an axis of length 0.
    FbxQuaternion(const FbxVector4& pAxis, double pDegree);

    using FbxDouble4::operator[];
    operator double*() { return mData; }
    operator const double*() const { return mData; }

    void Set(double pX, double pY, double pZ, double pW = 1.0) { *this = FbxQuaternion(pX, pY, pZ, pW); }

    FbxQuaternion operator-() const { return {-mData[0], -mData[1], -mData[2], -mData[3]}; }
    FbxQuaternion operator+(const FbxQuaternion& pOther) const;
    FbxQuaternion operator-(const FbxQuaternion& pOther) const;
    FbxQuaternion operator*(double pValue) const;
    FbxQuaternion operator/(double pValue) const;
    /// The quaternion product: as a rotation, the right one first.
    FbxQuaternion operator*(const FbxQuaternion& pOther) const;
    FbxQuaternion& operator*=(const FbxQuaternion& pOther) { return *this = *this * pOther; }

    bool operator==(const FbxQuaternion& pOther) const { return FbxDouble4::operator==(pOther); }
    bool operator!=(const FbxQuaternion& pOther) const { return !(*this == pOther); }

    [[nodiscard]] double DotProduct(const FbxQuaternion& pOther) const;
    [[nodiscard]] double Length() const;
    /// To length 1; a quaternion of length 0 becomes the identity.
    void Normalize();
    void Conjugate();
    /// The multiplicative inverse; of a quaternion of length 0 the identity.
    void Inverse();
    /// From this rotation (weight 0) to the other one (weight 1) on the shorter way, at constant speed.
    [[nodiscard]] FbxQuaternion Slerp(const FbxQuaternion& pOther, double pWeight) const;

    /// Sets the rotation from Euler XYZ angles in degrees; w of the argument is ignored.
    void ComposeSphericalXYZ(const FbxVector4& pEuler);
    /// Euler XYZ angles in degrees, w = 1.
    [[nodiscard]] FbxVector4 DecomposeSphericalXYZ() const;
};

FBXSDK_NAMESPACE_END
