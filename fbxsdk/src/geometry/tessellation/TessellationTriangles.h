// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes of polygons become meshes of triangles.
#pragma once

#include <fbxsdk/FbxMesh.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Fills a new mesh with the points of another one and its polygons cut into fans around their first corners; polygons
/// of fewer than three corners are left out. Layers come along, but for what belongs to edges.
void fillTriangles(FbxMesh& triangles, FbxMesh& polygons);

} // namespace detail
FBXSDK_NAMESPACE_END
