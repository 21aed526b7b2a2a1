// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Quaternion arithmetic; the conversions are those of core/Rotation.h.
#include <fbxsdk/FbxQuaternion.h>

#include <cmath>

#include "core/Rotation.h"

FBXSDK_NAMESPACE_BEGIN

FbxQuaternion::FbxQuaternion(const FbxVector4& pAxis, double pDegree) : FbxQuaternion() {
    FbxVector4 axis = pAxis;
    axis.Normalize();
    if (axis.SquareLength() > 0.0) {
        const auto [sine, cosine] = detail::sinCosDegrees(pDegree / 2.0);
        Set(axis[0] * sine, axis[1] * sine, axis[2] * sine, cosine);
    }
}

FbxQuaternion FbxQuaternion::operator+(const FbxQuaternion& pOther) const {
    return {mData[0] + pOther.mData[0], mData[1] + pOther.mData[1], mData[2] + pOther.mData[2],
            mData[3] + pOther.mData[3]};
}

FbxQuaternion FbxQuaternion::operator-(const FbxQuaternion& pOther) const { return *this + -pOther; }

FbxQuaternion FbxQuaternion::operator*(double pValue) const {
    return {mData[0] * pValue, mData[1] * pValue, mData[2] * pValue, mData[3] * pValue};
}

FbxQuaternion FbxQuaternion::operator/(double pValue) const {
    return {mData[0] / pValue, mData[1] / pValue, mData[2] / pValue, mData[3] / pValue};
}

FbxQuaternion FbxQuaternion::operator*(const FbxQuaternion& pOther) const {
    const auto& [ax, ay, az, aw] = mData;
    const auto& [bx, by, bz, bw] = pOther.mData;
    return {aw * bx + ax * bw + ay * bz - az * by, aw * by - ax * bz + ay * bw + az * bx,
            aw * bz + ax * by - ay * bx + az * bw, aw * bw - ax * bx - ay * by - az * bz};
}

double FbxQuaternion::DotProduct(const FbxQuaternion& pOther) const {
    return mData[0] * pOther.mData[0] + mData[1] * pOther.mData[1] + mData[2] * pOther.mData[2] +
           mData[3] * pOther.mData[3];
}

double FbxQuaternion::Length() const { return std::sqrt(DotProduct(*this)); }

void FbxQuaternion::Normalize() {
    const double length = Length();
    *this = length > 0.0 ? *this / length : FbxQuaternion();
}

void FbxQuaternion::Conjugate() { Set(-mData[0], -mData[1], -mData[2], mData[3]); }

void FbxQuaternion::Inverse() {
    const double square = DotProduct(*this);
    Conjugate();
    *this = square > 0.0 ? *this / square : FbxQuaternion();
}

FbxQuaternion FbxQuaternion::Slerp(const FbxQuaternion& pOther, double pWeight) const {
    return detail::slerp(*this, pOther, pWeight);
}

void FbxQuaternion::ComposeSphericalXYZ(const FbxVector4& pEuler) {
    *this = detail::quaternionFromEuler(pEuler, FbxEuler::eOrderXYZ);
}

FbxVector4 FbxQuaternion::DecomposeSphericalXYZ() const {
    return detail::eulerFromQuaternion(*this, FbxEuler::eOrderXYZ);
}

FBXSDK_NAMESPACE_END
