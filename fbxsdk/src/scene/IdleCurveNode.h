// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curve nodes without effect on the value of their property.
#pragma once

#include <fbxsdk/FbxAnimCurveNode.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Whether the curve node can be omitted from a file: it is on the base layer and has no keys, and either its value is
/// that of its property, or curves were made for it and never keyed, whatever their defaults. Programs that evaluate a
/// curve node without keys as 0 then use the property's static value.
[[nodiscard]] bool isIdle(const FbxAnimCurveNode& node);

} // namespace detail
FBXSDK_NAMESPACE_END
