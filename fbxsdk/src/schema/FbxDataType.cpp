// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Property types: the kind of their values, and their two type strings in files.
#include "schema/PropertyTypes.h"

#include "schema/NameIndex.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

// clang-format off
/// Constant, kind of value, name for users, first and second type string. Animatable types are spelt differently in
/// files: "Number" for "double", "Vector" for "Vector3D", "Color" for "ColorRGB".
#define FBXSDK_DATA_TYPES(ROW) \
    ROW(FbxBoolDT, eFbxBool, "Bool", "bool", "") \
    ROW(FbxIntDT, eFbxInt, "Integer", "int", "Integer") \
    ROW(FbxLongLongDT, eFbxLongLong, "LongLong", "LongLong", "") \
    ROW(FbxULongLongDT, eFbxULongLong, "ULongLong", "ULongLong", "") \
    ROW(FbxFloatDT, eFbxFloat, "Float", "Float", "") \
    ROW(FbxDoubleDT, eFbxDouble, "Number", "double", "Number") \
    ROW(FbxDouble2DT, eFbxDouble2, "Vector2", "Vector2D", "Vector2") \
    ROW(FbxDouble3DT, eFbxDouble3, "Vector", "Vector3D", "Vector") \
    ROW(FbxDouble4DT, eFbxDouble4, "Vector4", "Vector4D", "Vector4") \
    ROW(FbxEnumDT, eFbxEnum, "Enum", "enum", "") \
    ROW(FbxStringDT, eFbxString, "KString", "KString", "") \
    ROW(FbxTimeDT, eFbxTime, "Time", "KTime", "Time") \
    ROW(FbxReferenceDT, eFbxReference, "Reference", "object", "") \
    ROW(FbxBlobDT, eFbxBlob, "Blob", "Blob", "") \
    ROW(FbxDistanceDT, eFbxDistance, "Distance", "Distance", "") \
    ROW(FbxDateTimeDT, eFbxDateTime, "DateTime", "DateTime", "") \
    ROW(FbxColor3DT, eFbxDouble3, "Color", "ColorRGB", "Color") \
    ROW(FbxColor4DT, eFbxDouble4, "ColorAndAlpha", "ColorAndAlpha", "") \
    ROW(FbxCompoundDT, eFbxUndefined, "Compound", "Compound", "") \
    ROW(FbxUrlDT, eFbxString, "Url", "KString", "Url") \
    ROW(FbxXRefUrlDT, eFbxString, "XRefUrl", "KString", "XRefUrl") \
    ROW(FbxTranslationDT, eFbxDouble3, "Translation", "Translation", "") \
    ROW(FbxRotationDT, eFbxDouble3, "Rotation", "Rotation", "") \
    ROW(FbxScalingDT, eFbxDouble3, "Scaling", "Scaling", "") \
    ROW(FbxQuaternionDT, eFbxDouble4, "Quaternion", "Quaternion", "") \
    ROW(FbxLocalTranslationDT, eFbxDouble3, "Lcl Translation", "Lcl Translation", "") \
    ROW(FbxLocalRotationDT, eFbxDouble3, "Lcl Rotation", "Lcl Rotation", "") \
    ROW(FbxLocalScalingDT, eFbxDouble3, "Lcl Scaling", "Lcl Scaling", "") \
    ROW(FbxVisibilityDT, eFbxDouble, "Visibility", "Visibility", "") \
    ROW(FbxVisibilityInheritanceDT, eFbxBool, "Visibility Inheritance", "Visibility Inheritance", "") \
    ROW(FbxRollDT, eFbxDouble, "Roll", "Roll", "") \
    ROW(FbxFieldOfViewDT, eFbxDouble, "FieldOfView", "FieldOfView", "") \
    ROW(FbxFieldOfViewXDT, eFbxDouble, "FieldOfViewX", "FieldOfViewX", "") \
    ROW(FbxFieldOfViewYDT, eFbxDouble, "FieldOfViewY", "FieldOfViewY", "") \
    ROW(FbxOpticalCenterXDT, eFbxDouble, "OpticalCenterX", "OpticalCenterX", "") \
    ROW(FbxOpticalCenterYDT, eFbxDouble, "OpticalCenterY", "OpticalCenterY", "") \
    ROW(FbxNumberDT, eFbxDouble, "Number", "Number", "") \
    ROW(FbxVectorDT, eFbxDouble3, "Vector", "Vector", "") \
    ROW(FbxAnimatedColorDT, eFbxDouble3, "Color", "Color", "") \
    ROW(FbxWeightDT, eFbxDouble, "Weight", "Weight", "") \
    ROW(FbxShortDT, eFbxShort, "Short", "Short", "") \
    ROW(FbxUByteDT, eFbxUChar, "UByte", "UByte", "")
