// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// ASCII files: names, colons, comma lists and blocks in braces.
#pragma once

#include <span>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Parses the bytes into the tree's records and sets its version. On failure false, with a message in the status.
[[nodiscard]] bool readAscii(std::span<const char> bytes, RecordTree& tree, FbxStatus& status);

} // namespace detail
FBXSDK_NAMESPACE_END
