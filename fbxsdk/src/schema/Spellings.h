// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How files spell the enumerators of the API. The index in a table is the enumerator's number.
#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>

#include <fbxsdk/FbxTypes.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The sub-class of a skeleton.
inline constexpr std::array<std::string_view, 4> kSkeletonTypes = {"Root", "Limb", "LimbNode", "Effector"};
/// The sub-class of a marker.
inline constexpr std::array<std::string_view, 4> kMarkerTypes = {"Marker", "OpticalMarker", "FKEffector", "IKEffector"};
/// How a skin blends: FbxSkin::EType.
inline constexpr std::array<std::string_view, 4> kSkinningTypes = {"Rigid", "Linear", "DualQuaternion", "Blend"};
/// The link mode of a cluster: FbxCluster::ELinkMode. Files omit the first.
inline constexpr std::array<std::string_view, 3> kLinkModes = {"Normalize", "Additive", "Total1"};
/// The form of a surface in a direction, FbxNurbsSurfaceBase::EType, and of a curve: FbxNurbsCurve::EType.
inline constexpr std::array<std::string_view, 3> kSurfaceForms = {"Periodic", "Closed", "Open"};
inline constexpr std::array<std::string_view, 3> kCurveForms = {"Open", "Closed", "Periodic"};
/// The type of a patch in a direction: FbxPatch::EType.
inline constexpr std::array<std::string_view, 5> kPatchTypes = {"Bezier", "BezierQuadric", "Cardinal", "BSpline",
                                                                "Linear"};
/// The letter of a node's shading mode. Y, W and T are confirmed by files of known writers; the others follow the
/// modes' names.
inline constexpr std::array<char, 6> kShadingModes = {'Y', 'W', 'F', 'L', 'T', 'U'};

/// The number of a spelling; `otherwise` for an unknown one.
template <class T, std::size_t Count>
[[nodiscard]] constexpr int numberOf(const std::array<T, Count>& table, T spelling, int otherwise) {
    const auto found = std::find(table.begin(), table.end(), spelling);
    return found == table.end() ? otherwise : static_cast<int>(found - table.begin());
}

/// The spelling of a number; that of `otherwise` for a number without one.
template <class T, std::size_t Count>
[[nodiscard]] constexpr T spellingOf(const std::array<T, Count>& table, int number, int otherwise) {
    const bool isKnown = number >= 0 && static_cast<std::size_t>(number) < Count;
    return table[static_cast<std::size_t>(isKnown ? number : otherwise)];
}

} // namespace detail
FBXSDK_NAMESPACE_END
