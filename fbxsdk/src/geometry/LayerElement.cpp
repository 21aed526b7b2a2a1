// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Layer elements: their modes and arrays, and their owners.
#include <stdexcept>

#include <fbxsdk/FbxLayer.h>

FBXSDK_NAMESPACE_BEGIN

namespace detail {

void throwMissingDirectArray() {
    throw std::runtime_error("FbxLayerElementArrayTemplate - mDirectArray is NULL"); // kept: hosts rely on the text
}

void throwMissingIndexArray() { throw std::runtime_error("FbxLayerElementArrayTemplate - mIndexArray is NULL"); }

} // namespace detail

FbxLayerElement::FbxLayerElement() = default;
FbxLayerElement::~FbxLayerElement() = default;

void FbxLayerElement::joinOwner(FbxLayerContainer* pOwner) {
    if (pOwner)
        pOwner->adopt(*this);
}

void FbxLayerElement::Destroy() {
    if (mOwner)
        mOwner->disown(*this);
    delete this;
}

template <class T>
FbxLayerElementTemplate<T>::FbxLayerElementTemplate()
    : mDirectArray(std::make_unique<FbxLayerElementArrayTemplate<T>>()),
      mIndexArray(std::make_unique<FbxLayerElementArrayTemplate<int>>()) {}

template <class T>
FbxLayerElementTemplate<T>::~FbxLayerElementTemplate() = default;

template <class T>
bool FbxLayerElementTemplate<T>::Clear() {
    if (mDirectArray)
        mDirectArray->Clear();
    if (mIndexArray)
        mIndexArray->Clear();
    return true;
}

template <class T>
void FbxLayerElementTemplate<T>::removeEntries(int pFirst, int pCount) {
    if (GetReferenceMode() != eDirect && mIndexArray)
        mIndexArray->items().remove(pFirst, pCount);
    else if (mDirectArray)
        mDirectArray->items().remove(pFirst, pCount);
}

template class FbxLayerElementTemplate<FbxVector4>;
template class FbxLayerElementTemplate<FbxVector2>;
template class FbxLayerElementTemplate<FbxColor>;
template class FbxLayerElementTemplate<int>;
template class FbxLayerElementTemplate<double>;
template class FbxLayerElementTemplate<bool>;
template class FbxLayerElementTemplate<FbxSurfaceMaterial*>;
template class FbxLayerElementTemplate<FbxTexture*>;

#define FBXSDK_LAYER_ELEMENT_IMPLEMENT(Class)                                                                          \
    Class::Class() = default;                                                                                          \
    Class::~Class() = default;                                                                                         \
    Class* Class::Create(FbxLayerContainer* pOwner, const char* pName) {                                               \
        const auto destroy = [](Class* doomed) { delete doomed; };                                                     \
        std::unique_ptr<Class, decltype(destroy)> element(new Class, destroy);                                         \
        element->SetName(pName);                                                                                       \
        element->joinOwner(pOwner);                                                                                    \
        return element.release();                                                                                      \
    }

FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementNormal)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementBinormal)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementTangent)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementMaterial)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementPolygonGroup)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementUV)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementVertexColor)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementSmoothing)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementCrease)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementHole)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementVisibility)
FBXSDK_LAYER_ELEMENT_IMPLEMENT(FbxLayerElementTexture)

FBXSDK_NAMESPACE_END
