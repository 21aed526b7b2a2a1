// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What both readers accept at most.
#pragma once

#include <cstddef>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Levels of records. Sound files need less than twelve; one with fifty nested channels is known.
inline constexpr std::size_t kMaxDepth = 64;

/// From so many numbers on, a list of scalars is kept as one array instead of a value each: longer than any tuple or
/// matrix, shorter than anything that is worth the bytes.
inline constexpr std::size_t kShortestList = 17;

/// Arrays up to so many bytes are read along with the records around them, larger ones when somebody asks for them.
inline constexpr std::size_t kMostReadAlong = std::size_t{1} << 12;

/// What comes through a pipe is held in memory until it has been read.
inline constexpr std::size_t kMostPipeBytes = std::size_t{1} << 32;
/// Milliseconds without a byte, after which whoever should write into a pipe counts as gone.
inline constexpr int kMostPipeSilence = 60'000;

} // namespace detail
FBXSDK_NAMESPACE_END
