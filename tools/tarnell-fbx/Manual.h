// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The manual page and the completions of shells, made from the table of commands and options that --help prints.
#pragma once

#include <ostream>
#include <string>

#include <CLI/CLI.hpp>

namespace tool {

/// The manual page, in the language of man(7).
void writeManual(const CLI::App& app, std::ostream& out);

/// The completion script for bash, zsh or fish. False for another shell.
bool writeCompletion(const CLI::App& app, const std::string& shell, std::ostream& out);

} // namespace tool
