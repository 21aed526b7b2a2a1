// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Binary files: a 27-byte header, then records, each preceded by its sizes and end.
#pragma once

#include <cstdint>
#include <span>

#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Whether the bytes begin like a binary file.
[[nodiscard]] bool isBinary(std::span<const char> bytes);

/// Parses the bytes into the tree's records, version and byte order. On failure false, with a message in the status.
[[nodiscard]] bool readBinary(std::span<const char> bytes, RecordTree& tree, FbxStatus& status);

/// The offset behind a record that was parsed from the bytes, and behind its block.
[[nodiscard]] std::uint64_t binaryRecordEnd(std::span<const char> bytes, const RecordTree& tree, const Record& record);

} // namespace detail
FBXSDK_NAMESPACE_END
