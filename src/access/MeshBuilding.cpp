// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
#include "MeshBuilding.h"

#include <algorithm>
#include <cstdint>
#include <limits>

namespace Tarnell::Fbx {

namespace {

using Element = fbxsdk::FbxLayerElement;

/// How many polygon vertices the polygons may claim beyond the existing ones. Each becomes a corner at point 0; the
/// limit prevents a wrong size from creating billions of them.
constexpr std::int64_t kMostMissingCorners = 65536;

double widen(float value) { return static_cast<double>(value); }

fbxsdk::FbxVector4 point(float x, float y, float z) { return {widen(x), widen(y), widen(z), 1.0}; }

/// The first set.
void setPoints(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target) {
    const int count = mesh.getNumberOfControlPoints();
    target.InitControlPoints(count);
    fbxsdk::FbxVector4* points = target.GetControlPoints();
    for (int i = 0; i < count; ++i) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        mesh.getControlPoint(i, x, y, z);
        points[i] = point(x, y, z);
    }
}

template <class Array, class ValueAt>
void fillArray(Array& array, int count, ValueAt valueAt) {
    array.SetCount(count);
    auto* items = array.GetLocked();
    for (int i = 0; i < count; ++i)
        items[i] = valueAt(i);
    array.Release(&items);
}

void setNormals(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target, fbxsdk::FbxLayer& layer) {
    auto* normals = fbxsdk::FbxLayerElementNormal::Create(&target, "");
    normals->SetMappingMode(Element::eByPolygonVertex);
    normals->SetReferenceMode(Element::eDirect);
    fillArray(normals->GetDirectArray(), mesh.getNumberOfPolygonVertices(), [&mesh](int i) {
        float x = 0.0f, y = 0.0f, z = 0.0f;
        mesh.getNormal(i, x, y, z);
        return point(x, y, z);
    });
    layer.SetNormals(normals);
}

/// One value per polygon vertex, and consecutive indices.
template <class MappedElement, class ValueAt>
void fillIndexed(MappedElement& element, int count, ValueAt valueAt) {
    element.SetMappingMode(Element::eByPolygonVertex);
    element.SetReferenceMode(Element::eIndexToDirect);
    fillArray(element.GetDirectArray(), count, valueAt);
    fillArray(element.GetIndexArray(), count, [](int i) { return i; });
}

void setUVs(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target, fbxsdk::FbxLayer& layer) {
    auto* uvs = fbxsdk::FbxLayerElementUV::Create(&target, "map1");
    fillIndexed(*uvs, mesh.getNumberOfPolygonVertices(), [&mesh](int i) {
        float u = 0.0f, v = 0.0f;
        mesh.getUV(i, u, v);
        return fbxsdk::FbxVector2(widen(u), widen(v));
    });
    layer.SetUVs(uvs, Element::eTextureDiffuse);
}

void setColours(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target, fbxsdk::FbxLayer& layer) {
    auto* colours = fbxsdk::FbxLayerElementVertexColor::Create(&target, "");
    fillIndexed(*colours, mesh.getNumberOfPolygonVertices(), [&mesh](int i) {
        float red = 0.0f, green = 0.0f, blue = 0.0f, alpha = 0.0f;
        mesh.getColour(i, red, green, blue, alpha);
        return fbxsdk::FbxColor(widen(red), widen(green), widen(blue), widen(alpha));
    });
    layer.SetVertexColors(colours);
}

/// Polygons without corners are omitted; the next one continues at their position.
void addPolygons(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target) {
    target.ReservePolygonCount(mesh.getNumberOfPolygons());
    target.ReservePolygonVertexCount(mesh.getNumberOfPolygonVertices());
    int polygonVertex = 0;
    for (int polygon = 0; polygon < mesh.getNumberOfPolygons(); ++polygon) {
        const int size = mesh.getPolygonVertexSize(polygon);
        if (size <= 0)
            continue;
        target.BeginPolygon(/*pMaterial*/ -1, /*pTexture*/ -1, /*pGroup*/ -1, /*pLegacy*/ true);
        for (int corner = 0; corner < size; ++corner) {
            target.AddPolygon(mesh.getPointIndex(polygonVertex), /*pTextureUVIndex*/ -1);
            ++polygonVertex;
        }
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
