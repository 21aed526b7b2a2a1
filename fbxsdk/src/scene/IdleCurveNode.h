// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curve nodes that say nothing which their property does not say.
#pragma once

#include <fbxsdk/FbxAnimCurveNode.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Whether a file can go without the curve node: it stands on the base layer and has no keys, and either it has the
/// value of its property, or curves were made for it and never keyed, whatever their defaults. Programs that evaluate
/// a curve node without keys as 0 then find the property's static value.
[[nodiscard]] bool isIdle(const FbxAnimCurveNode& node);

} // namespace detail
FBXSDK_NAMESPACE_END
