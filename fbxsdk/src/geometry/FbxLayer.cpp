// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layers and their container, which owns both layers and elements.
#include <fbxsdk/FbxLayer.h>

#include <algorithm>

#include "geometry/GeometrySource.h"
#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_ABSTRACT_IMPLEMENT(FbxLayerContainer, FbxNodeAttribute)

void FbxLayer::set(FbxLayerElement* pElement, int pSlot) {
    if (pElement)
        mOwner.adopt(*pElement);
    mElements[pSlot] = pElement;
}

void FbxLayer::forget(const FbxLayerElement& pElement) {
    std::replace_if(
        std::begin(mElements), std::end(mElements),
        [&](const FbxLayerElement* element) { return element == &pElement; }, nullptr);
}

FbxLayerContainer::FbxLayerContainer(FbxManager& pManager, const detail::ClassInfo& pInfo)
    : FbxNodeAttribute(pManager, pInfo) {}

FbxLayerContainer::~FbxLayerContainer() {
    for (FbxLayerElement* element : mElements)
        delete element;
}

int FbxLayerContainer::CreateLayer() {
    detachSource();
    std::unique_ptr<FbxLayer, LayerDeleter> layer(new FbxLayer(*this));
    mLayers.push_back(std::move(layer));
    return static_cast<int>(mLayers.size()) - 1;
}

void FbxLayerContainer::ClearLayers() {
    detachSource();
    mLayers.clear();
}

int FbxLayerContainer::GetLayerCount(FbxLayerElement::EType pType, bool pUVCount) const {
    if (pType <= FbxLayerElement::eUnknown || pType >= FbxLayerElement::eTypeCount)
        return 0;
    // The type "UV" by itself means the default set.
    const FbxLayerElement::EType type = pType == FbxLayerElement::eUV ? FbxLayerElement::eTextureDiffuse : pType;
    const bool isUv = FbxLayer::isTextureChannel(type) && (pUVCount || pType == FbxLayerElement::eUV);
    const int slot = isUv ? FbxLayer::uvSlot(type) : type;
    ensureLoaded();
    return static_cast<int>(std::count_if(mLayers.begin(), mLayers.end(),
                                          [slot](const auto& layer) { return layer->mElements[slot] != nullptr; }));
}

void FbxLayerContainer::setSource(std::unique_ptr<detail::GeometrySource> pSource) { mSource = std::move(pSource); }

void FbxLayerContainer::detachSource() {
    ensureLoaded();
    mSource.reset();
}

void FbxLayerContainer::loadSource() const {
    // Without its source the object is an ordinary one for the reader's calls. The content is logically part of the
    // object: reading it late does not change the object. If it cannot be read, the object does not become empty; the
    // next access fails again.
    std::unique_ptr<detail::GeometrySource> source = std::move(mSource);
    try {
        if (!const_cast<FbxLayerContainer*>(this)->readSource(*source))
            mSource = std::move(source);
    } catch (...) {
        mSource = std::move(source);
        throw;
    }
}

void FbxLayerContainer::removeElementEntries(FbxLayerElement::EMappingMode pMappingMode, int pFirst, int pCount) {
    std::vector<FbxLayerElement*> touched; // an element in two layers is changed once
    for (const auto& layer : mLayers) {
        for (FbxLayerElement* element : layer->mElements) {
            if (!element || element->GetMappingMode() != pMappingMode)
                continue;
            if (std::find(touched.begin(), touched.end(), element) != touched.end())
                continue;
            element->removeEntries(pFirst, pCount);
            touched.push_back(element);
        }
    }
}

void FbxLayerContainer::adopt(FbxLayerElement& pElement) {
    if (pElement.mOwner == this)
        return;
    if (pElement.mOwner)
        pElement.mOwner->disown(pElement);
    mElements.push_back(&pElement);
    pElement.mOwner = this;
}

void FbxLayerContainer::disown(FbxLayerElement& pElement) {
    for (const auto& layer : mLayers)
        layer->forget(pElement);
    mElements.erase(std::remove(mElements.begin(), mElements.end(), &pElement), mElements.end());
    pElement.mOwner = nullptr;
}

FBXSDK_NAMESPACE_END
