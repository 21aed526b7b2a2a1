// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Text from files on its way to a terminal. Names may hold anything: what would move the cursor, change colours or turn
// the direction of writing is spelt out instead.
#pragma once

#include <cstdio>
#include <string>
#include <string_view>

namespace tool {

/// The text on one line, without control characters: "\n", "\t", "\r", "\x1b", "\u202e". Bytes that are no UTF-8 are
/// spelt out as well; everything else stays.
std::string terminalText(std::string_view text);

/// Whether a person reads the stream.
bool isTerminal(std::FILE* stream);

} // namespace tool
