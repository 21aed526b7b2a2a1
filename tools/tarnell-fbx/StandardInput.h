// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// "-" as the name of a file to read.
#pragma once

#include <string>

namespace tool {

/// A name under which standard input can be opened as often as need be; it is held in memory until the process ends.
/// Throws std::runtime_error when it cannot be read, or is longer than 4 GiB.
std::string keepStandardInput();

/// The text with "standard input" in place of that name.
std::string withoutKeptName(std::string text);

} // namespace tool
