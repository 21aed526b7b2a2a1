// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Effective slopes, for display.
#include <fbxsdk/extensions/CurveSlopes.h>

#include "animation/CurveEvaluation.h"
#include "animation/CurveSegment.h"

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

KeySlopes slopesAt(const FbxAnimCurve& curve, int key) {
    const detail::CurveKeys& keys = curve.keys();
    KeySlopes slopes;
    if (key < 0 || static_cast<std::size_t>(key) >= keys.keyCount())
        return slopes;
    const auto index = static_cast<std::size_t>(key);
    if (index > 0) {
        slopes.left = detail::leftSlope(keys, index);
        slopes.leftWeight = detail::leftWeight(keys, index);
    }
    if (index + 1 < keys.keyCount()) {
        slopes.right = detail::rightSlope(keys, index);
        slopes.rightWeight = detail::rightWeight(keys, index);
    }
    return slopes;
}

} // namespace extensions
FBXSDK_NAMESPACE_END
