// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Conversion of a mesh of the library to one of the scene: points, polygons, and one layer for the polygon vertices.
#pragma once

#include "TnFbxMesh.h"

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

/// Whether the polygons claim far more polygon vertices than the mesh has.
bool claimsTooManyCorners(const TnFbxMesh& mesh);

/// Fills an empty mesh. False when it cannot have a layer.
bool buildMesh(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target);

} // namespace Tarnell::Fbx::detail
