// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Invalid UTF-8 in names, as references spell it.
#pragma once

#include <string>
#include <string_view>

namespace conformance {

/// The text with U+FFFD instead of every byte that belongs to no character.
std::string withoutInvalidUtf8(std::string_view text);

} // namespace conformance
