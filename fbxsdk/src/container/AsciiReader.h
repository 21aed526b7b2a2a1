// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// ASCII files: names, colons, comma lists and blocks in braces.
#pragma once

#include <span>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Cuts the bytes into the tree's records and fills in its version. False with a sentence in the status.
[[nodiscard]] bool readAscii(std::span<const char> bytes, RecordTree& tree, FbxStatus& status);

} // namespace detail
FBXSDK_NAMESPACE_END
