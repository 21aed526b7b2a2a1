// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Skins and shapes of a surface for the mesh that replaces it.
#pragma once

#include <fbxsdk/FbxMesh.h>

#include "geometry/tessellation/TessellationGrid.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// How many numbers for each point the deformers of a geometry will have: one per cluster and per target shape.
[[nodiscard]] std::int64_t numbersPerPoint(const FbxGeometry& geometry);

/// Gives the mesh deformers of its own, which move its points as those of the surface moved the surface: clusters with
/// the same links and bindings, channels with the same curves. Point caches do not apply: their points no longer exist.
void carryDeformers(FbxMesh& mesh, const FbxGeometry& surface, const TessellationGrid& grid);
/// The same for a mesh that has the geometry's own points. Point caches then apply to both.
void carryDeformers(FbxMesh& mesh, const FbxGeometry& samePoints);

/// Destroys the deformers of this geometry only, with their clusters, channels and shapes.
void destroyDeformers(FbxGeometry& geometry);

/// Values, dynamic properties and animation of the properties that the object has set.
void carryProperties(FbxObject& to, const FbxObject& from);

} // namespace detail
FBXSDK_NAMESPACE_END
