// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: on how many threads
// it may read and write.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// How many threads work at most, the callers' own not counted twice: all calls of the process share what is beyond
/// one. Threads start and end within the call that they work for. What is read and written is the same for every
/// number.
[[nodiscard]] FBXSDK_DLL int maximumThreads();

/// 1 is the caller's thread alone, as at first unless TARNELL_FBX_THREADS in the environment says otherwise; 0 is as
/// many as the machine has. Less counts as 1. Any thread may call this at any time; work that has begun goes on as it
/// began.
FBXSDK_DLL void setMaximumThreads(int count);

} // namespace extensions
FBXSDK_NAMESPACE_END
