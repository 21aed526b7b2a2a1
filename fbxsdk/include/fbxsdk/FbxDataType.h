// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
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

/// The type of a property: the kind of its value and its spelling in files. Cheap to copy; compares by identity, so
/// that two types of the same values may differ in their spelling.
class FBXSDK_DLL FbxDataType {
public:
    constexpr FbxDataType() = default;                                                      ///< The undefined type.
    explicit constexpr FbxDataType(const detail::PropertyTypeInfo* pInfo) : mInfo(pInfo) {} ///< The platform's own.

    [[nodiscard]] bool Valid() const { return mInfo != nullptr; } ///< False only for the undefined type.
    /// The type of its values; eFbxUndefined also for compounds.
    [[nodiscard]] EFbxType GetType() const { return mInfo ? mInfo->type : eFbxUndefined; }
    /// A name for display, not unique; empty for the undefined type.
    [[nodiscard]] const char* GetName() const { return mInfo ? mInfo->apiName : ""; }
    [[nodiscard]] bool Is(const FbxDataType& pOther) const { return mInfo == pOther.mInfo; } ///< The same as ==.
    /// Whether both are the same type.
    bool operator==(const FbxDataType& pOther) const { return mInfo == pOther.mInfo; }
    bool operator!=(const FbxDataType& pOther) const { return mInfo != pOther.mInfo; } ///< The opposite.

    /// The platform's own view of the type.
    [[nodiscard]] const detail::PropertyTypeInfo* info() const { return mInfo; }

private:
    const detail::PropertyTypeInfo* mInfo = nullptr;
};

extern FBXSDK_DLL const FbxDataType FbxUndefinedDT, ///< no type
    FbxBoolDT,                                      ///< FbxBool
    FbxIntDT,                                       ///< FbxInt
    FbxLongLongDT,                                  ///< FbxLongLong
    FbxULongLongDT,                                 ///< FbxULongLong
    FbxFloatDT,                                     ///< FbxFloat
    FbxDoubleDT,                                    ///< FbxDouble, not meant to be animated
    FbxDouble2DT,                                   ///< FbxDouble2
    FbxDouble3DT,                                   ///< FbxDouble3, not meant to be animated
    FbxDouble4DT,                                   ///< FbxDouble4
    FbxEnumDT,                                      ///< FbxEnum
    FbxStringDT,                                    ///< FbxString
    FbxTimeDT,                                      ///< FbxTime
    FbxReferenceDT,                                 ///< an object, held by a connection
    FbxBlobDT,                                      ///< bytes
    FbxDistanceDT,                                  ///< a length with a unit of its own
    FbxDateTimeDT,                                  ///< a date, as text
    FbxColor3DT,                                    ///< FbxDouble3, 0 to 1, not meant to be animated
    FbxColor4DT,                                    ///< FbxDouble4, 0 to 1
    FbxCompoundDT,                                  ///< holds other properties
    FbxUrlDT,                                       ///< FbxString, the name of a file
    FbxXRefUrlDT,                                   ///< FbxString, the name of a file that the scene needs
    FbxTranslationDT,                               ///< FbxDouble3, scene units
    FbxRotationDT,                                  ///< FbxDouble3, degrees
    FbxScalingDT,                                   ///< FbxDouble3, factors
    FbxQuaternionDT,                                ///< FbxDouble4
    FbxLocalTranslationDT,                          ///< FbxDouble3, of FbxNode::LclTranslation
    FbxLocalRotationDT,                             ///< FbxDouble3, of FbxNode::LclRotation
    FbxLocalScalingDT,                              ///< FbxDouble3, of FbxNode::LclScaling
    FbxVisibilityDT,                                ///< FbxDouble, of FbxNode::Visibility
    FbxVisibilityInheritanceDT,                     ///< FbxBool, whether a node hides with its parent
    FbxRollDT,                                      ///< FbxDouble, degrees, of FbxCamera::Roll
    FbxFieldOfViewDT,                               ///< FbxDouble, degrees, of FbxCamera::FieldOfView
    FbxFieldOfViewXDT,                              ///< FbxDouble, degrees, of FbxCamera::FieldOfViewX
    FbxFieldOfViewYDT,                              ///< FbxDouble, degrees, of FbxCamera::FieldOfViewY
    FbxOpticalCenterXDT,                            ///< FbxDouble, of FbxCamera::OpticalCenterX
    FbxOpticalCenterYDT,                            ///< FbxDouble, of FbxCamera::OpticalCenterY
    FbxNumberDT,                                    ///< FbxDouble, meant to be animated
    FbxVectorDT,                                    ///< FbxDouble3, meant to be animated
    FbxAnimatedColorDT,                             ///< FbxDouble3, 0 to 1, meant to be animated
    FbxWeightDT,                                    ///< FbxDouble, percent
    FbxShortDT,                                     ///< FbxShort
    FbxUByteDT;                                     ///< FbxUChar

FBXSDK_NAMESPACE_END
