// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Curves drawn with the dots of Braille characters, two across and four down in each.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace tool {

/// Lines from top to bottom, each of that many characters. The values are spread over two dots per character, the
/// greatest at the top, the least at the bottom; all equal ones are in the middle. Adjacent values are joined;
/// NaN and infinity leave a gap.
std::vector<std::string> brailleLines(const std::vector<double>& values, std::size_t columns, std::size_t rows);

} // namespace tool
