// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How files name layer elements, their arrays and modes.
#pragma once

#include <array>
#include <string_view>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The numbers of FbxLayerElement::EType for the types that files have. Geometry asserts that they are equal.
namespace LayerElementType {
enum : int {
    normal = 1,
    binormal,
    tangent,
    material,
    polygonGroup,
    coordinates,
    color,
    smoothing,
    vertexCrease,
    edgeCrease,
    hole,
    visibility = 13,
    textureDiffuse,
};
} // namespace LayerElementType

/// How an element stores its values.
enum class LayerElementStorage {
    values,  ///< values, with optional indices to them
    numbers, ///< indices into something else: the materials or textures of a node
    groups,  ///< indices that are the values
};

struct LayerElementRow {
    std::string_view record;
    int type; ///< of LayerElementType
    LayerElementStorage storage;
    std::string_view direct, fourth, index; ///< records with the arrays; the fourth numbers of vectors have their own
    int version;                            ///< from 7.0 on; 0: VersionTraits::normalVersion
    int legacyVersion;                      ///< in files before 7.0
};

/// In the order of files, where texture coordinates are between the two halves and textures after both.
inline constexpr LayerElementRow kLayerElements[] = {
    {"LayerElementNormal", LayerElementType::normal, LayerElementStorage::values, "Normals", "NormalsW", "NormalsIndex",
     0, 101},
    {"LayerElementBinormal", LayerElementType::binormal, LayerElementStorage::values, "Binormals", "BinormalsW",
     "BinormalsIndex", 0, 101},
    {"LayerElementTangent", LayerElementType::tangent, LayerElementStorage::values, "Tangents", "TangentsW",
     "TangentsIndex", 0, 101},
    {"LayerElementPolygonGroup", LayerElementType::polygonGroup, LayerElementStorage::groups, "", "", "PolygonGroup",
     101, 101},
    {"LayerElementColor", LayerElementType::color, LayerElementStorage::values, "Colors", "", "ColorIndex", 101, 101},

    {"LayerElementSmoothing", LayerElementType::smoothing, LayerElementStorage::values, "Smoothing", "", "", 102, 102},
    {"LayerElementEdgeCrease", LayerElementType::edgeCrease, LayerElementStorage::values, "EdgeCrease", "", "", 101,
     100},
    {"LayerElementVisibility", LayerElementType::visibility, LayerElementStorage::values, "Visibility", "", "", 101,
     101},
    {"LayerElementHole", LayerElementType::hole, LayerElementStorage::values, "Hole", "", "", 101, 100},
    {"LayerElementVertexCrease", LayerElementType::vertexCrease, LayerElementStorage::values, "VertexCrease", "", "",
     101, 100},
    {"LayerElementMaterial", LayerElementType::material, LayerElementStorage::numbers, "", "", "Materials", 101, 101},
};
inline constexpr std::size_t kElementsBeforeCoordinates = 5;

/// Textures and texture coordinates exist once for each channel: the i-th row is that of textureDiffuse + i.
struct LayerChannelRow {
    std::string_view textures, coordinates; ///< the names of their records
};
inline constexpr LayerChannelRow kLayerChannels[] = {
    {"LayerElementTexture", "LayerElementUV"},
    {"LayerElementDiffuseFactorTextures", "LayerElementDiffuseFactorUV"},
    {"LayerElementEmissive_Textures", "LayerElementEmissiveUV"},
    {"LayerElementEmissiveFactorTextures", "LayerElementEmissiveFactorUV"},
    {"LayerElementAmbientTextures", "LayerElementAmbientUV"},
    {"LayerElementAmbientFactorTextures", "LayerElementAmbientFactorUV"},
    {"LayerElementSpecularTextures", "LayerElementSpecularUV"},
    {"LayerElementSpecularFactorTextures", "LayerElementSpecularFactorUV"},
    {"LayerElementShininessTextures", "LayerElementShininessUV"},
    {"LayerElementNormalMapTextures", "LayerElementNormalMapUV"},
    {"LayerElementBumpTextures", "LayerElementBumpUV"},
    {"LayerElementTransparentTextures", "LayerElementTransparentUV"},
    {"LayerElementTransparencyFactorTextures", "LayerElementTransparencyFactorUV"},
    {"LayerElementReflectionTextures", "LayerElementReflectionUV"},
    {"LayerElementReflectionFactorTextures", "LayerElementReflectionFactorUV"},
    {"LayerElementDisplacementTextures", "LayerElementDisplacementUV"},
};

/// The rows of a channel's texture coordinates and textures.
[[nodiscard]] constexpr LayerElementRow coordinatesRow(const LayerChannelRow& channel) {
    return {
        channel.coordinates, LayerElementType::coordinates, LayerElementStorage::values, "UV", "", "UVIndex", 101, 101};
}
[[nodiscard]] constexpr LayerElementRow texturesRow(const LayerChannelRow& channel) {
    const int type = LayerElementType::textureDiffuse + static_cast<int>(&channel - kLayerChannels);
    return {channel.textures, type, LayerElementStorage::numbers, "", "", "TextureId", 101, 101};
}

/// The index in the table is the number of FbxLayerElement::EMappingMode.
inline constexpr std::array<std::string_view, 6> kMappingModes = {
    "NoMappingInformation", "ByVertice", "ByPolygonVertex", "ByPolygon", "ByEdge", "AllSame"};
/// Further spellings of the mode by control point, which files have and writers do not need.
inline constexpr std::array<std::string_view, 2> kControlPointMappings = {"ByVertex", "ByControlPoint"};

/// The index in the table is the number of FbxLayerElement::EReferenceMode. Old files say "Index" for the last one.
inline constexpr std::array<std::string_view, 3> kReferenceModes = {"Direct", "Index", "IndexToDirect"};

} // namespace detail
FBXSDK_NAMESPACE_END
