// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// From a grid of samples to a mesh of triangles.
#pragma once

#include <fbxsdk/FbxMesh.h>

#include "geometry/TessellationGrid.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Fills a new mesh: a control point per distinct sample, two triangles per cell, in layer 0 normals and texture
/// coordinates of the corners. u and v run from 0 to 1 over the surface.
void fillMesh(FbxMesh& mesh, const TessellationGrid& grid);

/// The first material of the surface's material element, for all of the mesh. Nothing without such an element.
void carryMaterial(FbxMesh& mesh, FbxGeometry& surface);

} // namespace detail
FBXSDK_NAMESPACE_END
