// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Small fixed vectors of plain numbers, the type codes of properties and the numeric constants of the API.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN

/// What a property's value is. The numbers are part of the API.
enum EFbxType : int {
    eFbxUndefined = 0,  ///< nothing; also of compounds
    eFbxChar = 1,       ///< FbxChar
    eFbxUChar = 2,      ///< FbxUChar
    eFbxShort = 3,      ///< FbxShort
    eFbxUShort = 4,     ///< FbxUShort
    eFbxUInt = 5,       ///< FbxUInt
    eFbxLongLong = 6,   ///< FbxLongLong
    eFbxULongLong = 7,  ///< FbxULongLong
    eFbxHalfFloat = 8,  ///< half precision; kept in single precision here
    eFbxBool = 9,       ///< FbxBool
    eFbxInt = 10,       ///< FbxInt
    eFbxFloat = 11,     ///< FbxFloat
    eFbxDouble = 12,    ///< FbxDouble
    eFbxDouble2 = 13,   ///< FbxDouble2
    eFbxDouble3 = 14,   ///< FbxDouble3, also colours, translations, rotations and scalings
    eFbxDouble4 = 15,   ///< FbxDouble4, also colours with alpha and quaternions
    eFbxDouble4x4 = 16, ///< FbxDouble4x4; no property here holds one
    eFbxEnum = 17,      ///< FbxEnum
    eFbxEnumM = -17,    ///< an enumeration of single-use values; the same as eFbxEnum here
    eFbxString = 18,    ///< FbxString
    eFbxTime = 19,      ///< FbxTime
    eFbxReference = 20, ///< an object, held by a connection
    eFbxBlob = 21,      ///< bytes without a meaning to the platform
    eFbxDistance = 22,  ///< a length with a unit of its own
    eFbxDateTime = 23,  ///< a date, as text
    eFbxTypeCount = 24  ///< how many types there are; none itself
};

inline constexpr double FBXSDK_TOLERANCE = 1.0e-6;             ///< The tolerance within which matrices are equal.
inline constexpr double FBXSDK_PI = 3.14159265358979323846;    ///< π.
inline constexpr double FBXSDK_PI_DIV_180 = FBXSDK_PI / 180.0; ///< Radians per degree.
inline constexpr double FBXSDK_180_DIV_PI = 180.0 / FBXSDK_PI; ///< Degrees per radian.

/// Two consecutive numbers. Zero by default; compared exactly.
template <typename T>
class FbxVectorTemplate2 {
public:
    constexpr FbxVectorTemplate2() = default;                                   ///< Zeros.
    constexpr explicit FbxVectorTemplate2(T pValue) : mData{pValue, pValue} {}  ///< That value twice.
    constexpr FbxVectorTemplate2(T pData0, T pData1) : mData{pData0, pData1} {} ///< The values in their order.

    constexpr T& operator[](int pIndex) { return mData[pIndex]; } ///< The index is 0 or 1; it is not checked.
    constexpr const T& operator[](int pIndex) const { return mData[pIndex]; } ///< The same for reading.
    /// Exact: 0 and -0 are equal, NaN is not.
    constexpr bool operator==(const FbxVectorTemplate2& pOther) const {
        return mData[0] == pOther.mData[0] && mData[1] == pOther.mData[1];
    }
    constexpr bool operator!=(const FbxVectorTemplate2& pOther) const { return !(*this == pOther); } ///< The opposite.

    constexpr T* Buffer() { return mData; }             ///< The numbers as an array.
    constexpr const T* Buffer() const { return mData; } ///< The same for reading.

    T mData[2] = {}; ///< the numbers
};

/// Three consecutive numbers. Zero by default; compared exactly.
template <typename T>
class FbxVectorTemplate3 {
public:
    constexpr FbxVectorTemplate3() = default;                                          ///< Zeros.
    constexpr explicit FbxVectorTemplate3(T pValue) : mData{pValue, pValue, pValue} {} ///< That value three times.
    /// The values in their order.
    constexpr FbxVectorTemplate3(T pData0, T pData1, T pData2) : mData{pData0, pData1, pData2} {}

    constexpr T& operator[](int pIndex) { return mData[pIndex]; } ///< The index is 0 to 2; it is not checked.
    constexpr const T& operator[](int pIndex) const { return mData[pIndex]; } ///< The same for reading.
    /// Exact: 0 and -0 are equal, NaN is not.
    constexpr bool operator==(const FbxVectorTemplate3& pOther) const {
        return mData[0] == pOther.mData[0] && mData[1] == pOther.mData[1] && mData[2] == pOther.mData[2];
    }
    constexpr bool operator!=(const FbxVectorTemplate3& pOther) const { return !(*this == pOther); } ///< The opposite.

    constexpr T* Buffer() { return mData; }             ///< The numbers as an array.
    constexpr const T* Buffer() const { return mData; } ///< The same for reading.

    T mData[3] = {}; ///< the numbers
};

/// Four consecutive numbers (or rows of numbers). Zero by default; compared exactly.
template <typename T>
class FbxVectorTemplate4 {
public:
    constexpr FbxVectorTemplate4() = default; ///< Zeros.
    /// That value four times.
    constexpr explicit FbxVectorTemplate4(T pValue) : mData{pValue, pValue, pValue, pValue} {}
    /// The values in their order.
    constexpr FbxVectorTemplate4(T pData0, T pData1, T pData2, T pData3) : mData{pData0, pData1, pData2, pData3} {}

    constexpr T& operator[](int pIndex) { return mData[pIndex]; } ///< The index is 0 to 3; it is not checked.
    constexpr const T& operator[](int pIndex) const { return mData[pIndex]; } ///< The same for reading.
    /// Exact: 0 and -0 are equal, NaN is not.
    constexpr bool operator==(const FbxVectorTemplate4& pOther) const {
        return mData[0] == pOther.mData[0] && mData[1] == pOther.mData[1] && mData[2] == pOther.mData[2] &&
               mData[3] == pOther.mData[3];
    }
    constexpr bool operator!=(const FbxVectorTemplate4& pOther) const { return !(*this == pOther); } ///< The opposite.

    constexpr T* Buffer() { return mData; }             ///< The numbers as an array.
    constexpr const T* Buffer() const { return mData; } ///< The same for reading.

    T mData[4] = {}; ///< the numbers
};

typedef FbxVectorTemplate2<FbxDouble> FbxDouble2;    ///< Two doubles.
typedef FbxVectorTemplate3<FbxDouble> FbxDouble3;    ///< Three doubles: a point, angles, factors or a colour.
typedef FbxVectorTemplate4<FbxDouble> FbxDouble4;    ///< Four doubles.
typedef FbxVectorTemplate4<FbxDouble4> FbxDouble4x4; ///< Four rows of four doubles.

FBXSDK_NAMESPACE_END
