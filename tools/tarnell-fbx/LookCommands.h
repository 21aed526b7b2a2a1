// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The options of the commands that inspect files.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <utility>

#include <CLI/CLI.hpp>

namespace tool {

/// Adds info, tree, props, curve, cache, records and, where it was built, report. The one that is parsed stores its
/// work in `chosen`.
void addLookCommands(CLI::App& app, std::function<int()>& chosen);

/// "--frames A:B", or a single frame.
void addFrames(CLI::App& command, std::optional<std::pair<int, int>>& frames, const char* help);

} // namespace tool
