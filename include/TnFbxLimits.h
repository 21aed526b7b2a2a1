// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// How much memory the results of one call may take.
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

} // namespace Tarnell::Fbx
