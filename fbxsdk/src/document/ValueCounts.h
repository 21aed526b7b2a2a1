// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Whether property lines hold as many numbers as their type has.
#pragma once

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// False, with the line in the status, when a line of an ASCII file holds more numbers than a value of its type has.
/// Such files come from programs that spell numbers with the decimal comma of their country: of "35,5" only 35 would be
/// read, and every number behind it in the wrong place. Properties of users may hold bounds behind the value.
[[nodiscard]] bool checkValueCounts(const RecordTree& tree, FbxStatus& status);

} // namespace detail
FBXSDK_NAMESPACE_END
