// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves as files before 7.0 can hold them.
#pragma once

#include "document/CurveKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Tangents that such files have no letter for, automatic ones that are clamped, broken or biased, come out as the
/// slopes that they have.
[[nodiscard]] CurveKeys legacyKeys(const CurveKeys& keys);

} // namespace detail
FBXSDK_NAMESPACE_END
