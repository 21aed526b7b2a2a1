// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Comma-separated values (RFC 4180).
#pragma once

#include <string>

namespace tool {

/// The text as a field: in quotes where necessary.
std::string csvField(const std::string& text);

} // namespace tool
