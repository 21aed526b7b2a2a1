// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data of geometry other than its points: normals, texture coordinates, colours, materials, … as elements in
// layers.
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

/// The value of new items of an array: all bits zero, the w of vectors and the alpha of colours included.
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

/// The value of new items of an array.
enum EFbxMemoryClearMode {
    eClearToZero ///< all bits zero
};

/// The type-independent part of an element's array. Arrays belong to their element.
class FBXSDK_DLL FbxLayerElementArray {
public:
    /// The use of a pointer to the items; without effect, as nothing is locked.
    enum ELockMode {
        eReadLock = 1,     ///< reading
        eWriteLock = 2,    ///< writing
        eReadWriteLock = 3 ///< both
    };

    FbxLayerElementArray(const FbxLayerElementArray&) = delete;
    FbxLayerElementArray& operator=(const FbxLayerElementArray&) = delete;

    [[nodiscard]] int GetCount() const { return mStorage.count(); } ///< How many items there are.

protected:
    explicit FbxLayerElementArray(detail::PlainStorage& pStorage) : mStorage(pStorage) {} ///< For the array of a type.
    ~FbxLayerElementArray() = default;

private:
    detail::PlainStorage& mStorage;
};

/// A contiguous array of plain items. New items are all zero; an index out of range reads as a zero item and writes
/// nowhere.
///
/// Items of a file are read on the first access; a file that has been changed since then makes such a call throw
/// std::runtime_error.
template <class T>
class FbxLayerElementArrayTemplate : public FbxLayerElementArray {
public:
    FbxLayerElementArrayTemplate() : FbxLayerElementArray(mItems) {} ///< No items.

    [[nodiscard]] int GetCount() const { return mItems.count(); } ///< How many items there are.
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
    void Clear() { mItems.clear(); } ///< Removes all items.

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
    /// No effect out of range.
    void SetAt(int pIndex, T const& pItem) {
        if (mItems.contains(pIndex))
            mItems[pIndex] = pItem;
    }
    void SetLast(T const& pItem) { SetAt(GetCount() - 1, pItem); } ///< No effect without items.

    /// A copy; a zero item out of range.
    [[nodiscard]] T GetAt(int pIndex) const {
        return mItems.contains(pIndex) ? mItems.value(pIndex) : detail::zeroItem<T>();
    }
    [[nodiscard]] T GetFirst() const { return GetAt(0); }             ///< A zero item when there are none.
    [[nodiscard]] T GetLast() const { return GetAt(GetCount() - 1); } ///< A zero item when there are none.
    /// The removed item; a zero item when there is none at the index.
    T RemoveAt(int pIndex) {
        const T removed = GetAt(pIndex);
        if (mItems.contains(pIndex))
            mItems.remove(pIndex);
        return removed;
    }
    T RemoveLast() { return RemoveAt(GetCount() - 1); } ///< The removed item; a zero item when there is none.
    /// Removes the first equal item; false when there is none.
    bool RemoveIt(T const& pItem) {
        const int index = Find(pItem);
        if (index >= 0)
            mItems.remove(index);
        return index >= 0;
    }
    /// The index of the first equal item; -1 when there is none.
    [[nodiscard]] int Find(T const& pItem) const {
        const T* found = std::find(mItems.begin(), mItems.end(), pItem);
        return found == mItems.end() ? -1 : static_cast<int>(found - mItems.begin());
    }
    /// Makes pArray hold the same items and no others.
    void CopyTo(FbxArray<T>& pArray) const {
        pArray.Resize(GetCount());
        for (int i = 0; i < GetCount(); ++i)
            pArray[i] = mItems.value(i);
    }

    /// Unlike elsewhere the index must be in range.
    T& operator[](int pIndex) const { return mItems[pIndex]; }

