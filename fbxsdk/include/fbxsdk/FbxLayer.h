// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What geometry carries beside its points: normals, texture coordinates, colours, materials, … as elements in layers.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <fbxsdk/FbxArray.h>
#include <fbxsdk/FbxColor.h>
#include <fbxsdk/FbxNodeAttribute.h>
#include <fbxsdk/FbxPlainArray.h>
#include <fbxsdk/FbxVector2.h>
#include <fbxsdk/FbxVector4.h>

FBXSDK_NAMESPACE_BEGIN

class FbxLayer;
class FbxLayerContainer;
class FbxSurfaceMaterial;
class FbxTexture;

namespace detail {
struct GeometrySource;
struct LayerElementAccess;

/// What new items of an array hold: all bits zero, the w of vectors and the alpha of colours included.
template <class T>
inline T zeroItem() {
    return T();
}
template <>
inline FbxVector4 zeroItem<FbxVector4>() {
    return FbxVector4(0.0, 0.0, 0.0, 0.0);
}
template <>
inline FbxColor zeroItem<FbxColor>() {
    return FbxColor(0.0, 0.0, 0.0, 0.0);
}
} // namespace detail

enum EFbxMemoryClearMode { eClearToZero };

/// The part of an element's array that does not depend on its type.
class FBXSDK_DLL FbxLayerElementArray {
public:
    enum ELockMode { eReadLock = 1, eWriteLock = 2, eReadWriteLock = 3 };

    FbxLayerElementArray(const FbxLayerElementArray&) = delete;
    FbxLayerElementArray& operator=(const FbxLayerElementArray&) = delete;

    [[nodiscard]] int GetCount() const { return mStorage.count(); }

protected:
    explicit FbxLayerElementArray(detail::PlainStorage& pStorage) : mStorage(pStorage) {}
    ~FbxLayerElementArray() = default;

private:
    detail::PlainStorage& mStorage;
};

/// A contiguous array of plain items. New items are all zero; an index out of range reads as a zero item and writes
/// nowhere.
template <class T>
class FbxLayerElementArrayTemplate : public FbxLayerElementArray {
public:
    FbxLayerElementArrayTemplate() : FbxLayerElementArray(mItems) {}

    [[nodiscard]] int GetCount() const { return mItems.count(); }
    /// Always true; a negative count means none.
    bool SetCount(int pCount, EFbxMemoryClearMode = eClearToZero) {
        mItems.resize(pCount, detail::zeroItem<T>());
        return true;
    }
    /// The first new item's index.
    int AddMultiple(int pItemCount, EFbxMemoryClearMode = eClearToZero) {
        const int first = GetCount();
        SetCount(first + std::max(pItemCount, 0));
        return first;
    }
    void Clear() { mItems.clear(); }

    /// The new item's index.
    int Add(T const& pItem) {
        mItems.add(pItem);
        return GetCount() - 1;
    }
    /// An index beyond the end appends; a negative one does nothing and gives -1.
    int InsertAt(int pIndex, T const& pItem) {
        if (pIndex < 0)
            return -1;
        const int index = std::min(pIndex, GetCount());
        mItems.insert(index, pItem);
        return index;
    }
    void SetAt(int pIndex, T const& pItem) {
        if (mItems.contains(pIndex))
            mItems[pIndex] = pItem;
    }
    void SetLast(T const& pItem) { SetAt(GetCount() - 1, pItem); }

    [[nodiscard]] T GetAt(int pIndex) const {
        return mItems.contains(pIndex) ? mItems.value(pIndex) : detail::zeroItem<T>();
    }
    [[nodiscard]] T GetFirst() const { return GetAt(0); }
    [[nodiscard]] T GetLast() const { return GetAt(GetCount() - 1); }
    /// The removed item; a zero item when there is none at the index.
    T RemoveAt(int pIndex) {
        const T removed = GetAt(pIndex);
        if (mItems.contains(pIndex))
            mItems.remove(pIndex);
        return removed;
    }
    T RemoveLast() { return RemoveAt(GetCount() - 1); }
    /// Removes the first equal item; false when there is none.
    bool RemoveIt(T const& pItem) {
        const int index = Find(pItem);
        if (index >= 0)
            mItems.remove(index);
        return index >= 0;
    }
    /// -1 when there is none.
    [[nodiscard]] int Find(T const& pItem) const {
        const T* found = std::find(mItems.begin(), mItems.end(), pItem);
        return found == mItems.end() ? -1 : static_cast<int>(found - mItems.begin());
    }
    void CopyTo(FbxArray<T>& pArray) const {
        pArray.Resize(GetCount());
        for (int i = 0; i < GetCount(); ++i)
            pArray[i] = mItems.value(i);
    }

