// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Time units: some files of header version 1004 count 141120000 ticks per second instead of the usual unit.
#pragma once

#include <cstdint>
#include <limits>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

inline constexpr std::int64_t kShortTicksPerSecond = 141120000;

/// A time in ticks of kTicksPerSecond, rounded to the nearest; times beyond the range saturate.
[[nodiscard]] inline std::int64_t rescaledTicks(std::int64_t time, std::int64_t ticksPerSecond) {
    if (ticksPerSecond == kTicksPerSecond)
        return time;
    constexpr std::int64_t kMostSeconds = std::numeric_limits<std::int64_t>::max() / kTicksPerSecond - 1;
    const std::int64_t seconds = time / ticksPerSecond;
    if (seconds > kMostSeconds)
        return std::numeric_limits<std::int64_t>::max();
    if (seconds < -kMostSeconds)
        return std::numeric_limits<std::int64_t>::min();
    // The remainder is below one second, so its product stays within 64 bits for both units.
    const std::int64_t rest = (time % ticksPerSecond) * kTicksPerSecond;
    const std::int64_t half = rest < 0 ? -ticksPerSecond / 2 : ticksPerSecond / 2;
    return seconds * kTicksPerSecond + (rest + half) / ticksPerSecond;
}
static_assert(kShortTicksPerSecond < std::numeric_limits<std::int64_t>::max() / kTicksPerSecond);

} // namespace detail
FBXSDK_NAMESPACE_END
