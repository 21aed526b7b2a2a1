// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Small fixed vectors of plain numbers, the type codes of properties and the numeric constants of the API.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// What a property's value is. The numbers are part of the API.
enum EFbxType : int {
    eFbxUndefined = 0,
    eFbxChar = 1,
    eFbxUChar = 2,
    eFbxShort = 3,
    eFbxUShort = 4,
    eFbxUInt = 5,
    eFbxLongLong = 6,
    eFbxULongLong = 7,
    eFbxHalfFloat = 8,
    eFbxBool = 9,
    eFbxInt = 10,
    eFbxFloat = 11,
    eFbxDouble = 12,
    eFbxDouble2 = 13,
    eFbxDouble3 = 14,
    eFbxDouble4 = 15,
    eFbxDouble4x4 = 16,
    eFbxEnum = 17,
    eFbxEnumM = -17,
    eFbxString = 18,
    eFbxTime = 19,
    eFbxReference = 20,
    eFbxBlob = 21,
    eFbxDistance = 22,
    eFbxDateTime = 23,
    eFbxTypeCount = 24
};

inline constexpr double FBXSDK_TOLERANCE = 1.0e-6;
inline constexpr double FBXSDK_PI = 3.14159265358979323846;
inline constexpr double FBXSDK_PI_DIV_180 = FBXSDK_PI / 180.0;
inline constexpr double FBXSDK_180_DIV_PI = 180.0 / FBXSDK_PI;

/// Two numbers in a row. Zero when made without values; compared exactly.
template <typename T>
class FbxVectorTemplate2 {
public:
    constexpr FbxVectorTemplate2() = default;
    constexpr explicit FbxVectorTemplate2(T pValue) : mData{pValue, pValue} {}
    constexpr FbxVectorTemplate2(T pData0, T pData1) : mData{pData0, pData1} {}

    constexpr T& operator[](int pIndex) { return mData[pIndex]; }
    constexpr const T& operator[](int pIndex) const { return mData[pIndex]; }
    constexpr bool operator==(const FbxVectorTemplate2& pOther) const {
        return mData[0] == pOther.mData[0] && mData[1] == pOther.mData[1];
    }
    constexpr bool operator!=(const FbxVectorTemplate2& pOther) const { return !(*this == pOther); }

    constexpr T* Buffer() { return mData; }
    constexpr const T* Buffer() const { return mData; }

    T mData[2] = {};
};

/// Three numbers in a row. Zero when made without values; compared exactly.
template <typename T>
class FbxVectorTemplate3 {
public:
    constexpr FbxVectorTemplate3() = default;
    constexpr explicit FbxVectorTemplate3(T pValue) : mData{pValue, pValue, pValue} {}
    constexpr FbxVectorTemplate3(T pData0, T pData1, T pData2) : mData{pData0, pData1, pData2} {}

    constexpr T& operator[](int pIndex) { return mData[pIndex]; }
    constexpr const T& operator[](int pIndex) const { return mData[pIndex]; }
    constexpr bool operator==(const FbxVectorTemplate3& pOther) const {
        return mData[0] == pOther.mData[0] && mData[1] == pOther.mData[1] && mData[2] == pOther.mData[2];
    }
    constexpr bool operator!=(const FbxVectorTemplate3& pOther) const { return !(*this == pOther); }

    constexpr T* Buffer() { return mData; }
    constexpr const T* Buffer() const { return mData; }

    T mData[3] = {};
};

/// Four numbers (or rows of numbers) in a row. Zero when made without values; compared exactly.
template <typename T>
class FbxVectorTemplate4 {
public:
    constexpr FbxVectorTemplate4() = default;
    constexpr explicit FbxVectorTemplate4(T pValue) : mData{pValue, pValue, pValue, pValue} {}
    constexpr FbxVectorTemplate4(T pData0, T pData1, T pData2, T pData3) : mData{pData0, pData1, pData2, pData3} {}

    constexpr T& operator[](int pIndex) { return mData[pIndex]; }
    constexpr const T& operator[](int pIndex) const { return mData[pIndex]; }
    constexpr bool operator==(const FbxVectorTemplate4& pOther) const {
        return mData[0] == pOther.mData[0] && mData[1] == pOther.mData[1] && mData[2] == pOther.mData[2] &&
               mData[3] == pOther.mData[3];
    }
    constexpr bool operator!=(const FbxVectorTemplate4& pOther) const { return !(*this == pOther); }

    constexpr T* Buffer() { return mData; }
    constexpr const T* Buffer() const { return mData; }

    T mData[4] = {};
};

typedef FbxVectorTemplate2<FbxDouble> FbxDouble2;
typedef FbxVectorTemplate3<FbxDouble> FbxDouble3;
typedef FbxVectorTemplate4<FbxDouble> FbxDouble4;
typedef FbxVectorTemplate4<FbxDouble4> FbxDouble4x4;

FBXSDK_NAMESPACE_END
