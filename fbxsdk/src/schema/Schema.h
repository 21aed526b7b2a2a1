// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The properties that each class of objects has, with types and defaults.
//
// The tables are in the Schema*.cpp sources. Their sizes are here, so that the spans are constants: a class can
// use its rows before any initialiser has run, whatever the order of the sources.
#pragma once

#include <span>
#include <string_view>

#include "schema/PropertyRow.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Types that differ from the plain ones in files only: there, animatable types are spelt differently.
extern const FbxDataType kAnimatableBoolType, kAnimatableIntType;

extern const PropertyRow kNodeTable[71];
inline constexpr std::span<const PropertyRow> kNodeRows{kNodeTable};

extern const PropertyRow kNodeAttributeTable[1];
inline constexpr std::span<const PropertyRow> kNodeAttributeRows{kNodeAttributeTable}; ///< of kinds without a class

extern const PropertyRow kCameraTable[106];
inline constexpr std::span<const PropertyRow> kCameraRows{kCameraTable};

inline constexpr std::size_t kStereoOnlyRowCount = 10;
extern const std::array<PropertyRow, std::size(kCameraTable) + kStereoOnlyRowCount> kCameraStereoTable;
inline constexpr std::span<const PropertyRow> kCameraStereoRows{kCameraStereoTable};

extern const PropertyRow kCameraSwitcherTable[2];
inline constexpr std::span<const PropertyRow> kCameraSwitcherRows{kCameraSwitcherTable};

extern const PropertyRow kLightTable[27];
inline constexpr std::span<const PropertyRow> kLightRows{kLightTable};

extern const PropertyRow kMarkerTable[6];
inline constexpr std::span<const PropertyRow> kMarkerRows{kMarkerTable};

extern const PropertyRow kNullTable[3];
inline constexpr std::span<const PropertyRow> kNullRows{kNullTable};

extern const PropertyRow kSkeletonTable[3];
inline constexpr std::span<const PropertyRow> kSkeletonRows{kSkeletonTable};

extern const PropertyRow kLodGroupTable[8];
inline constexpr std::span<const PropertyRow> kLodGroupRows{kLodGroupTable};

extern const PropertyRow kMeshTable[6];
inline constexpr std::span<const PropertyRow> kMeshRows{kMeshTable}; ///< of all geometry but lines

extern const PropertyRow kLineTable[7];
inline constexpr std::span<const PropertyRow> kLineRows{kLineTable};

extern const PropertyRow kVertexCacheDeformerTable[4];
inline constexpr std::span<const PropertyRow> kVertexCacheDeformerRows{kVertexCacheDeformerTable};

extern const PropertyRow kBlendShapeChannelTable[1];
inline constexpr std::span<const PropertyRow> kBlendShapeChannelRows{kBlendShapeChannelTable};

extern const PropertyRow kCacheTable[3];
inline constexpr std::span<const PropertyRow> kCacheRows{kCacheTable};

extern const PropertyRow kAnimStackTable[5];
inline constexpr std::span<const PropertyRow> kAnimStackRows{kAnimStackTable};

extern const PropertyRow kAnimLayerTable[9];
inline constexpr std::span<const PropertyRow> kAnimLayerRows{kAnimLayerTable};

extern const PropertyRow kAnimCurveNodeTable[1];
inline constexpr std::span<const PropertyRow> kAnimCurveNodeRows{kAnimCurveNodeTable};

extern const PropertyRow kMaterialTable[2];
inline constexpr std::span<const PropertyRow> kMaterialRows{kMaterialTable};

extern const PropertyRow kLambertTable[17];
inline constexpr std::span<const PropertyRow> kLambertRows{kLambertTable};

extern const PropertyRow kPhongTable[22];
inline constexpr std::span<const PropertyRow> kPhongRows{kPhongTable};

extern const PropertyRow kFileTextureTable[16];
inline constexpr std::span<const PropertyRow> kFileTextureRows{kFileTextureTable};

extern const PropertyRow kLayeredTextureTable[14];
inline constexpr std::span<const PropertyRow> kLayeredTextureRows{kLayeredTextureTable};

extern const PropertyRow kVideoTable[20];
inline constexpr std::span<const PropertyRow> kVideoRows{kVideoTable};

extern const PropertyRow kGlobalSettingsTable[20];
inline constexpr std::span<const PropertyRow> kGlobalSettingsRows{kGlobalSettingsTable};

/// The index of the row of that name; -1 when there is none.
[[nodiscard]] int rowIndex(std::span<const PropertyRow> rows, std::string_view name);

} // namespace detail
FBXSDK_NAMESPACE_END
