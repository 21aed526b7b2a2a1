// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The layout of text pages: colours where a terminal shows them, and lines no longer than its width.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace tool {

/// The role of a piece of text, for its colour.
enum class Ink { plain, heading, name, number, faint, warning };

struct Terminal {
    bool colour = false;
    std::size_t width = 0; ///< columns; 0: lines are not truncated
    [[nodiscard]] std::string paint(Ink ink, std::string_view text) const;
    /// The text, truncated at the end of the line when that many columns are in use already.
    [[nodiscard]] std::string fit(std::string_view text, std::size_t taken = 0) const;
};

/// The properties of standard output: colours when it is a terminal, NO_COLOR is unset and TERM is not "dumb"; a width
/// when it is one, or when COLUMNS is set.
Terminal standardTerminal();

} // namespace tool
