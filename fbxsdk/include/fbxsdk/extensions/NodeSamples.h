// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: the transforms of a
// node at many times, without a call for each of them.
#pragma once

#include <fbxsdk/FbxAMatrix.h>
#include <fbxsdk/FbxNode.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// Stores the global matrix at each of the times, as `FbxNode::EvaluateGlobalTransform` returns it. Times in ascending
/// order take the least time, and so do nodes whose parents were evaluated at the same times shortly before. Throws
/// std::runtime_error when keys are still in a file that has been changed.
FBXSDK_DLL void evaluateGlobalTransforms(FbxNode& node, const FbxTime* times, int count, FbxAMatrix* matrices);

} // namespace extensions
FBXSDK_NAMESPACE_END
