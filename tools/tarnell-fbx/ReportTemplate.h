// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The page that the build makes of tools/report, before and behind the place of the data. In pieces, since compilers
// take texts of a moderate length only.
#pragma once

#include <span>
#include <string_view>

namespace tool {

extern const std::span<const std::string_view> kReportHead;
extern const std::span<const std::string_view> kReportTail;

} // namespace tool
