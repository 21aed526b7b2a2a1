// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: how a curve really
// goes through its keys. Keys hold slopes where somebody has set them; those of auto and TCB tangents follow from the
// keys around.
#pragma once

#include <fbxsdk/FbxAnimCurve.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// What evaluation uses on both sides of a key. At the ends, and for an index out of range, there is nothing: zero.
struct KeySlopes {
    double left = 0.0, right = 0.0; ///< per second
    /// Lengths of the handles, as parts of the pieces of the curve that they stand in.
    double leftWeight = 0.0, rightWeight = 0.0;
};

[[nodiscard]] FBXSDK_DLL KeySlopes slopesAt(const FbxAnimCurve& curve, int key);

} // namespace extensions
FBXSDK_NAMESPACE_END