    /// Unlike elsewhere the index must be in range.
    T& operator[](int pIndex) const { return mItems[pIndex]; }

    /// All items as one run; null when there are none. Nothing is locked: the pointer is good until the count changes.
    [[nodiscard]] T* GetLocked(T* = nullptr, ELockMode = eReadWriteLock) const {
        return GetCount() == 0 ? nullptr : mItems.data();
    }
    /// Ends the use of a pointer from GetLocked, and clears it.
    void Release(T** pDataPtr) const {
        if (pDataPtr)
            *pDataPtr = nullptr;
    }

    /// The platform's own view.
    [[nodiscard]] detail::PlainArray<T>& items() { return mItems; }

private:
    detail::PlainArray<T> mItems;
};

/// One property of the points, corners or polygons of a geometry. Belongs to its container and lives until Destroy or
/// the container's end, whether it stands in a layer or not.
class FBXSDK_DLL FbxLayerElement {
public:
    enum EType {
        eUnknown,
        eNormal,
        eBiNormal,
        eTangent,
        eMaterial,
        ePolygonGroup,
        eUV,
        eVertexColor,
        eSmoothing,
        eVertexCrease,
        eEdgeCrease,
        eHole,
        eUserData,
        eVisibility,
        eTextureDiffuse,
        eTextureDiffuseFactor,
        eTextureEmissive,
        eTextureEmissiveFactor,
        eTextureAmbient,
        eTextureAmbientFactor,
        eTextureSpecular,
        eTextureSpecularFactor,
        eTextureShininess,
        eTextureNormalMap,
        eTextureBump,
        eTextureTransparency,
        eTextureTransparencyFactor,
        eTextureReflection,
        eTextureReflectionFactor,
        eTextureDisplacement,
        eTextureDisplacementVector,
        eTypeCount
    };
    /// What one value belongs to.
    enum EMappingMode { eNone, eByControlPoint, eByPolygonVertex, eByPolygon, eByEdge, eAllSame };
    /// Direct: the n-th value is direct[n]. Index to direct: it is direct[index[n]].
    enum EReferenceMode { eDirect, eIndex, eIndexToDirect };

    FbxLayerElement(const FbxLayerElement&) = delete;
    FbxLayerElement& operator=(const FbxLayerElement&) = delete;

    void SetMappingMode(EMappingMode pMappingMode) { mMappingMode = pMappingMode; }
    [[nodiscard]] EMappingMode GetMappingMode() const { return mMappingMode; }
    void SetReferenceMode(EReferenceMode pReferenceMode) { mReferenceMode = pReferenceMode; }
    [[nodiscard]] EReferenceMode GetReferenceMode() const { return mReferenceMode; }
    void SetName(const char* pName) { mName = pName ? pName : ""; }
    [[nodiscard]] const char* GetName() const { return mName.c_str(); }

    /// Takes the element out of its layers and frees it.
    void Destroy();

protected:
    FBXSDK_LOCAL FbxLayerElement();
    FBXSDK_LOCAL virtual ~FbxLayerElement();

    FBXSDK_LOCAL void joinOwner(FbxLayerContainer* pOwner);
    /// Removes entries from the array that the mapping counts in: the index array where indices are in use.
    virtual void removeEntries(int pFirst, int pCount) = 0;

private:
    friend class FbxLayerContainer;
    friend struct detail::LayerElementAccess;
    EMappingMode mMappingMode = eNone;
    EReferenceMode mReferenceMode = eDirect;
    std::string mName;
    FbxLayerContainer* mOwner = nullptr;
};

