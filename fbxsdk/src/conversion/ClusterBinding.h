// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Bind matrices when a whole scene is transformed.
#pragma once

#include <fbxsdk/FbxAMatrix.h>

FBXSDK_NAMESPACE_BEGIN
class FbxScene;
namespace detail {

/// Applies the transform after the mesh, link and associate bind matrices of every cluster of the scene.
void transformBindMatrices(FbxScene& scene, const FbxAMatrix& transform);

} // namespace detail
FBXSDK_NAMESPACE_END
