// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Cells become triangles that are counter-clockwise seen from the surface's front.
#include "geometry/tessellation/TessellationMesh.h"

#include <algorithm>

#include "object/ManagerData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Calls for each corner of each triangle, in order, with the index of its sample in the grid.
template <class Visit>
void visitCorners(const TessellationGrid& grid, Visit visit) {
    //  3---2
    //  | / |   v
    //  0---1   u ->
    constexpr int kFront[6][2] = {{0, 0}, {1, 0}, {1, 1}, {0, 0}, {1, 1}, {0, 1}};
    constexpr int kBack[6][2] = {{0, 0}, {1, 1}, {1, 0}, {0, 0}, {0, 1}, {1, 1}};
    const auto& corners = grid.flipped() ? kBack : kFront;
    for (int v = 0; v + 1 < grid.v().sampleCount(); ++v) {
        for (int u = 0; u + 1 < grid.u().sampleCount(); ++u)
            for (const auto& corner : corners)
                visit(u + corner[0], v + corner[1]);
    }
}

int cellCount(const TessellationGrid& grid) { return (grid.u().sampleCount() - 1) * (grid.v().sampleCount() - 1); }

void fillPolygons(FbxMesh& mesh, const TessellationGrid& grid) {
    PlainArray<int>& corners = mesh.polygonVertices();
    corners.resizeUninitialised(6 * cellCount(grid));
    int* corner = corners.data();
    visitCorners(grid, [&](int u, int v) { *corner++ = grid.pointOf(u, v); });
    PlainArray<int>& starts = mesh.polygonStarts();
    starts.resizeUninitialised(2 * cellCount(grid));
    for (int polygon = 0; polygon < starts.count(); ++polygon)
        starts[polygon] = 3 * polygon;
}

/// Points where the surface has no normal, as at the tip of a cusp, take that of the triangle; zero when the
/// triangle has none either.
FbxVector4 triangleNormal(const FbxMesh& mesh, int corner) {
    const int* vertices = mesh.GetPolygonVertices() + corner / 3 * 3;
    const FbxVector4* points = mesh.GetControlPoints();
    const FbxVector4 first = points[vertices[0]];
    return unitVector(unitVector(points[vertices[1]] - first).CrossProduct(unitVector(points[vertices[2]] - first)));
}

void addNormals(FbxMesh& mesh, FbxLayer& layer, const TessellationGrid& grid) {
    FbxLayerElementNormal* element = FbxLayerElementNormal::Create(&mesh, "");
    element->SetMappingMode(FbxLayerElement::eByPolygonVertex);
    element->SetReferenceMode(FbxLayerElement::eDirect);
    FbxLayerElementArrayTemplate<FbxVector4>& normals = element->GetDirectArray();
    normals.items().resizeUninitialised(mesh.GetPolygonVertexCount());
    int corner = 0;
    visitCorners(grid, [&](int u, int v) {
        FbxVector4 normal = grid.normals()[static_cast<std::size_t>(grid.sampleOf(u, v))];
        if (normal.SquareLength() == 0.0)
            normal = triangleNormal(mesh, corner);
        normals[corner++] = FbxVector4(normal[0], normal[1], normal[2]);
    });
    layer.SetNormals(element);
}

void addUvs(FbxMesh& mesh, FbxLayer& layer, const TessellationGrid& grid) {
    FbxLayerElementUV* element = FbxLayerElementUV::Create(&mesh, "");
    element->SetMappingMode(FbxLayerElement::eByPolygonVertex);
    element->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    FbxLayerElementArrayTemplate<FbxVector2>& uvs = element->GetDirectArray();
    uvs.items().reserve(grid.u().sampleCount() * grid.v().sampleCount());
    for (const double v : grid.v().places)
        for (const double u : grid.u().places)
            uvs.Add(FbxVector2(u, v));
    FbxLayerElementArrayTemplate<int>& indices = element->GetIndexArray();
    indices.items().resizeUninitialised(mesh.GetPolygonVertexCount());
    int corner = 0;
    visitCorners(grid, [&](int u, int v) { indices[corner++] = grid.sampleOf(u, v); });
    layer.SetUVs(element);
}

} // namespace

void fillMesh(FbxMesh& mesh, const TessellationGrid& grid) {
    mesh.points().resizeUninitialised(grid.pointCount());
    std::copy(grid.points().begin(), grid.points().end(), mesh.points().begin());
    fillPolygons(mesh, grid);
    FbxLayer& layer = *mesh.GetLayer(mesh.CreateLayer());
    addNormals(mesh, layer, grid);
    addUvs(mesh, layer, grid);
}

void carryMaterial(FbxMesh& mesh, FbxGeometry& surface) {
    FbxLayer* from = surface.GetLayer(0);
    FbxLayerElementMaterial* materials = from ? from->GetMaterials() : nullptr;
    if (!materials)
        return;
    FbxLayerElementMaterial* element = FbxLayerElementMaterial::Create(&mesh, materials->GetName());
    element->SetMappingMode(FbxLayerElement::eAllSame);
    element->SetReferenceMode(FbxLayerElement::eIndexToDirect);
    element->GetIndexArray().Add(materials->GetIndexArray().GetFirst());
    mesh.GetLayer(0)->SetMaterials(element);
}

MeshOfSurface::~MeshOfSurface() {
    if (!surface.GetFbxManager()->data().tearingDown) // which frees it anyway
        surface.Destroy();
}

bool fillMesh(FbxMesh& mesh, const MeshOfSurface& source) {
    const auto grid = TessellationGrid::of(source.surface, /*numbersPerPoint*/ 0, source.fewest);
    if (!grid)
        return false;
    fillMesh(mesh, *grid);
    carryMaterial(mesh, source.surface);
    return true;
}

} // namespace detail
FBXSDK_NAMESPACE_END
