// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Polygons, and the elements of layer 0 for their corners.
#include <fbxsdk/FbxMesh.h>

#include <fbxsdk/FbxNode.h>

#include "geometry/ArraysAhead.h"
#include "geometry/GeometryReading.h"
#include "geometry/ItemReading.h"
#include "geometry/tessellation/TessellationMesh.h"
#include "object/ManagerData.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN

FBXSDK_OBJECT_IMPLEMENT(FbxMesh, FbxGeometry, detail::kMeshRows)

namespace {

/// The index of an element's value for item i; -1 when it has none.
template <class T>
int valueIndex(const FbxLayerElementTemplate<T>& element, int item) {
    if (element.GetReferenceMode() == FbxLayerElement::eDirect)
        return item;
    const FbxLayerElementArrayTemplate<int>& indices = element.GetIndexArray();
    return item >= 0 && item < indices.GetCount() ? indices.GetAt(item) : -1;
}

/// Sets the entry of an index array for one item, with zeros for earlier items that are not set.
void setIndex(FbxLayerElementArrayTemplate<int>& indices, int item, int value) {
    if (indices.GetCount() <= item)
        indices.SetCount(item + 1);
    indices.SetAt(item, value);
}

template <class T>
void setPolygonIndex(FbxLayerElementTemplate<T>* element, int polygon, int value) {
    if (value >= 0 && element && element->GetMappingMode() == FbxLayerElement::eByPolygon)
        setIndex(element->GetIndexArray(), polygon, value);
}

} // namespace

FbxMesh::FbxMesh(FbxManager& pManager, const detail::ClassInfo& pInfo) : FbxGeometry(pManager, pInfo) {}

FbxMesh::~FbxMesh() = default;

FbxNodeAttribute::EType FbxMesh::GetAttributeType() const { return eMesh; }

bool FbxMesh::readSource(const detail::GeometrySource& pSource) {
    if (pSource.surface)
        return detail::fillMesh(*this, *pSource.surface);
    detail::GeometrySource source = pSource;
    source.ahead = detail::ArraysAhead::ofMesh(*source.body, *source.document);
    mRepairedCorners = detail::readMesh(*this, source);
    detail::readLayers(*this, source);
    if (const detail::Record* edges = pSource.body->child("Edges"))
        detail::readLate(pSource.document, *edges, mEdges, detail::LateReading::whole);
    return true;
}

detail::PlainArray<int>& FbxMesh::edges() {
    ensureLoaded();
    return mEdges;
}

void FbxMesh::dropEdges() { mEdges.clear(); }

void FbxMesh::BeginPolygon(int pMaterial, int pTexture, int pGroup, bool /*pLegacy*/) {
    detachSource();
    dropEdges();
    mPolygonStarts.add(mPolygonVertices.count());
    mPolygonOpen = true;
    FbxLayer* layer = GetLayer(0);
    if (!layer)
        return;
    const int polygon = mPolygonStarts.count() - 1;
    setPolygonIndex(layer->GetMaterials(), polygon, pMaterial);
    setPolygonIndex(layer->GetTextures(FbxLayerElement::eTextureDiffuse), polygon, pTexture);
    setPolygonIndex(layer->GetPolygonGroups(), polygon, pGroup);
}

void FbxMesh::AddPolygon(int pIndex, int pTextureUVIndex) {
    if (!mPolygonOpen)
        return;
    mPolygonVertices.add(pIndex);
    FbxLayer* layer = GetLayer(0);
    FbxLayerElementUV* uvs = pTextureUVIndex >= 0 && layer ? layer->GetUVs() : nullptr;
    if (uvs && uvs->GetMappingMode() == FbxLayerElement::eByPolygonVertex &&
        uvs->GetReferenceMode() != FbxLayerElement::eDirect)
        setIndex(uvs->GetIndexArray(), mPolygonVertices.count() - 1, pTextureUVIndex);
}

void FbxMesh::EndPolygon() { mPolygonOpen = false; }

bool FbxMesh::GetPolygonVertexNormal(int pPolyIndex, int pVertexIndex, FbxVector4& pNormal) const {
    const int corner = cornerOf(pPolyIndex, pVertexIndex);
    const FbxLayer* layer = GetLayer(0);
    const FbxLayerElementNormal* normals = corner >= 0 && layer ? layer->GetNormals() : nullptr;
    if (!normals)
        return false;
    const FbxLayerElement::EMappingMode mapping = normals->GetMappingMode();
    const bool byCorner = mapping == FbxLayerElement::eByPolygonVertex;
    if (!byCorner && mapping != FbxLayerElement::eByControlPoint)
        return false;
    const FbxLayerElementArrayTemplate<FbxVector4>& direct = normals->GetDirectArray();
    const int index = valueIndex(*normals, byCorner ? corner : mPolygonVertices[corner]);
    if (index < 0 || index >= direct.GetCount())
        return false;
    pNormal = direct.GetAt(index);
    return true;
}

int FbxMesh::GetTextureUVIndex(int pPolygonIndex, int pPositionInPolygon, FbxLayerElement::EType pTypeIdentifier) {
    const int corner = cornerOf(pPolygonIndex, pPositionInPolygon);
    const FbxLayer* layer = GetLayer(0);
    const FbxLayerElementUV* uvs = corner >= 0 && layer ? layer->GetUVs(pTypeIdentifier) : nullptr;
    if (!uvs || uvs->GetMappingMode() != FbxLayerElement::eByPolygonVertex)
        return -1;
    return valueIndex(*uvs, corner);
}

int FbxMesh::RemovePolygon(int pPolygonIndex) {
    detachSource();
    if (!mPolygonStarts.contains(pPolygonIndex))
        return -1;
    const int first = mPolygonStarts[pPolygonIndex];
    const int size = GetPolygonSize(pPolygonIndex);
    dropEdges();
    mPolygonVertices.remove(first, size);
    mPolygonStarts.remove(pPolygonIndex);
    for (int i = pPolygonIndex; i < mPolygonStarts.count(); ++i)
        mPolygonStarts[i] -= size;
    mPolygonOpen = mPolygonOpen && pPolygonIndex < mPolygonStarts.count();
    removeElementEntries(FbxLayerElement::eByPolygon, pPolygonIndex, 1);
    removeElementEntries(FbxLayerElement::eByPolygonVertex, first, size);
    return pPolygonIndex;
}

bool FbxMesh::IsTriangleMesh() const {
    for (int i = 0; i < GetPolygonCount(); ++i)
        if (GetPolygonSize(i) != 3)
            return false;
    return true;
}

void FbxMesh::ReservePolygonCount(int pCount) {
    detachSource();
    mPolygonStarts.reserve(pCount);
}

void FbxMesh::ReservePolygonVertexCount(int pCount) {
    detachSource();
    mPolygonVertices.reserve(pCount);
}

FbxMesh* FbxNode::GetMesh() { return FbxCast<FbxMesh>(GetNodeAttribute()); }

FBXSDK_NAMESPACE_END
