// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: the values and keys of
// a curve at many times, without a call for each of them.
#pragma once

#include <fbxsdk/FbxAnimCurve.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// Stores the value at each of the times, as `FbxAnimCurve::Evaluate` returns it. Times in ascending order, several
/// between two keys, take the least time. Throws std::runtime_error when the keys are still in a file that has been
/// changed.
FBXSDK_DLL void evaluate(FbxAnimCurve& curve, const FbxTime* times, int count, float* values);

/// Adds keys as `FbxAnimCurve::KeyAdd` and `KeySet` with linear interpolation do, one after another: a key at the time
/// of an existing one replaces its value. Ascending times after the last key take the least time. Throws
/// std::bad_alloc.
FBXSDK_DLL void addLinearKeys(FbxAnimCurve& curve, const FbxTime* times, const float* values, int count);

} // namespace extensions
FBXSDK_NAMESPACE_END