namespace detail {
[[noreturn]] FBXSDK_DLL void throwMissingDirectArray();
[[noreturn]] FBXSDK_DLL void throwMissingIndexArray();
} // namespace detail

template <class T>
class FbxLayerElementTemplate : public FbxLayerElement {
public:
    using ArrayElementType = T;

    /// Throws std::runtime_error when there is no such array, which is so in damaged elements only.
    [[nodiscard]] FbxLayerElementArrayTemplate<T>& GetDirectArray() const {
        if (!mDirectArray)
            detail::throwMissingDirectArray();
        return *mDirectArray;
    }
    /// Empty unless the reference mode asks for indices.
    [[nodiscard]] FbxLayerElementArrayTemplate<int>& GetIndexArray() const {
        if (!mIndexArray)
            detail::throwMissingIndexArray();
        return *mIndexArray;
    }
    /// Empties both arrays; always true.
    bool Clear();

protected:
    FbxLayerElementTemplate();
    ~FbxLayerElementTemplate() override;

    void removeEntries(int pFirst, int pCount) override;

private:
    friend struct detail::LayerElementAccess;
    std::unique_ptr<FbxLayerElementArrayTemplate<T>> mDirectArray;
    std::unique_ptr<FbxLayerElementArrayTemplate<int>> mIndexArray;
};

extern template class FBXSDK_DLL FbxLayerElementTemplate<FbxVector4>;
extern template class FBXSDK_DLL FbxLayerElementTemplate<FbxVector2>;
extern template class FBXSDK_DLL FbxLayerElementTemplate<FbxColor>;
extern template class FBXSDK_DLL FbxLayerElementTemplate<int>;
extern template class FBXSDK_DLL FbxLayerElementTemplate<double>;
extern template class FBXSDK_DLL FbxLayerElementTemplate<bool>;
extern template class FBXSDK_DLL FbxLayerElementTemplate<FbxSurfaceMaterial*>;
extern template class FBXSDK_DLL FbxLayerElementTemplate<FbxTexture*>;

/// What every class of elements declares. The new element belongs to the owner but is in no layer yet; with a null
/// owner it belongs to nobody until it is put into a layer.
#define FBXSDK_LAYER_ELEMENT_DECLARE(Class)                                                                            \
public:                                                                                                                \
    static Class* Create(FbxLayerContainer* pOwner, const char* pName);                                                \
                                                                                                                       \
protected:                                                                                                             \
    FBXSDK_LOCAL Class();                                                                                              \
    FBXSDK_LOCAL ~Class() override;                                                                                    \
                                                                                                                       \
private:                                                                                                               \
    friend struct detail::LayerElementAccess;

class FBXSDK_DLL FbxLayerElementNormal : public FbxLayerElementTemplate<FbxVector4> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementNormal)
};
class FBXSDK_DLL FbxLayerElementBinormal : public FbxLayerElementTemplate<FbxVector4> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementBinormal)
};
class FBXSDK_DLL FbxLayerElementTangent : public FbxLayerElementTemplate<FbxVector4> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementTangent)
};
/// Elements read from files number the materials of the node in the index array; the direct array is empty.
class FBXSDK_DLL FbxLayerElementMaterial : public FbxLayerElementTemplate<FbxSurfaceMaterial*> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementMaterial)
};
/// Elements read from files have the groups in the index array, reference eIndex.
class FBXSDK_DLL FbxLayerElementPolygonGroup : public FbxLayerElementTemplate<int> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementPolygonGroup)
};
class FBXSDK_DLL FbxLayerElementUV : public FbxLayerElementTemplate<FbxVector2> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementUV)
};
class FBXSDK_DLL FbxLayerElementVertexColor : public FbxLayerElementTemplate<FbxColor> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementVertexColor)
};
/// By polygon the values are bits of smoothing groups, by edge 0 is hard and anything else soft.
class FBXSDK_DLL FbxLayerElementSmoothing : public FbxLayerElementTemplate<int> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementSmoothing)
};
/// Creases of edges or of control points.
class FBXSDK_DLL FbxLayerElementCrease : public FbxLayerElementTemplate<double> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementCrease)
};
class FBXSDK_DLL FbxLayerElementHole : public FbxLayerElementTemplate<bool> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementHole)
};
class FBXSDK_DLL FbxLayerElementVisibility : public FbxLayerElementTemplate<bool> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementVisibility)
};
/// Elements read from files number the textures of the node in the index array; the direct array is empty.
class FBXSDK_DLL FbxLayerElementTexture : public FbxLayerElementTemplate<FbxTexture*> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementTexture)
};

