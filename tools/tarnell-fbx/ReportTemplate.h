// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The build output of tools/report, before and after the place of the data. In parts, since compilers
// limit the length of string literals.
#pragma once

#include <span>
#include <string_view>

namespace tool {

extern const std::span<const std::string_view> kReportHead;
extern const std::span<const std::string_view> kReportTail;

} // namespace tool
