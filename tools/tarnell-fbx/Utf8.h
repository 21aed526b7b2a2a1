// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Characters of UTF-8 text, and how many columns they take.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace tool {

struct Utf8Character {
    char32_t code = 0;
    std::size_t size = 1; ///< bytes
    bool valid = false;   ///< else one byte that begins no character
};

/// The character that begins at a byte of the text.
Utf8Character utf8At(std::string_view text, std::size_t at);

/// Columns of a terminal for the text: two for wide characters, none for combining ones.
std::size_t displayWidth(std::string_view text);

/// The text in at most that many columns; a truncated one ends in "…".
std::string fitted(std::string_view text, std::size_t columns);

} // namespace tool
