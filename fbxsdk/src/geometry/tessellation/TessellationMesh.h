// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of a grid of samples to a mesh of triangles.
#pragma once

#include <cstdint>

#include <fbxsdk/FbxMesh.h>

#include "geometry/tessellation/TessellationGrid.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A surface that a mesh has replaced, to be sampled when the mesh's polygons are first accessed. The mesh is its only
/// owner.
struct MeshOfSurface {
    explicit MeshOfSurface(FbxGeometry& geometry, std::int64_t fewestSamples)
        : surface(geometry), fewest(fewestSamples) {}
    MeshOfSurface(const MeshOfSurface&) = delete;
    MeshOfSurface& operator=(const MeshOfSurface&) = delete;
    ~MeshOfSurface();

    FbxGeometry& surface;
    const std::int64_t fewest; ///< minimum budget of samples, however few control points it has
};

/// Fills a mesh with the polygons and the material of the surface. False when it has no samples.
[[nodiscard]] bool fillMesh(FbxMesh& mesh, const MeshOfSurface& source);

/// Fills a new mesh: a control point per distinct sample, two triangles per cell, in layer 0 normals and texture
/// coordinates of the corners. u and v run from 0 to 1 over the surface.
void fillMesh(FbxMesh& mesh, const TessellationGrid& grid);

/// The first material of the surface's material element, for all of the mesh. Nothing without such an element.
void carryMaterial(FbxMesh& mesh, FbxGeometry& surface);

} // namespace detail
FBXSDK_NAMESPACE_END
