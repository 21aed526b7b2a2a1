// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Data types of properties: what a property holds and how the type is spelt in files.
#pragma once

#include <fbxsdk/FbxTypes.h>

FBXSDK_NAMESPACE_BEGIN

namespace detail {

/// One row of the type table.
struct PropertyTypeInfo {
    EFbxType type;
    const char* apiName;     ///< "Double2", "ColorRGB", …
    const char* typeName;    ///< first type string of a file's property line: "Vector2D"
    const char* subTypeName; ///< second: "Vector2"
};

} // namespace detail

class FBXSDK_DLL FbxDataType {
public:
    constexpr FbxDataType() = default;
    explicit constexpr FbxDataType(const detail::PropertyTypeInfo* pInfo) : mInfo(pInfo) {}

    [[nodiscard]] bool Valid() const { return mInfo != nullptr; }
    [[nodiscard]] EFbxType GetType() const { return mInfo ? mInfo->type : eFbxUndefined; }
    [[nodiscard]] const char* GetName() const { return mInfo ? mInfo->apiName : ""; }
    [[nodiscard]] bool Is(const FbxDataType& pOther) const { return mInfo == pOther.mInfo; }
    bool operator==(const FbxDataType& pOther) const { return mInfo == pOther.mInfo; }
    bool operator!=(const FbxDataType& pOther) const { return mInfo != pOther.mInfo; }

    [[nodiscard]] const detail::PropertyTypeInfo* info() const { return mInfo; }

private:
    const detail::PropertyTypeInfo* mInfo = nullptr;
};

extern FBXSDK_DLL const FbxDataType FbxUndefinedDT, FbxBoolDT, FbxIntDT, FbxLongLongDT, FbxULongLongDT, FbxFloatDT,
    FbxDoubleDT, FbxDouble2DT, FbxDouble3DT, FbxDouble4DT, FbxEnumDT, FbxStringDT, FbxTimeDT, FbxReferenceDT, FbxBlobDT,
    FbxDistanceDT, FbxDateTimeDT, FbxColor3DT, FbxColor4DT, FbxCompoundDT, FbxUrlDT, FbxXRefUrlDT, FbxTranslationDT,
    FbxRotationDT, FbxScalingDT, FbxQuaternionDT, FbxLocalTranslationDT, FbxLocalRotationDT, FbxLocalScalingDT,
    FbxVisibilityDT, FbxVisibilityInheritanceDT, FbxRollDT, FbxFieldOfViewDT, FbxFieldOfViewXDT, FbxFieldOfViewYDT,
    FbxOpticalCenterXDT, FbxOpticalCenterYDT, FbxNumberDT, FbxVectorDT, FbxAnimatedColorDT, FbxWeightDT, FbxShortDT,
    FbxUByteDT;

FBXSDK_NAMESPACE_END
