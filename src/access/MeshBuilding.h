// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A mesh of the scene out of one of the library: points, polygons, and one layer with what the polygon vertices carry.
#pragma once

#include "TnFbxMesh.h"

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

/// Whether the polygons claim far more polygon vertices than the mesh has.
bool claimsTooManyCorners(const TnFbxMesh& mesh);

/// Fills an empty mesh. False when it cannot have a layer.
bool buildMesh(const TnFbxMesh& mesh, fbxsdk::FbxMesh& target);

} // namespace Tarnell::Fbx::detail
