// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How pages for people look: colours where a terminal shows them, and lines no longer than it is wide.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace tool {

/// What a piece of text is, for those who see it in colour.
enum class Ink { plain, heading, name, number, faint, warning };

struct Terminal {
    bool colour = false;
    std::size_t width = 0; ///< columns; 0: lines are as long as they are
    [[nodiscard]] std::string paint(Ink ink, std::string_view text) const;
    /// The text, cut where the line ends when so many columns are taken already.
    [[nodiscard]] std::string fit(std::string_view text, std::size_t taken = 0) const;
};

/// What standard output is: colours when it is a terminal, NO_COLOR is unset and TERM is not "dumb"; a width when it is
/// one, or when COLUMNS says so.
Terminal standardTerminal();

} // namespace tool
