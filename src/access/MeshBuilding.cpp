// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
#include "MeshBuilding.h"

#include "model/MeshArrays.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <numeric>

namespace Tarnell::Fbx {

namespace {

using detail::MeshArrays;
using detail::SharedArray;
using Element = fbxsdk::FbxLayerElement;

/// How many polygon vertices the polygons may claim beyond the existing ones. Each becomes a corner at point 0; the
/// limit prevents a wrong size from creating billions of them.
constexpr std::int64_t kMostMissingCorners = 65536;

double widen(float value) { return static_cast<double>(value); }

fbxsdk::FbxVector4 point(const MeshArrays::Vector& vector) {
    return {widen(vector.x), widen(vector.y), widen(vector.z), 1.0};
}

fbxsdk::FbxVector2 textureCoordinate(const MeshArrays::TextureCoordinate& uv) { return {widen(uv.u), widen(uv.v)}; }

fbxsdk::FbxColor colour(const MeshArrays::Colour& value) {
    return {widen(value.red), widen(value.green), widen(value.blue), widen(value.alpha)};
}

/// Converts elements from the first one on; those that the mesh lacks are zero.
template <class Item, class Source, class Convert>
void convertAll(const SharedArray<Source>& elements, Item* items, int count, Convert convert) {
    const auto wanted = static_cast<std::size_t>(count);
    const std::size_t stored = std::min(elements.storedCount(), wanted);
    std::transform(elements.stored(), elements.stored() + stored, items, convert);
    const std::size_t present = std::min(elements.size(), wanted);
    if (stored < present)
        std::fill(items + stored, items + present, convert(*elements.filler()));
    std::fill(items + present, items + wanted, convert(Source{}));
}

/// The first set.
void setPoints(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target) {
    const int count = mesh.getNumberOfControlPoints();
    target.InitControlPoints(count);
    convertAll(MeshArrays::controlPointsOf(mesh), target.GetControlPoints(), count, point);
}

template <class Array, class Fill>
void fillArray(Array& array, int count, Fill fill) {
    array.SetCount(count);
    auto* items = array.GetLocked();
    fill(items);
    array.Release(&items);
}

void setNormals(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target, fbxsdk::FbxLayer& layer) {
    auto* normals = fbxsdk::FbxLayerElementNormal::Create(&target, "");
    normals->SetMappingMode(Element::eByPolygonVertex);
    normals->SetReferenceMode(Element::eDirect);
    const int count = mesh.getNumberOfPolygonVertices();
    fillArray(normals->GetDirectArray(), count,
              [&](fbxsdk::FbxVector4* items) { convertAll(MeshArrays::normalsOf(mesh), items, count, point); });
    layer.SetNormals(normals);
}

/// One value per polygon vertex, and consecutive indices.
template <class MappedElement, class Values, class Convert>
void fillIndexed(MappedElement& element, const Values& values, int count, Convert convert) {
    element.SetMappingMode(Element::eByPolygonVertex);
    element.SetReferenceMode(Element::eIndexToDirect);
    fillArray(
        element.GetDirectArray(), count, [&](auto* items) { convertAll(values, items, count, convert); });
    fillArray(element.GetIndexArray(), count, [count](int* items) { std::iota(items, items + count, 0); });
}

void setUVs(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target, fbxsdk::FbxLayer& layer) {
    auto* uvs = fbxsdk::FbxLayerElementUV::Create(&target, "map1");
    fillIndexed(*uvs, MeshArrays::uvsOf(mesh), mesh.getNumberOfPolygonVertices(), textureCoordinate);
    layer.SetUVs(uvs, Element::eTextureDiffuse);
}

void setColours(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target, fbxsdk::FbxLayer& layer) {
    auto* colours = fbxsdk::FbxLayerElementVertexColor::Create(&target, "");
    fillIndexed(*colours, MeshArrays::coloursOf(mesh), mesh.getNumberOfPolygonVertices(), colour);
    layer.SetVertexColors(colours);
}

/// Polygons without corners are omitted; the next one continues at their position. Missing corners are at point 0.
void addPolygons(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target) {
    const SharedArray<int>& sizes = MeshArrays::polygonVertexSizesOf(mesh);
    const SharedArray<int>& points = MeshArrays::pointIndicesOf(mesh);
    target.ReservePolygonCount(static_cast<int>(sizes.size()));
    target.ReservePolygonVertexCount(static_cast<int>(points.size()));
    std::size_t polygonVertex = 0;
    for (std::size_t polygon = 0; polygon < sizes.size(); ++polygon) {
        const int size = sizes[polygon];
        if (size <= 0)
            continue;
        target.BeginPolygon(/*pMaterial*/ -1, /*pTexture*/ -1, /*pGroup*/ -1, /*pLegacy*/ true);
        for (int corner = 0; corner < size; ++corner, ++polygonVertex)
            target.AddPolygon(polygonVertex < points.size() ? points[polygonVertex] : 0, /*pTextureUVIndex*/ -1);
        target.EndPolygon();
    }
}

fbxsdk::FbxLayer* firstLayer(fbxsdk::FbxMesh& mesh) {
    if (mesh.GetLayer(0) == nullptr)
        mesh.CreateLayer();
    return mesh.GetLayer(0);
}

} // namespace

bool detail::claimsTooManyCorners(const TnFbxMesh& mesh) {
    std::int64_t corners = 0;
    for (int polygon = 0; polygon < mesh.getNumberOfPolygons(); ++polygon)
        corners += std::max(mesh.getPolygonVertexSize(polygon), 0);
    const bool fits = corners <= mesh.getNumberOfPolygonVertices() + kMostMissingCorners &&
                      corners <= std::numeric_limits<int>::max();
    return !fits;
}

bool detail::buildMesh(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target) {
    setPoints(mesh, target);
    fbxsdk::FbxLayer* layer = firstLayer(target);
    if (layer == nullptr)
        return false;
    if (mesh.getValidNormals())
        setNormals(mesh, target, *layer);
    if (mesh.getValidUVs())
        setUVs(mesh, target, *layer);
    if (mesh.getValidColours())
        setColours(mesh, target, *layer);
    addPolygons(mesh, target);
    return true;
}

} // namespace Tarnell::Fbx
