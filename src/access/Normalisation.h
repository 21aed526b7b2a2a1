// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What every scene becomes before it is read: centimetres, Y up, right-handed, and meshes in the place of surfaces.
#pragma once

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

void convertToCentimetres(fbxsdk::FbxScene& scene);
void convertToYUp(fbxsdk::FbxScene& scene);

/// Puts a mesh in the place of the node's NURBS or patch; a surface that cannot become one stays.
void triangulate(fbxsdk::FbxManager* manager, fbxsdk::FbxNode& node);

} // namespace Tarnell::Fbx::detail
