// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Text from files for display in a terminal. Names may contain anything: characters that move the cursor, change
// colours or the direction of writing are escaped.
#pragma once

#include <cstdio>
#include <string>
#include <string_view>

namespace tool {

/// The text on one line, without control characters: "\n", "\t", "\r", "\x1b", "\u202e". Invalid UTF-8 bytes are
/// escaped as well; everything else stays.
std::string terminalText(std::string_view text);

/// Whether the stream is a terminal.
bool isTerminal(std::FILE* stream);

} // namespace tool
