// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Each triangle stores its polygon, and each of its corners the polygon's corner: layers are converted by these maps.
#include "geometry/tessellation/TessellationTriangles.h"

#include <algorithm>
#include <vector>

#include "geometry/LayerElementAccess.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

using Access = LayerElementAccess;
using Element = FbxLayerElement;

/// The origin of the triangles.
struct Origins {
    std::vector<int> corners;  ///< for each corner of each triangle
    std::vector<int> polygons; ///< for each triangle
};

Origins cutIntoFans(const FbxMesh& mesh) {
    Origins origins;
    for (int polygon = 0; polygon < mesh.GetPolygonCount(); ++polygon) {
        const int first = mesh.GetPolygonVertexIndex(polygon);
        for (int corner = 1; corner + 1 < mesh.GetPolygonSize(polygon); ++corner) {
            origins.corners.insert(origins.corners.end(), {first, first + corner, first + corner + 1});
            origins.polygons.push_back(polygon);
        }
    }
    return origins;
}

void fillPolygons(FbxMesh& triangles, const FbxMesh& mesh, const Origins& origins) {
    PlainArray<int>& vertices = triangles.polygonVertices();
    vertices.resizeUninitialised(static_cast<int>(origins.corners.size()));
    std::transform(origins.corners.begin(), origins.corners.end(), vertices.begin(),
                   [&](int corner) { return mesh.GetPolygonVertices()[corner]; });
    PlainArray<int>& starts = triangles.polygonStarts();
    starts.resizeUninitialised(static_cast<int>(origins.polygons.size()));
    for (int i = 0; i < starts.count(); ++i)
        starts[i] = 3 * i;
}

/// The entries at the indices, in their order; without indices all of them.
template <class T>
void pick(FbxLayerElementArrayTemplate<T>& to, const FbxLayerElementArrayTemplate<T>& from,
          const std::vector<int>* places) {
    const int count = places ? static_cast<int>(places->size()) : from.GetCount();
    to.SetCount(count);
    for (int i = 0; i < count; ++i)
        to[i] = from.GetAt(places ? (*places)[static_cast<std::size_t>(i)] : i);
}

template <class Class>
Element* carryElement(FbxMesh& triangles, Element& source, const Origins& origins) {
    auto& from = static_cast<Class&>(source);
    const Element::EMappingMode mapping = from.GetMappingMode();
    if (mapping == Element::eByEdge)
        return nullptr;
    Class* element = Class::Create(&triangles, from.GetName());
    element->SetMappingMode(mapping);
    element->SetReferenceMode(from.GetReferenceMode());
    const std::vector<int>* places = mapping == Element::eByPolygonVertex ? &origins.corners
                                     : mapping == Element::eByPolygon     ? &origins.polygons
                                                                          : nullptr;
    const bool direct = from.GetReferenceMode() == Element::eDirect;
    pick(element->GetDirectArray(), from.GetDirectArray(), direct ? places : nullptr);
    pick(element->GetIndexArray(), from.GetIndexArray(), direct ? nullptr : places);
    return element;
}

struct SlotKind {
    int slot;
    Element* (*carry)(FbxMesh& triangles, Element& source, const Origins& origins);
};

constexpr SlotKind kSlots[] = {
    {Element::eNormal, carryElement<FbxLayerElementNormal>},
    {Element::eBiNormal, carryElement<FbxLayerElementBinormal>},
    {Element::eTangent, carryElement<FbxLayerElementTangent>},
    {Element::eMaterial, carryElement<FbxLayerElementMaterial>},
    {Element::ePolygonGroup, carryElement<FbxLayerElementPolygonGroup>},
    {Element::eVertexColor, carryElement<FbxLayerElementVertexColor>},
    {Element::eSmoothing, carryElement<FbxLayerElementSmoothing>},
    {Element::eVertexCrease, carryElement<FbxLayerElementCrease>},
    {Element::eEdgeCrease, carryElement<FbxLayerElementCrease>},
    {Element::eHole, carryElement<FbxLayerElementHole>},
    {Element::eVisibility, carryElement<FbxLayerElementVisibility>},
};

void carryLayer(FbxMesh& triangles, FbxLayer& to, const FbxLayer& from, const Origins& origins) {
    const auto carry = [&](const SlotKind& kind) {
        Element* source = Access::elementAt(from, kind.slot);
        Element* element = source ? kind.carry(triangles, *source, origins) : nullptr;
        if (element)
            Access::setElement(to, kind.slot, *element);
    };
    for (const SlotKind& kind : kSlots)
        carry(kind);
    for (int channel = Element::eTextureDiffuse; channel < Element::eTypeCount; ++channel) {
        carry({channel, carryElement<FbxLayerElementTexture>});
        carry({Access::uvSlot(static_cast<Element::EType>(channel)), carryElement<FbxLayerElementUV>});
    }
}

} // namespace

void fillTriangles(FbxMesh& triangles, FbxMesh& polygons) {
    const Origins origins = cutIntoFans(polygons);
    triangles.points().resizeUninitialised(polygons.GetControlPointsCount());
    std::copy_n(polygons.GetControlPoints(), polygons.GetControlPointsCount(), triangles.points().begin());
    fillPolygons(triangles, polygons, origins);
    for (int i = 0; i < polygons.GetLayerCount(); ++i)
        carryLayer(triangles, *triangles.GetLayer(triangles.CreateLayer()), *polygons.GetLayer(i), origins);
}

} // namespace detail
FBXSDK_NAMESPACE_END
