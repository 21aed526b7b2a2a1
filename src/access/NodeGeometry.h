// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The matrices of a node for reading and deforming, and the vectors they come from.
#pragma once

#include <fbxsdk.h>

#include <algorithm>
#include <span>

#ifndef TARNELL_FBX_EXTERNAL_FBXSDK
#include <fbxsdk/extensions/NodeSamples.h>
#include <fbxsdk/extensions/PropertySamples.h>
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

/// A vector of the node at many times, over all layers.
inline void vectorsAt(fbxsdk::FbxPropertyT<fbxsdk::FbxDouble3>& property, std::span<const fbxsdk::FbxTime> times,
                      fbxsdk::FbxDouble3* values) {
#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
    std::transform(times.begin(), times.end(), values,
                   [&property](const fbxsdk::FbxTime& time) { return property.EvaluateValue(time); });
#else
    fbxsdk::extensions::evaluate(property, times.data(), static_cast<int>(times.size()), values);
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
