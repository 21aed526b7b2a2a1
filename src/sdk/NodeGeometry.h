// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Two matrices of a node for reading and deforming.
#pragma once

#include <fbxsdk.h>

#include <algorithm>
#include <span>

#ifndef TARNELL_FBX_EXTERNAL_FBXSDK
#include <fbxsdk/extensions/NodeSamples.h>
#endif

namespace Tarnell::Fbx::detail {

/// The node's global matrix, without its geometric offset and without following a target.
inline fbxsdk::FbxAMatrix globalTransform(fbxsdk::FbxNode& node, const fbxsdk::FbxTime& time) {
    return node.EvaluateGlobalTransform(time, fbxsdk::FbxNode::eSourcePivot, /*pApplyTarget*/ false,
                                        /*pForceEval*/ false);
}

/// The same at many times.
inline void globalTransforms(fbxsdk::FbxNode& node, std::span<const fbxsdk::FbxTime> times,
                             fbxsdk::FbxAMatrix* matrices) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
    std::transform(times.begin(), times.end(), matrices,
                   [&node](const fbxsdk::FbxTime& time) { return globalTransform(node, time); });
#else
    fbxsdk::extensions::evaluateGlobalTransforms(node, times.data(), static_cast<int>(times.size()), matrices);
#endif
}

/// The geometric offset as the readers of objects get it.
inline fbxsdk::FbxAMatrix geometricTransform(const fbxsdk::FbxNode& node) {
    fbxsdk::FbxAMatrix matrix;
    matrix.SetTRS(node.GetGeometricTranslation(fbxsdk::FbxNode::eSourcePivot),
                  node.GetGeometricRotation(fbxsdk::FbxNode::eSourcePivot),
                  node.GetGeometricScaling(fbxsdk::FbxNode::eSourcePivot));
    return matrix;
}

} // namespace Tarnell::Fbx::detail
