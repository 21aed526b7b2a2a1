// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Texts of files on their way to people.
#pragma once

#include <string>
#include <string_view>

namespace Tarnell::Fbx::detail {

/// The text without anything that a terminal would obey: control characters, those of the upper half and those that
/// turn the direction of writing among them, become "\x1B" or "\u009B", and so do bytes that are no UTF-8. Line ends
/// stay only when `keepLines`.
std::string printable(std::string_view text, bool keepLines = false);

} // namespace Tarnell::Fbx::detail
