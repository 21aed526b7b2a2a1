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
    const char* name;      ///< as hosts request it
    std::uint32_t version; ///< as files state it
    int generation;        ///< 6: names identify objects, takes hold the animation; 7: objects have ids, curves too
    // Which objects and properties a file has.
    bool views;           ///< the application's views: producer cameras, their hidden parts, their resolution
    bool defaultsLeftOut; ///< properties with the value of their class's template
    bool inlineShapes;    ///< blend shapes are inside their geometry, and their weights are its properties
    bool modelStates;     ///< Models state whether they have several layers and takes
    // Curves.
    int keyVersion;
    bool allTangents;           ///< keys can be automatic and clamped, broken or biased
    bool relativeExtrapolation; ///< curves can repeat relative to their end
    // Geometry and deformers.
    int normalVersion;  ///< of layer elements of normals, tangents and binormals …
    bool fourthNumbers; ///< … which have a fourth number from 102 on
    bool shapeVersion;  ///< shapes state one
    int skinVersion;
    bool skinningType; ///< skins state how they blend
};

// clang-format off
inline constexpr VersionTraits kVersionTraits[] = {
    //             generation  defaultsLeftOut  modelStates    relativeExtrapolation  shapeVersion    skinningType
    //                     |  views  |  inlineShapes |  keyVersion  |  normalVersion  |    skinVersion |
    //                     |    |    |      |        |    | allTangents  |  fourthNumbers  |     |     |
    {"FBX201000", 6100,    6, true,  false, true,  true,  4005, false, false, 101, false, false, 100, false},
    {"FBX201100", 7100,    7, false, true,  true,  false, 4007, true,  false, 101, false, false, 101, true},
    {"FBX201200", 7200,    7, false, true,  false, false, 4009, true,  true,  101, false, true,  101, true},
    {"FBX201300", 7300,    7, false, true,  false, false, 4009, true,  true,  101, false, true,  101, true},
    {"FBX201400", 7400,    7, false, true,  false, false, 4009, true,  true,  102, true,  true,  101, true},
    {"FBX201600", 7500,    7, false, true,  false, false, 4009, true,  true,  102, true,  true,  101, true},
};
// clang-format on

/// The version written by default.
inline constexpr const VersionTraits& kNewestVersion = kVersionTraits[5];

/// The row of that name; null when there is none.
[[nodiscard]] constexpr const VersionTraits* findVersion(std::string_view name) {
    for (const VersionTraits& row : kVersionTraits)
        if (name == row.name)
            return &row;
    return nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
