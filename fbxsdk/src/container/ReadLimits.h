// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The limits of both readers.
#pragma once

#include <cstddef>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Levels of records. Valid files need less than twelve; one with fifty nested channels is known.
inline constexpr std::size_t kMaxDepth = 64;

/// A list of at least this many scalars is kept as one array instead of a value each: longer than any tuple or
/// matrix, shorter than any list where memory matters.
inline constexpr std::size_t kShortestList = 17;

/// Arrays up to this size in bytes are read along with the records around them, larger ones on access.
inline constexpr std::size_t kMostReadAlong = std::size_t{1} << 12;

/// The content of a pipe is held in memory until it has been read.
inline constexpr std::size_t kMostPipeBytes = std::size_t{1} << 32;
/// Milliseconds without a byte, after which the writer of a pipe is considered gone.
inline constexpr int kMostPipeSilence = 60'000;

} // namespace detail
FBXSDK_NAMESPACE_END
