// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Suggestions for mistyped names.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tool {

/// At most three of the names, the most similar first: those that differ in the case of letters only, that begin with
/// the text or contain it, or that are a few typing mistakes away. Each name once.
std::vector<std::string> mostSimilar(std::string_view text, const std::vector<std::string>& names);

} // namespace tool
