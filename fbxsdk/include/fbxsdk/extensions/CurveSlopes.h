// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: the effective slopes
// of a curve at its keys. Keys hold slopes where they were set; those of auto and TCB tangents follow from the
// adjacent keys.
#pragma once

#include <fbxsdk/FbxAnimCurve.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// What evaluation uses on both sides of a key. At the ends, and for an index out of range, zero.
struct KeySlopes {
    double left = 0.0,       ///< per second
        right = 0.0;         ///< per second
    double leftWeight = 0.0, ///< length of the handle, as a fraction of the segment before the key
        rightWeight = 0.0;   ///< length of the handle, as a fraction of the segment after it
};

/// The slopes of the key of that index; zero for a side beyond an end of the curve.
[[nodiscard]] FBXSDK_DLL KeySlopes slopesAt(const FbxAnimCurve& curve, int key);

} // namespace extensions
FBXSDK_NAMESPACE_END