    /// All items, contiguous; null when there are none. Nothing is locked: the pointer is valid until the count
    /// changes.
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

/// One property of the points, corners or polygons of a geometry: values, indices of values, and what they belong to.
/// Owned by its container until Destroy or the container's end, whether it is in a layer or not.
class FBXSDK_DLL FbxLayerElement {
public:
    /// What the element is. The numbers are part of the API.
    enum EType {
        eUnknown,                   ///< none of the others
        eNormal,                    ///< normals
        eBiNormal,                  ///< binormals
        eTangent,                   ///< tangents
        eMaterial,                  ///< materials
        ePolygonGroup,              ///< groups of polygons
        eUV,                        ///< texture coordinates
        eVertexColor,               ///< colours
        eSmoothing,                 ///< smoothing groups, or hard and soft edges
        eVertexCrease,              ///< creases of control points
        eEdgeCrease,                ///< creases of edges
        eHole,                      ///< polygons that are holes
        eUserData,                  ///< of the API; no class here has it
        eVisibility,                ///< what is shown
        eTextureDiffuse,            ///< the texture channel of the diffuse colour
        eTextureDiffuseFactor,      ///< of its factor
        eTextureEmissive,           ///< of the emitted colour
        eTextureEmissiveFactor,     ///< of its factor
        eTextureAmbient,            ///< of the ambient colour
        eTextureAmbientFactor,      ///< of its factor
        eTextureSpecular,           ///< of the highlights
        eTextureSpecularFactor,     ///< of their factor
        eTextureShininess,          ///< of the exponent of the highlights
        eTextureNormalMap,          ///< of normals
        eTextureBump,               ///< of heights
        eTextureTransparency,       ///< of the transparent colour
        eTextureTransparencyFactor, ///< of its factor
        eTextureReflection,         ///< of reflections
        eTextureReflectionFactor,   ///< of their factor
        eTextureDisplacement,       ///< of displacements along the normal
        eTextureDisplacementVector, ///< of displacements in all directions
        eTypeCount                  ///< how many types there are; none itself
    };
    /// What one value belongs to.
    enum EMappingMode {
        eNone,            ///< nothing; the value of a new element
        eByControlPoint,  ///< a control point
        eByPolygonVertex, ///< a corner of a polygon
        eByPolygon,       ///< a polygon
        eByEdge,          ///< an edge
        eAllSame          ///< everything
    };
    /// Where the n-th value is.
    enum EReferenceMode {
        eDirect,       ///< direct[n]
        eIndex,        ///< index[n] itself, for numbers without a direct array
        eIndexToDirect ///< direct[index[n]]
    };

    FbxLayerElement(const FbxLayerElement&) = delete;
    FbxLayerElement& operator=(const FbxLayerElement&) = delete;

    void SetMappingMode(EMappingMode pMappingMode) { mMappingMode = pMappingMode; } ///< The arrays stay as they are.
    [[nodiscard]] EMappingMode GetMappingMode() const { return mMappingMode; }      ///< eNone for a new element.
    /// The arrays stay as they are.
    void SetReferenceMode(EReferenceMode pReferenceMode) { mReferenceMode = pReferenceMode; }
    [[nodiscard]] EReferenceMode GetReferenceMode() const { return mReferenceMode; } ///< eDirect for a new element.
    void SetName(const char* pName) { mName = pName ? pName : ""; }                  ///< UTF-8; null is the empty name.
    [[nodiscard]] const char* GetName() const { return mName.c_str(); } ///< Never null; valid until the name changes.

    /// Removes the element from its layers and frees it.
    void Destroy();

protected:
    FBXSDK_LOCAL FbxLayerElement(); ///< For derived classes.
    FBXSDK_LOCAL virtual ~FbxLayerElement();

    FBXSDK_LOCAL void joinOwner(FbxLayerContainer* pOwner); ///< Transfers it to the container; null changes nothing.
    /// Removes entries from the array that the mapping indexes: the index array where indices are in use.
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

/// An element whose values are of type T. Arrays of a file are read on the first access.
template <class T>
class FbxLayerElementTemplate : public FbxLayerElement {
public:
    using ArrayElementType = T; ///< The type of the values.

    /// Throws std::runtime_error when there is no such array, which happens in damaged elements only.
    [[nodiscard]] FbxLayerElementArrayTemplate<T>& GetDirectArray() const {
        if (!mDirectArray)
            detail::throwMissingDirectArray();
        return *mDirectArray;
    }
    /// Empty unless the reference mode uses indices.
    [[nodiscard]] FbxLayerElementArrayTemplate<int>& GetIndexArray() const {
        if (!mIndexArray)
            detail::throwMissingIndexArray();
        return *mIndexArray;
    }
    /// Empties both arrays; always true.
    bool Clear();

protected:
    FbxLayerElementTemplate(); ///< Two empty arrays.
    ~FbxLayerElementTemplate() override;

