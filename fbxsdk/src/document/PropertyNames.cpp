// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Tables of property names.
#include "document/PropertyNames.h"

#include <algorithm>
#include <iterator>

#include "schema/PropertyFlags.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Sorted for the binary search.
constexpr std::string_view kModelProperties[] = {
    "AxisLen",
    "DefaultAttributeIndex",
    "Freeze",
    "GeometricRotation",
    "GeometricScaling",
    "GeometricTranslation",
    "InheritType",
    "LODBox",
    "Lcl Rotation",
    "Lcl Scaling",
    "Lcl Translation",
    "LookAtProperty",
    "MaxDampRangeX",
    "MaxDampRangeY",
    "MaxDampRangeZ",
    "MaxDampStrengthX",
    "MaxDampStrengthY",
    "MaxDampStrengthZ",
    "MinDampRangeX",
    "MinDampRangeY",
    "MinDampRangeZ",
    "MinDampStrengthX",
    "MinDampStrengthY",
    "MinDampStrengthZ",
    "NegativePercentShapeSupport",
    "PostRotation",
    "PreRotation",
    "PreferedAngleX",
    "PreferedAngleY",
    "PreferedAngleZ",
    "QuaternionInterpolate",
    "RotationActive",
    "RotationMax",
    "RotationMaxX",
    "RotationMaxY",
    "RotationMaxZ",
    "RotationMin",
    "RotationMinX",
    "RotationMinY",
    "RotationMinZ",
    "RotationOffset",
    "RotationOrder",
    "RotationPivot",
    "RotationSpaceForLimitOnly",
    "RotationStiffnessX",
    "RotationStiffnessY",
    "RotationStiffnessZ",
    "ScalingActive",
    "ScalingMax",
    "ScalingMaxX",
    "ScalingMaxY",
    "ScalingMaxZ",
    "ScalingMin",
    "ScalingMinX",
    "ScalingMinY",
    "ScalingMinZ",
    "ScalingOffset",
    "ScalingPivot",
    "Show",
    "TranslationActive",
    "TranslationMax",
    "TranslationMaxX",
    "TranslationMaxY",
    "TranslationMaxZ",
    "TranslationMin",
    "TranslationMinX",
    "TranslationMinY",
    "TranslationMinZ",
    "UpVectorProperty",
    "Visibility",
    "Visibility Inheritance",
};
static_assert(std::is_sorted(std::begin(kModelProperties), std::end(kModelProperties)));

struct Renaming {
    std::string_view subClass, className, oldName, newName;
};
constexpr Renaming kRenamings[] = {
    {"Light", "FbxLight", "HotSpot", "InnerAngle"},
    {"Light", "FbxLight", "Cone angle", "OuterAngle"},
    {"Light", "FbxLight", "ConeAngle", "OuterAngle"},
    {"Light", "FbxLight", "CastLight", "CastLightOnObject"},
    {"Camera", "FbxCamera", "AspectW", "AspectWidth"},
    {"Camera", "FbxCamera", "AspectH", "AspectHeight"},
    {"Camera", "FbxCamera", "ResolutionMode", "AspectRatioMode"},
    {"Camera", "FbxCamera", "FitImage", "BackPlateFitImage"},
    {"Camera", "FbxCamera", "Crop", "BackPlateCrop"},
    {"Camera", "FbxCamera", "Center", "BackPlateCenter"},
    {"Camera", "FbxCamera", "KeepRatio", "BackPlateKeepRatio"},
};

constexpr std::pair<std::string_view, std::string_view> kSubTypes[] = {
    {"double", "Number"},  {"Vector3D", "Vector"},     {"Vector2D", "Vector2"}, {"int", "Integer"},
    {"ColorRGB", "Color"}, {"ColorAndAlpha", "Color"}, {"KTime", "Time"},
};

constexpr std::pair<std::string_view, std::string_view> kAttributeFlags[] = {
    {"N", ""}, {"AN", "A"}, {"A+N", "A+"}, {"HN", "H"}, {"AUN", "AU"}, {"UN", "U"},
};

} // namespace

bool isModelProperty(std::string_view name) {
    return std::binary_search(std::begin(kModelProperties), std::end(kModelProperties), name);
}

std::string_view modernPropertyName(std::string_view subClass, std::string_view name) {
    const auto* found = std::find_if(std::begin(kRenamings), std::end(kRenamings), [&](const Renaming& row) {
        return row.oldName == name && (row.subClass == subClass || row.className == subClass);
    });
    return found == std::end(kRenamings) ? name : found->newName;
}

void modernizePropertyNames(std::string_view record, std::string_view subClass,
                            std::vector<DocumentProperty>& properties) {
    if (record != "NodeAttribute")
        return;
    for (const Renaming& row : kRenamings) {
        if (row.subClass != subClass && row.className != subClass)
            continue;
        const auto isCalled = [&](std::string_view name) {
            return [name](const DocumentProperty& property) { return property.name == name; };
        };
        if (std::none_of(properties.begin(), properties.end(), isCalled(row.newName)))
            for (DocumentProperty& property : properties)
                if (property.name == row.oldName)
                    property.name = row.newName;
    }
}

std::string_view subTypeOf(std::string_view typeName) {
    const auto* found = std::find_if(std::begin(kSubTypes), std::end(kSubTypes),
                                     [&](const auto& row) { return row.first == typeName; });
    return found == std::end(kSubTypes) ? std::string_view() : found->second;
}

std::string_view attributeFlags(RecordTree& tree, std::string_view flags) {
    if (flags.find(kAttributeFlagLetter) == std::string_view::npos)
        return flags;
    const auto* found = std::find_if(std::begin(kAttributeFlags), std::end(kAttributeFlags),
                                     [&](const auto& row) { return row.first == flags; });
    if (found != std::end(kAttributeFlags))
        return found->second;
    std::string kept(flags);
    std::erase(kept, kAttributeFlagLetter);
    return tree.keepText(std::move(kept));
}

} // namespace detail
FBXSDK_NAMESPACE_END