// clang-format on

namespace detail {
namespace {

#define FBXSDK_TYPE_INFO(Name, ...) {__VA_ARGS__},
constinit const PropertyTypeInfo kTypes[] = {FBXSDK_DATA_TYPES(FBXSDK_TYPE_INFO)};
#undef FBXSDK_TYPE_INFO

#define FBXSDK_TYPE_PLACE(Name, ...) placeOf##Name,
enum TypePlace { FBXSDK_DATA_TYPES(FBXSDK_TYPE_PLACE) };
#undef FBXSDK_TYPE_PLACE

} // namespace
} // namespace detail

constinit const FbxDataType FbxUndefinedDT;
#define FBXSDK_TYPE_CONSTANT(Name, ...) constinit const FbxDataType Name{&detail::kTypes[detail::placeOf##Name]};
FBXSDK_DATA_TYPES(FBXSDK_TYPE_CONSTANT)
#undef FBXSDK_TYPE_CONSTANT
#undef FBXSDK_DATA_TYPES

namespace detail {
namespace {

constinit const PropertyTypeInfo kAnimatableEnumInfo{eFbxEnum, "Enum", "Enum", ""};
constinit const FbxDataType kAnimatableEnumType{&kAnimatableEnumInfo};
constinit const PropertyTypeInfo kReachTranslationInfo{eFbxDouble, "IK Reach Translation", "IK Reach Translation", ""};
constinit const FbxDataType kReachTranslationType{&kReachTranslationInfo};
constinit const PropertyTypeInfo kReachRotationInfo{eFbxDouble, "IK Reach Rotation", "IK Reach Rotation", ""};
constinit const FbxDataType kReachRotationType{&kReachRotationInfo};

/// Further first type strings that files have, and the type they mean.
struct Spelling {
    std::string_view typeName;
    const FbxDataType* type;
};
constexpr Spelling kSpellings[] = {
    {"Bool", &kAnimatableBoolType},
    {"Integer", &kAnimatableIntType},
    {"Enum", &kAnimatableEnumType},
    {"IK Reach Translation", &kReachTranslationType},
    {"IK Reach Rotation", &kReachRotationType},
    {"Int", &FbxIntDT},
    {"float", &FbxFloatDT},
    {"Real", &FbxNumberDT},
    {"Double", &FbxDoubleDT},
    {"Intensity", &FbxNumberDT},
    {"Shape", &FbxNumberDT},
    {"Vector2", &FbxDouble2DT},
    {"Vector4", &FbxDouble4DT},
    {"ColorRGBA", &FbxColor4DT},
    {"charptr", &FbxStringDT},
    {"String", &FbxStringDT},
    {"Action", &FbxIntDT},
    {"Time", &FbxTimeDT},
    {"TimeCode", &FbxTimeDT},
    {"Reference", &FbxReferenceDT},
    {"ReferenceProperty", &FbxReferenceDT},
};

/// The first row of that type string; -1 when there is none.
int firstOfType(std::string_view typeName) {
    static const NameIndex index(std::span<const PropertyTypeInfo>(kTypes),
                                 [](const PropertyTypeInfo& row) { return row.typeName; });
    return index.find(NameKey(typeName));
}

} // namespace

FbxDataType dataTypeOf(std::string_view typeName, std::string_view subTypeName) {
    const int first = firstOfType(typeName);
    if (first >= 0) {
        for (const PropertyTypeInfo& row : std::span(kTypes).subspan(static_cast<std::size_t>(first)))
            if (typeName == row.typeName && subTypeName == row.subTypeName)
                return FbxDataType(&row);
        return FbxDataType(&kTypes[first]);
    }
    for (const Spelling& spelling : kSpellings)
        if (typeName == spelling.typeName)
            return *spelling.type;
    return FbxBlobDT;
}

std::string_view subTypeOf(std::string_view typeName) {
    const int first = firstOfType(typeName);
    return first >= 0 ? kTypes[first].subTypeName : std::string_view();
}

std::size_t componentCount(EFbxType type) {
    switch (type) {
    case eFbxDouble2:
        return 2;
    case eFbxDouble3:
        return 3;
    case eFbxDouble4:
        return 4;
    default:
        return 1;
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
