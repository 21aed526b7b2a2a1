// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: the values of a
// property at many times, without a call for each of them.
#pragma once

#include <fbxsdk/FbxProperty.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// Stores the value at each of the times, as `EvaluateValue` returns it. Times in ascending order take the least time.
/// Throws std::runtime_error when keys are still in a file that has been changed.
FBXSDK_DLL void evaluate(FbxPropertyT<FbxDouble3>& property, const FbxTime* times, int count, FbxDouble3* values);

} // namespace extensions
FBXSDK_NAMESPACE_END
