// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of meshes of polygons to meshes of triangles.
#pragma once

#include <fbxsdk/FbxMesh.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Fills a new mesh with the points of another one and its polygons split into fans around their first corners;
/// polygons of fewer than three corners are omitted. Layers are converted as well, except for elements by edge.
void fillTriangles(FbxMesh& triangles, FbxMesh& polygons);

} // namespace detail
FBXSDK_NAMESPACE_END
