// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How files call the elements of texture channels.
#pragma once

#include <string_view>

#include <fbxsdk/FbxLayer.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Textures and texture coordinates exist once for each channel.
struct LayerChannelRow {
    std::string_view textures, uvs; ///< the names of their records
    FbxLayerElement::EType channel;
};

inline constexpr LayerChannelRow kLayerChannels[] = {
    {"LayerElementTexture", "LayerElementUV", FbxLayerElement::eTextureDiffuse},
    {"LayerElementDiffuseFactorTextures", "LayerElementDiffuseFactorUV", FbxLayerElement::eTextureDiffuseFactor},
    {"LayerElementEmissive_Textures", "LayerElementEmissiveUV", FbxLayerElement::eTextureEmissive},
    {"LayerElementEmissiveFactorTextures", "LayerElementEmissiveFactorUV", FbxLayerElement::eTextureEmissiveFactor},
    {"LayerElementAmbientTextures", "LayerElementAmbientUV", FbxLayerElement::eTextureAmbient},
    {"LayerElementAmbientFactorTextures", "LayerElementAmbientFactorUV", FbxLayerElement::eTextureAmbientFactor},
    {"LayerElementSpecularTextures", "LayerElementSpecularUV", FbxLayerElement::eTextureSpecular},
    {"LayerElementSpecularFactorTextures", "LayerElementSpecularFactorUV", FbxLayerElement::eTextureSpecularFactor},
    {"LayerElementShininessTextures", "LayerElementShininessUV", FbxLayerElement::eTextureShininess},
    {"LayerElementNormalMapTextures", "LayerElementNormalMapUV", FbxLayerElement::eTextureNormalMap},
    {"LayerElementBumpTextures", "LayerElementBumpUV", FbxLayerElement::eTextureBump},
    {"LayerElementTransparentTextures", "LayerElementTransparentUV", FbxLayerElement::eTextureTransparency},
    {"LayerElementTransparencyFactorTextures", "LayerElementTransparencyFactorUV",
     FbxLayerElement::eTextureTransparencyFactor},
    {"LayerElementReflectionTextures", "LayerElementReflectionUV", FbxLayerElement::eTextureReflection},
    {"LayerElementReflectionFactorTextures", "LayerElementReflectionFactorUV",
     FbxLayerElement::eTextureReflectionFactor},
    {"LayerElementDisplacementTextures", "LayerElementDisplacementUV", FbxLayerElement::eTextureDisplacement},
};

} // namespace detail
FBXSDK_NAMESPACE_END