typedef FbxLayerElement FbxGeometryElement;
typedef FbxLayerElementNormal FbxGeometryElementNormal;
typedef FbxLayerElementBinormal FbxGeometryElementBinormal;
typedef FbxLayerElementTangent FbxGeometryElementTangent;
typedef FbxLayerElementMaterial FbxGeometryElementMaterial;
typedef FbxLayerElementPolygonGroup FbxGeometryElementPolygonGroup;
typedef FbxLayerElementUV FbxGeometryElementUV;
typedef FbxLayerElementVertexColor FbxGeometryElementVertexColor;
typedef FbxLayerElementSmoothing FbxGeometryElementSmoothing;
typedef FbxLayerElementCrease FbxGeometryElementCrease;
typedef FbxLayerElementHole FbxGeometryElementHole;
typedef FbxLayerElementVisibility FbxGeometryElementVisibility;

/// At most one element of each type; textures and texture coordinates one for each texture channel.
///
/// Getters are null when the layer has no such element. Setters replace it and hand the new one to the layer's
/// container; null takes it out.
class FBXSDK_DLL FbxLayer {
public:
    FbxLayer(const FbxLayer&) = delete;
    FbxLayer& operator=(const FbxLayer&) = delete;

    [[nodiscard]] FbxLayerElementNormal* GetNormals() { return get<FbxLayerElementNormal>(FbxLayerElement::eNormal); }
    [[nodiscard]] const FbxLayerElementNormal* GetNormals() const {
        return get<FbxLayerElementNormal>(FbxLayerElement::eNormal);
    }
    void SetNormals(FbxLayerElementNormal* pNormals) { set(pNormals, FbxLayerElement::eNormal); }

    [[nodiscard]] FbxLayerElementBinormal* GetBinormals() {
        return get<FbxLayerElementBinormal>(FbxLayerElement::eBiNormal);
    }
    [[nodiscard]] const FbxLayerElementBinormal* GetBinormals() const {
        return get<FbxLayerElementBinormal>(FbxLayerElement::eBiNormal);
    }
    void SetBinormals(FbxLayerElementBinormal* pBinormals) { set(pBinormals, FbxLayerElement::eBiNormal); }

    [[nodiscard]] FbxLayerElementTangent* GetTangents() {
        return get<FbxLayerElementTangent>(FbxLayerElement::eTangent);
    }
    [[nodiscard]] const FbxLayerElementTangent* GetTangents() const {
        return get<FbxLayerElementTangent>(FbxLayerElement::eTangent);
    }
    void SetTangents(FbxLayerElementTangent* pTangents) { set(pTangents, FbxLayerElement::eTangent); }

    [[nodiscard]] FbxLayerElementMaterial* GetMaterials() {
        return get<FbxLayerElementMaterial>(FbxLayerElement::eMaterial);
    }
    [[nodiscard]] const FbxLayerElementMaterial* GetMaterials() const {
        return get<FbxLayerElementMaterial>(FbxLayerElement::eMaterial);
    }
    void SetMaterials(FbxLayerElementMaterial* pMaterials) { set(pMaterials, FbxLayerElement::eMaterial); }

    [[nodiscard]] FbxLayerElementPolygonGroup* GetPolygonGroups() {
        return get<FbxLayerElementPolygonGroup>(FbxLayerElement::ePolygonGroup);
    }
    [[nodiscard]] const FbxLayerElementPolygonGroup* GetPolygonGroups() const {
        return get<FbxLayerElementPolygonGroup>(FbxLayerElement::ePolygonGroup);
    }
    void SetPolygonGroups(FbxLayerElementPolygonGroup* pGroups) { set(pGroups, FbxLayerElement::ePolygonGroup); }

