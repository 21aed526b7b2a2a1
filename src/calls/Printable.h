// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Texts of files, escaped for display.
#pragma once

#include <string>
#include <string_view>

namespace Tarnell::Fbx::detail {

/// The text without control characters for terminals: these, those of the upper half and bidirectional
/// marks included, become "\x1B" or "\u009B", and so do bytes that are not UTF-8. Line ends
/// stay only with `keepLines`.
std::string printable(std::string_view text, bool keepLines = false);

} // namespace Tarnell::Fbx::detail
