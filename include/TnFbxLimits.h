// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How much memory the results of one call may take, and how many threads its work.
#pragma once

#include "TnFbxExport.h"

#include <cstdint>

namespace Tarnell::Fbx {

/// The bytes that the objects of one call may take, samples and mesh arrays included, or the keys of a scene that is
/// written; the memory for loading a file is not counted. A call that would take more fails, and `lastError()` says how
/// much it would have been.
///
/// One value for the whole process, which any thread may read and set at any time; a call in progress keeps the one
/// it began with. The default is half of the machine's memory.
TARNELL_FBX_API std::uint64_t memoryLimit();

/// Sets the limit that `memoryLimit()` returns, in bytes; 0 restores the default.
TARNELL_FBX_API void setMemoryLimit(std::uint64_t bytes);

/// How many threads the calls of the process may use at most: initially 1, the caller's own, or the value of
/// TARNELL_FBX_THREADS in the environment.
TARNELL_FBX_API int maximumThreads();

/// 0 is as many threads as the machine has; less counts as 1. The arrays of large meshes are then deflated and inflated
/// on several threads, and long lists of ASCII files parsed. Threads start and end within the call that uses them; only
/// while a scene stays loaded, as that of an `FbxFaithful`, they may continue to inflate for a short time after it.
/// Concurrent calls share them. What is read and written is the same for every number. Any thread may call this at any
/// time; a call in progress may keep the previous number.
TARNELL_FBX_API void setMaximumThreads(int count);

} // namespace Tarnell::Fbx