    /// The set of a texture channel; the diffuse one is the layer's ordinary set. Null for types that are no channel.
    [[nodiscard]] FbxLayerElementUV* GetUVs(FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eTextureDiffuse) {
        return isTextureChannel(pTypeIdentifier) ? get<FbxLayerElementUV>(uvSlot(pTypeIdentifier)) : nullptr;
    }
    [[nodiscard]] const FbxLayerElementUV*
    GetUVs(FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eTextureDiffuse) const {
        return isTextureChannel(pTypeIdentifier) ? get<FbxLayerElementUV>(uvSlot(pTypeIdentifier)) : nullptr;
    }
    void SetUVs(FbxLayerElementUV* pUVs, FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eTextureDiffuse) {
        if (isTextureChannel(pTypeIdentifier))
            set(pUVs, uvSlot(pTypeIdentifier));
    }

    [[nodiscard]] FbxLayerElementVertexColor* GetVertexColors() {
        return get<FbxLayerElementVertexColor>(FbxLayerElement::eVertexColor);
    }
    [[nodiscard]] const FbxLayerElementVertexColor* GetVertexColors() const {
        return get<FbxLayerElementVertexColor>(FbxLayerElement::eVertexColor);
    }
    void SetVertexColors(FbxLayerElementVertexColor* pColors) { set(pColors, FbxLayerElement::eVertexColor); }

    [[nodiscard]] FbxLayerElementSmoothing* GetSmoothing() {
        return get<FbxLayerElementSmoothing>(FbxLayerElement::eSmoothing);
    }
    [[nodiscard]] const FbxLayerElementSmoothing* GetSmoothing() const {
        return get<FbxLayerElementSmoothing>(FbxLayerElement::eSmoothing);
    }
    void SetSmoothing(FbxLayerElementSmoothing* pSmoothing) { set(pSmoothing, FbxLayerElement::eSmoothing); }

    [[nodiscard]] FbxLayerElementCrease* GetVertexCrease() {
        return get<FbxLayerElementCrease>(FbxLayerElement::eVertexCrease);
    }
    [[nodiscard]] const FbxLayerElementCrease* GetVertexCrease() const {
        return get<FbxLayerElementCrease>(FbxLayerElement::eVertexCrease);
    }
    void SetVertexCrease(FbxLayerElementCrease* pCrease) { set(pCrease, FbxLayerElement::eVertexCrease); }

    [[nodiscard]] FbxLayerElementCrease* GetEdgeCrease() {
        return get<FbxLayerElementCrease>(FbxLayerElement::eEdgeCrease);
    }
    [[nodiscard]] const FbxLayerElementCrease* GetEdgeCrease() const {
        return get<FbxLayerElementCrease>(FbxLayerElement::eEdgeCrease);
    }
    void SetEdgeCrease(FbxLayerElementCrease* pCrease) { set(pCrease, FbxLayerElement::eEdgeCrease); }

    [[nodiscard]] FbxLayerElementHole* GetHole() { return get<FbxLayerElementHole>(FbxLayerElement::eHole); }
    [[nodiscard]] const FbxLayerElementHole* GetHole() const {
        return get<FbxLayerElementHole>(FbxLayerElement::eHole);
    }
    void SetHole(FbxLayerElementHole* pHole) { set(pHole, FbxLayerElement::eHole); }

    [[nodiscard]] FbxLayerElementVisibility* GetVisibility() {
        return get<FbxLayerElementVisibility>(FbxLayerElement::eVisibility);
    }
    [[nodiscard]] const FbxLayerElementVisibility* GetVisibility() const {
        return get<FbxLayerElementVisibility>(FbxLayerElement::eVisibility);
    }
    void SetVisibility(FbxLayerElementVisibility* pVisibility) { set(pVisibility, FbxLayerElement::eVisibility); }

    /// The textures of a channel; null for types that are no channel.
    [[nodiscard]] FbxLayerElementTexture* GetTextures(FbxLayerElement::EType pType) {
        return isTextureChannel(pType) ? get<FbxLayerElementTexture>(pType) : nullptr;
    }
    [[nodiscard]] const FbxLayerElementTexture* GetTextures(FbxLayerElement::EType pType) const {
        return isTextureChannel(pType) ? get<FbxLayerElementTexture>(pType) : nullptr;
    }
    void SetTextures(FbxLayerElement::EType pType, FbxLayerElementTexture* pTextures) {
        if (isTextureChannel(pType))
            set(pTextures, pType);
    }

private:
    friend class FbxLayerContainer;
    friend struct detail::LayerElementAccess;

