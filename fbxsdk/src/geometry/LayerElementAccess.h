// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <fbxsdk/FbxLayer.h>

#include "schema/LayerElements.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

static_assert(int{LayerElementType::normal} == FbxLayerElement::eNormal &&
              int{LayerElementType::coordinates} == FbxLayerElement::eUV &&
              int{LayerElementType::hole} == FbxLayerElement::eHole &&
              int{LayerElementType::visibility} == FbxLayerElement::eVisibility &&
              int{LayerElementType::textureDiffuse} == FbxLayerElement::eTextureDiffuse);
static_assert(FbxLayerElement::eTextureDiffuse + std::size(kLayerChannels) ==
              FbxLayerElement::eTextureDisplacement + 1U);
static_assert(kMappingModes.size() == FbxLayerElement::eAllSame + 1U &&
              kReferenceModes.size() == FbxLayerElement::eIndexToDirect + 1U);

/// Access to layers and elements for the readers of files, not for hosts.
struct LayerElementAccess {
    // Slots of a layer: an element type, or the texture coordinates of a texture channel.
    [[nodiscard]] static int uvSlot(FbxLayerElement::EType channel) { return FbxLayer::uvSlot(channel); }
    [[nodiscard]] static FbxLayerElement* elementAt(const FbxLayer& layer, int slot) { return layer.mElements[slot]; }
    /// The element's class must be that of the slot.
    static void setElement(FbxLayer& layer, int slot, FbxLayerElement& element) { layer.set(&element, slot); }

    /// Leaves the element without its direct array, as damaged files do.
    template <class T>
    static void removeDirectArray(FbxLayerElementTemplate<T>& element) {
        element.mDirectArray.reset();
    }
    template <class T>
    static void removeIndexArray(FbxLayerElementTemplate<T>& element) {
        element.mIndexArray.reset();
    }
};

} // namespace detail
FBXSDK_NAMESPACE_END
