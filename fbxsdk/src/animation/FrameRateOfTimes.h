// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The frame rate derived from key times, for files that state none.
#pragma once

#include <cstdint>
#include <span>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The rate at which nearly all of these times, in ticks, are whole frames; 0 when there is no evidence for any. Frames
/// count from time 0. The times are ascending and unique.
///
/// The most frequent distance between adjacent times is a frame when that is between 12 and 1000 frames per second.
/// Otherwise, as with sparse keys, the first of the usual rates that fits is taken; 30 frames per second, at which a
/// file without a rate runs, is the first, so that it stays unless the times contradict it.
[[nodiscard]] double frameRateOfTimes(std::span<const std::int64_t> times);

} // namespace detail
FBXSDK_NAMESPACE_END
