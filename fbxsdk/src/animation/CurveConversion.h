// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves of the animation layer as curves of a document.
#pragma once

#include "animation/CurveEvaluation.h"
#include "document/Document.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Tangents that the version has no letter for, automatic ones that are clamped, broken or biased, come out as the
/// slopes that they have.
[[nodiscard]] DocumentCurve documentCurve(const CurveKeys& keys, const VersionTraits& traits);

} // namespace detail
FBXSDK_NAMESPACE_END