    /// Removes entries from the array that the mapping indexes.
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

/// The declarations common to all element classes. The new element belongs to the owner but is in no layer yet; with a
/// null owner it has no owner until it is put into a layer.
#define FBXSDK_LAYER_ELEMENT_DECLARE(Class)                                                                            \
public:                                                                                                                \
    /** Makes an element that belongs to the owner and is in no layer yet; a null name is the empty name. */           \
    static Class* Create(FbxLayerContainer* pOwner, const char* pName);                                                \
                                                                                                                       \
protected:                                                                                                             \
    /** For Create. */                                                                                                 \
    FBXSDK_LOCAL Class();                                                                                              \
    FBXSDK_LOCAL ~Class() override;                                                                                    \
                                                                                                                       \
private:                                                                                                               \
    friend struct detail::LayerElementAccess;

/// Normals, of length 1 in most files; they are returned as stored, the w too: 1 where a file has none.
class FBXSDK_DLL FbxLayerElementNormal : public FbxLayerElementTemplate<FbxVector4> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementNormal)
};
/// Binormals: perpendicular to normal and tangent.
class FBXSDK_DLL FbxLayerElementBinormal : public FbxLayerElementTemplate<FbxVector4> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementBinormal)
};
/// Tangents: the direction in which u grows.
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
/// Texture coordinates, usually with indices; the image is between 0 and 1.
class FBXSDK_DLL FbxLayerElementUV : public FbxLayerElementTemplate<FbxVector2> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementUV)
};
/// Colours, 0 to 1.
class FBXSDK_DLL FbxLayerElementVertexColor : public FbxLayerElementTemplate<FbxColor> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementVertexColor)
};
/// By polygon the values are bits of smoothing groups; by edge 0 is hard and anything else soft.
class FBXSDK_DLL FbxLayerElementSmoothing : public FbxLayerElementTemplate<int> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementSmoothing)
};
/// Creases of edges or of control points.
class FBXSDK_DLL FbxLayerElementCrease : public FbxLayerElementTemplate<double> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementCrease)
};
/// By polygon: whether it is a hole.
class FBXSDK_DLL FbxLayerElementHole : public FbxLayerElementTemplate<bool> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementHole)
};
/// Whether an edge or polygon is shown.
class FBXSDK_DLL FbxLayerElementVisibility : public FbxLayerElementTemplate<bool> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementVisibility)
};
/// Elements read from files number the textures of the node in the index array; the direct array is empty.
class FBXSDK_DLL FbxLayerElementTexture : public FbxLayerElementTemplate<FbxTexture*> {
    FBXSDK_LAYER_ELEMENT_DECLARE(FbxLayerElementTexture)
};

typedef FbxLayerElement FbxGeometryElement;                         ///< An alias of the API.
typedef FbxLayerElementNormal FbxGeometryElementNormal;             ///< An alias of the API.
typedef FbxLayerElementBinormal FbxGeometryElementBinormal;         ///< An alias of the API.
typedef FbxLayerElementTangent FbxGeometryElementTangent;           ///< An alias of the API.
typedef FbxLayerElementMaterial FbxGeometryElementMaterial;         ///< An alias of the API.
typedef FbxLayerElementPolygonGroup FbxGeometryElementPolygonGroup; ///< An alias of the API.
typedef FbxLayerElementUV FbxGeometryElementUV;                     ///< An alias of the API.
typedef FbxLayerElementVertexColor FbxGeometryElementVertexColor;   ///< An alias of the API.
typedef FbxLayerElementSmoothing FbxGeometryElementSmoothing;       ///< An alias of the API.
typedef FbxLayerElementCrease FbxGeometryElementCrease;             ///< An alias of the API.
typedef FbxLayerElementHole FbxGeometryElementHole;                 ///< An alias of the API.
typedef FbxLayerElementVisibility FbxGeometryElementVisibility;     ///< An alias of the API.

/// A set of elements: at most one of each type; textures and texture coordinates one for each texture channel.
///
/// Layers belong to their container. Getters are null when the layer has no such element. Setters replace it and
/// transfer the new one to the layer's container; null removes it, and the container still owns it.
class FBXSDK_DLL FbxLayer {
public:
    FbxLayer(const FbxLayer&) = delete;
    FbxLayer& operator=(const FbxLayer&) = delete;

    /// The layer's normals; null when it has none.
    [[nodiscard]] FbxLayerElementNormal* GetNormals() { return get<FbxLayerElementNormal>(FbxLayerElement::eNormal); }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementNormal* GetNormals() const {
        return get<FbxLayerElementNormal>(FbxLayerElement::eNormal);
    }
    /// Puts them into the layer, replacing any others.
    void SetNormals(FbxLayerElementNormal* pNormals) { set(pNormals, FbxLayerElement::eNormal); }

