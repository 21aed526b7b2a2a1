// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Names that are no UTF-8, as references spell them.
#pragma once

#include <string>
#include <string_view>

namespace conformance {

/// The text with U+FFFD in the place of every byte that belongs to no character.
std::string withoutInvalidUtf8(std::string_view text);

} // namespace conformance
