// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Whether two records are equal, with all their descendants.
#pragma once

#include <span>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

[[nodiscard]] bool sameValues(std::span<const Value> a, std::span<const Value> b);
/// Compares values and blocks, not names of the two records themselves.
[[nodiscard]] bool sameRecords(const Record& a, const Record& b);

} // namespace detail
FBXSDK_NAMESPACE_END