    explicit FbxLayer(FbxLayerContainer& pOwner) : mOwner(pOwner) {}
    ~FbxLayer() = default;

    // A slot is an element type, or, from eTypeCount on, the texture coordinates of a texture channel.
    static constexpr int kSlotCount = 2 * FbxLayerElement::eTypeCount - FbxLayerElement::eTextureDiffuse;
    [[nodiscard]] static bool isTextureChannel(int pType) {
        return pType >= FbxLayerElement::eTextureDiffuse && pType < FbxLayerElement::eTypeCount;
    }
    [[nodiscard]] static int uvSlot(int pChannel) {
        return FbxLayerElement::eTypeCount + pChannel - FbxLayerElement::eTextureDiffuse;
    }

    template <class Element>
    [[nodiscard]] Element* get(int pSlot) const {
        return static_cast<Element*>(mElements[pSlot]);
    }
    void set(FbxLayerElement* pElement, int pSlot);
    FBXSDK_LOCAL void forget(const FbxLayerElement& pElement);

    FbxLayerContainer& mOwner;
    FbxLayerElement* mElements[kSlotCount] = {};
};

/// A node attribute with layers. What stands in a file is read on the first access.
class FBXSDK_DLL FbxLayerContainer : public FbxNodeAttribute {
    FBXSDK_ABSTRACT_DECLARE(FbxLayerContainer, FbxNodeAttribute)

public:
    /// The new layer's index.
    int CreateLayer();
    /// Removes all layers. The elements that stood in them live on until the container's end.
    void ClearLayers();
    [[nodiscard]] int GetLayerCount() const {
        ensureLoaded();
        return static_cast<int>(mLayers.size());
    }
    /// How many layers have an element of the type; with pUVCount, texture coordinates of the texture channel.
    [[nodiscard]] int GetLayerCount(FbxLayerElement::EType pType, bool pUVCount = false) const;
    /// Null out of range.
    [[nodiscard]] FbxLayer* GetLayer(int pIndex) { return layerAt(pIndex); }
    [[nodiscard]] const FbxLayer* GetLayer(int pIndex) const { return layerAt(pIndex); }

    /// For the scene reader: what the file holds of this object becomes its content on the first access.
    void setSource(std::unique_ptr<detail::GeometrySource> pSource);
    [[nodiscard]] bool isPending() const { return mSource != nullptr; }

protected:
    /// Every access to what may still stand in the file starts with this.
    void ensureLoaded() const {
        if (mSource)
            loadSource();
    }
    /// What follows changes the object: it is read if it can be, and the file is done with.
    FBXSDK_LOCAL void detachSource();
    /// Fills the object from the file. False when that is not possible yet; the next access tries again.
    virtual bool readSource(const detail::GeometrySource& pSource) = 0;

    /// For every element that stands in a layer and is mapped that way.
    FBXSDK_LOCAL void removeElementEntries(FbxLayerElement::EMappingMode pMappingMode, int pFirst, int pCount);

private:
    friend class FbxLayer;
    friend class FbxLayerElement;
    friend struct detail::LayerElementAccess;

    struct LayerDeleter {
        void operator()(FbxLayer* pLayer) const { delete pLayer; }
    };

    void loadSource() const;
    FBXSDK_LOCAL void adopt(FbxLayerElement& pElement);
    FBXSDK_LOCAL void disown(FbxLayerElement& pElement);
    [[nodiscard]] FbxLayer* layerAt(int pIndex) const {
        return pIndex >= 0 && pIndex < GetLayerCount() ? mLayers[static_cast<std::size_t>(pIndex)].get() : nullptr;
    }

    std::vector<std::unique_ptr<FbxLayer, LayerDeleter>> mLayers;
    std::vector<FbxLayerElement*> mElements; ///< all that belong to the container
    mutable std::unique_ptr<detail::GeometrySource> mSource;
};

FBXSDK_NAMESPACE_END
