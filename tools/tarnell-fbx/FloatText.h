// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Floats as text. Long clips are printed as millions of them.
#pragma once

#include <cstddef>

namespace tool {

/// The characters that writeShortest may overwrite, more than the longest text has.
constexpr std::size_t kFloatRoom = 48;

/// Writes the shortest digits that read back as the same number, as std::to_chars does, and returns the end.
char* writeShortest(char* first, float value);

} // namespace tool