    /// The layer's binormals; null when it has none.
    [[nodiscard]] FbxLayerElementBinormal* GetBinormals() {
        return get<FbxLayerElementBinormal>(FbxLayerElement::eBiNormal);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementBinormal* GetBinormals() const {
        return get<FbxLayerElementBinormal>(FbxLayerElement::eBiNormal);
    }
    /// Puts them into the layer, replacing any others.
    void SetBinormals(FbxLayerElementBinormal* pBinormals) { set(pBinormals, FbxLayerElement::eBiNormal); }

    /// The layer's tangents; null when it has none.
    [[nodiscard]] FbxLayerElementTangent* GetTangents() {
        return get<FbxLayerElementTangent>(FbxLayerElement::eTangent);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementTangent* GetTangents() const {
        return get<FbxLayerElementTangent>(FbxLayerElement::eTangent);
    }
    /// Puts them into the layer, replacing any others.
    void SetTangents(FbxLayerElementTangent* pTangents) { set(pTangents, FbxLayerElement::eTangent); }

    /// Which material of the node each polygon has; null when the layer does not define it.
    [[nodiscard]] FbxLayerElementMaterial* GetMaterials() {
        return get<FbxLayerElementMaterial>(FbxLayerElement::eMaterial);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementMaterial* GetMaterials() const {
        return get<FbxLayerElementMaterial>(FbxLayerElement::eMaterial);
    }
    /// Puts them into the layer, replacing any others.
    void SetMaterials(FbxLayerElementMaterial* pMaterials) { set(pMaterials, FbxLayerElement::eMaterial); }

    /// The group of each polygon; null when the layer does not define it.
    [[nodiscard]] FbxLayerElementPolygonGroup* GetPolygonGroups() {
        return get<FbxLayerElementPolygonGroup>(FbxLayerElement::ePolygonGroup);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementPolygonGroup* GetPolygonGroups() const {
        return get<FbxLayerElementPolygonGroup>(FbxLayerElement::ePolygonGroup);
    }
    /// Puts them into the layer, replacing any others.
    void SetPolygonGroups(FbxLayerElementPolygonGroup* pGroups) { set(pGroups, FbxLayerElement::ePolygonGroup); }

    /// The set of a texture channel; the diffuse one is the layer's default set. Null for types that are no channel.
    [[nodiscard]] FbxLayerElementUV* GetUVs(FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eTextureDiffuse) {
        return isTextureChannel(pTypeIdentifier) ? get<FbxLayerElementUV>(uvSlot(pTypeIdentifier)) : nullptr;
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementUV*
    GetUVs(FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eTextureDiffuse) const {
        return isTextureChannel(pTypeIdentifier) ? get<FbxLayerElementUV>(uvSlot(pTypeIdentifier)) : nullptr;
    }
    /// Puts the set into the layer as that of the channel; types that are no channel change nothing.
    void SetUVs(FbxLayerElementUV* pUVs, FbxLayerElement::EType pTypeIdentifier = FbxLayerElement::eTextureDiffuse) {
        if (isTextureChannel(pTypeIdentifier))
            set(pUVs, uvSlot(pTypeIdentifier));
    }

    /// The layer's colours; null when it has none.
    [[nodiscard]] FbxLayerElementVertexColor* GetVertexColors() {
        return get<FbxLayerElementVertexColor>(FbxLayerElement::eVertexColor);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementVertexColor* GetVertexColors() const {
        return get<FbxLayerElementVertexColor>(FbxLayerElement::eVertexColor);
    }
    /// Puts them into the layer, replacing any others.
    void SetVertexColors(FbxLayerElementVertexColor* pColors) { set(pColors, FbxLayerElement::eVertexColor); }

    /// The smoothing of edges or polygons; null when the layer does not define it.
    [[nodiscard]] FbxLayerElementSmoothing* GetSmoothing() {
        return get<FbxLayerElementSmoothing>(FbxLayerElement::eSmoothing);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementSmoothing* GetSmoothing() const {
        return get<FbxLayerElementSmoothing>(FbxLayerElement::eSmoothing);
    }
    /// Puts it into the layer, replacing any other.
    void SetSmoothing(FbxLayerElementSmoothing* pSmoothing) { set(pSmoothing, FbxLayerElement::eSmoothing); }

    /// The creases of control points; null when the layer has none.
    [[nodiscard]] FbxLayerElementCrease* GetVertexCrease() {
        return get<FbxLayerElementCrease>(FbxLayerElement::eVertexCrease);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementCrease* GetVertexCrease() const {
        return get<FbxLayerElementCrease>(FbxLayerElement::eVertexCrease);
    }
    /// Puts them into the layer, replacing any others.
    void SetVertexCrease(FbxLayerElementCrease* pCrease) { set(pCrease, FbxLayerElement::eVertexCrease); }

    /// The creases of edges; null when the layer has none.
    [[nodiscard]] FbxLayerElementCrease* GetEdgeCrease() {
        return get<FbxLayerElementCrease>(FbxLayerElement::eEdgeCrease);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementCrease* GetEdgeCrease() const {
        return get<FbxLayerElementCrease>(FbxLayerElement::eEdgeCrease);
    }
    /// Puts them into the layer, replacing any others.
    void SetEdgeCrease(FbxLayerElementCrease* pCrease) { set(pCrease, FbxLayerElement::eEdgeCrease); }

    /// Which polygons are holes; null when the layer does not define it.
    [[nodiscard]] FbxLayerElementHole* GetHole() { return get<FbxLayerElementHole>(FbxLayerElement::eHole); }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementHole* GetHole() const {
        return get<FbxLayerElementHole>(FbxLayerElement::eHole);
    }
    /// Puts it into the layer, replacing any other.
    void SetHole(FbxLayerElementHole* pHole) { set(pHole, FbxLayerElement::eHole); }

    /// Which edges or polygons are shown; null when the layer does not define it.
    [[nodiscard]] FbxLayerElementVisibility* GetVisibility() {
        return get<FbxLayerElementVisibility>(FbxLayerElement::eVisibility);
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementVisibility* GetVisibility() const {
        return get<FbxLayerElementVisibility>(FbxLayerElement::eVisibility);
    }
    /// Puts it into the layer, replacing any other.
    void SetVisibility(FbxLayerElementVisibility* pVisibility) { set(pVisibility, FbxLayerElement::eVisibility); }

    /// The textures of a channel; null for types that are no channel.
    [[nodiscard]] FbxLayerElementTexture* GetTextures(FbxLayerElement::EType pType) {
        return isTextureChannel(pType) ? get<FbxLayerElementTexture>(pType) : nullptr;
    }
    /// The same for a const layer.
    [[nodiscard]] const FbxLayerElementTexture* GetTextures(FbxLayerElement::EType pType) const {
        return isTextureChannel(pType) ? get<FbxLayerElementTexture>(pType) : nullptr;
    }
    /// Puts them into the layer as those of the channel; types that are no channel change nothing.
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

/// A node attribute with layers. The content of a file is read on the first access.
class FBXSDK_DLL FbxLayerContainer : public FbxNodeAttribute {
    FBXSDK_ABSTRACT_DECLARE(FbxLayerContainer, FbxNodeAttribute)

public:
    /// Appends an empty layer. The new layer's index.
    int CreateLayer();
    /// Removes all layers. Their elements still belong to the container.
    void ClearLayers();
    /// How many layers there are; 0 for new geometry.
    [[nodiscard]] int GetLayerCount() const {
        ensureLoaded();
        return static_cast<int>(mLayers.size());
    }
    /// How many layers have an element of the type; with pUVCount, texture coordinates of the texture channel.
    [[nodiscard]] int GetLayerCount(FbxLayerElement::EType pType, bool pUVCount = false) const;
    /// The layer at that index, owned by the container; null out of range.
    [[nodiscard]] FbxLayer* GetLayer(int pIndex) { return layerAt(pIndex); }
    /// The same for a const container.
    [[nodiscard]] const FbxLayer* GetLayer(int pIndex) const { return layerAt(pIndex); }

    /// For the scene reader: the content of this object in the file is read into it on the first access.
    void setSource(std::unique_ptr<detail::GeometrySource> pSource);
    [[nodiscard]] bool isPending() const { return mSource != nullptr; } ///< Whether the content is still to be read.

protected:
    /// Every access to content that may not be read yet starts with this.
    void ensureLoaded() const {
        if (mSource)
            loadSource();
    }
    /// To be called before a change: the content is read if it can be, and the file is not used again.
    FBXSDK_LOCAL void detachSource();
    /// Fills the object from the file. False when that is not possible yet; the next access tries again.
    virtual bool readSource(const detail::GeometrySource& pSource) = 0;

    /// Removes the entries of every element that is in a layer and is mapped that way.
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
    std::vector<FbxLayerElement*> mElements; ///< all elements that the container owns
    mutable std::unique_ptr<detail::GeometrySource> mSource;
};

FBXSDK_NAMESPACE_END
