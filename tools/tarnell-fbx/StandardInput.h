// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// "-" as the name of a file to read.
#pragma once

#include <string>

namespace tool {

/// A name under which standard input can be opened repeatedly; it is held in memory until the process ends.
/// Throws std::runtime_error when it cannot be read, or is longer than 4 GiB.
std::string keepStandardInput();

/// The text with "standard input" instead of that name.
std::string withoutKeptName(std::string text);

} // namespace tool
