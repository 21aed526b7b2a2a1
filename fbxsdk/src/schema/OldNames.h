// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The names of properties in older files, and the spelling of the frame rate in files before 7.0.
#pragma once

#include <cstdint>
#include <string_view>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A property of a kind of attribute: its name in older files, and the present one.
struct OldPropertyName {
    std::string_view subClass, className, oldName, newName;
    bool written; ///< files before 7.0 are written with the old name
};
inline constexpr OldPropertyName kOldPropertyNames[] = {
    {"Light", "FbxLight", "HotSpot", "InnerAngle", true},
    {"Light", "FbxLight", "Cone angle", "OuterAngle", true},
    {"Light", "FbxLight", "ConeAngle", "OuterAngle", false},
    {"Light", "FbxLight", "CastLight", "CastLightOnObject", false},
    {"Camera", "FbxCamera", "AspectW", "AspectWidth", false},
    {"Camera", "FbxCamera", "AspectH", "AspectHeight", false},
    {"Camera", "FbxCamera", "ResolutionMode", "AspectRatioMode", false},
    {"Camera", "FbxCamera", "FitImage", "BackPlateFitImage", false},
    {"Camera", "FbxCamera", "Crop", "BackPlateCrop", false},
    {"Camera", "FbxCamera", "Center", "BackPlateCenter", false},
    {"Camera", "FbxCamera", "KeepRatio", "BackPlateKeepRatio", false},
};

/// The frame rate of a time mode as text.
struct LegacyRateRow {
    std::int64_t timeMode;
    std::string_view framesPerSecond;
    bool read; ///< whether the rate means this mode, of several that have it
};
inline constexpr LegacyRateRow kLegacyRates[] = {
    {0, "30", false}, {1, "120", true},    {2, "100", true},   {3, "60", true},      {4, "50", true},
    {5, "48", true},  {6, "30", true},     {7, "30", false},   {8, "29.97", false},  {9, "29.97", true},
    {10, "25", true}, {11, "24", true},    {12, "1000", true}, {13, "23.976", true}, {15, "96", true},
    {16, "72", true}, {17, "59.94", true},
};
/// The mode of all other rates, which are stored separately.
inline constexpr std::int64_t kCustomTimeMode = 14;

} // namespace detail
FBXSDK_NAMESPACE_END
