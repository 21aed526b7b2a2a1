// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Animated points of a mesh as a point cache: the deformer that names the file, and the file with a sample per frame.
#pragma once

#include "PointCachePlace.h"

#include "TnFbxMesh.h"
#include "TnFbxTime.h"

#include <fbxsdk.h>

namespace Tarnell::Fbx::detail {

struct PointCacheForm {
    const char* channel; ///< of a Maya cache
    bool maya;           ///< else a Max cache
    bool wide;           ///< 64-bit sizes, in a Maya cache
    double rate;         ///< frames per second
};

/// The vertex cache that deforms the mesh of a node, and its file; null when there is none.
fbxsdk::FbxVertexCacheDeformer* pointCacheDeformerOf(fbxsdk::FbxNode& node);
fbxsdk::FbxCache* pointCacheOf(fbxsdk::FbxNode& node);

/// A vertex cache on the geometry, with its file at that location; its folder is created. `withScene`: the file is
/// renamed when the scene is saved, where the platform supports that. False, with the reason noted, when the folder
/// cannot be created.
bool attachPointCache(fbxsdk::FbxManager& manager, fbxsdk::FbxGeometry& geometry, const PointCachePlace& place,
                      const char* name, bool maya, bool withScene);

/// Null, or why the points of the mesh do not match the range.
const char* pointCacheFault(const TnFbxMesh& mesh, const TnFbxTime& range);

/// Whether the file can be written; `status` has the reason otherwise.
bool openPointCache(fbxsdk::FbxCache& cache, const TnFbxMesh& mesh, const TnFbxTime& range, const PointCacheForm& form,
                    fbxsdk::FbxStatus& status);
/// One sample for each frame of the range. Only closing reports whether it worked.
void writePointSamples(fbxsdk::FbxCache& cache, const TnFbxMesh& mesh, const TnFbxTime& range,
                       const PointCacheForm& form);

} // namespace Tarnell::Fbx::detail
