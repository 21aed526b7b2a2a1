// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The members of FbxVector2, FbxVector4 and FbxColor that are too long for their headers.
#include <cmath>

#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN

double FbxVector2::Length() const { return std::sqrt(SquareLength()); }

void FbxVector2::Normalize() {
    const double length = Length();
    if (length > 0.0)
        *this /= length;
}

FbxVector4 FbxVector4::CrossProduct(const FbxVector4& pVector) const {
    return {mData[1] * pVector.mData[2] - mData[2] * pVector.mData[1],
            mData[2] * pVector.mData[0] - mData[0] * pVector.mData[2],
            mData[0] * pVector.mData[1] - mData[1] * pVector.mData[0]};
}

double FbxVector4::Length() const { return std::sqrt(SquareLength()); }

double FbxVector4::Distance(const FbxVector4& pVector) const { return (*this - pVector).Length(); }

void FbxVector4::Normalize() {
    const double length = Length();
    if (length > 0.0)
        Set(mData[0] / length, mData[1] / length, mData[2] / length, mData[3]);
}

bool FbxColor::IsValid() const {
    const auto displayable = [](double component) { return component >= 0.0 && component <= 1.0; };
    return displayable(mRed) && displayable(mGreen) && displayable(mBlue) && displayable(mAlpha);
}

double& FbxColor::operator[](int pIndex) {
    double* const components[] = {&mRed, &mGreen, &mBlue};
    return pIndex >= 0 && pIndex < 3 ? *components[pIndex] : mAlpha;
}

const double& FbxColor::operator[](int pIndex) const {
    const double* const components[] = {&mRed, &mGreen, &mBlue};
    return pIndex >= 0 && pIndex < 3 ? *components[pIndex] : mAlpha;
}

FBXSDK_NAMESPACE_END
