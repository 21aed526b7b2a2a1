// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The versions that can be written, and what each writes differently. A new row is enough for a new version.
#pragma once

#include <cstdint>
#include <string_view>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

struct VersionTraits {
    const char* name;           ///< as hosts ask for it
    std::uint32_t version;      ///< as files state it
    int keyVersion;             ///< of curves
    int normalVersion;          ///< of layer elements of normals, tangents and binormals; 102 has a fourth number
    bool inlineShapes;          ///< blend shapes stand inside their geometry, and their weights are its properties
    bool relativeExtrapolation; ///< curves can repeat from where they ended
    bool idsAndTemplates;       ///< objects have ids, defaults are left out: from 7.0 on
};

inline constexpr VersionTraits kVersionTraits[] = {
    {"FBX201000", 6100, 4005, 101, true, false, false}, {"FBX201100", 7100, 4007, 101, true, false, true},
    {"FBX201200", 7200, 4009, 101, false, true, true},  {"FBX201300", 7300, 4009, 101, false, true, true},
    {"FBX201400", 7400, 4009, 102, false, true, true},  {"FBX201600", 7500, 4009, 102, false, true, true},
};

/// What is written unless somebody asks for another.
inline constexpr const VersionTraits& kNewestVersion = kVersionTraits[5];

/// The row of that name; null when there is none.
[[nodiscard]] constexpr const VersionTraits* findVersion(std::string_view name) {
    for (const VersionTraits& row : kVersionTraits) {
        if (name == row.name)
            return &row;
    }
    return nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
