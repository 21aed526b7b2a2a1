// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The one table of time modes: number, name, rate.
#pragma once

#include <span>

#include <fbxsdk/FbxTime.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

struct TimeModeRow {
    FbxTime::EMode mode;
    const char* name;
    double rate; ///< frames per second; 0 where it depends on the global time mode
};

/// Every mode, row i being mode i.
[[nodiscard]] std::span<const TimeModeRow> timeModes();

} // namespace detail
FBXSDK_NAMESPACE_END
