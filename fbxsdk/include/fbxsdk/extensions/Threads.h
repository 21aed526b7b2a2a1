// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: how many threads
// reading and writing may use.
#pragma once

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace extensions {

/// How many threads work at most, the callers' own not counted twice: all calls of the process share what is beyond
/// one. Threads start and end within the call that uses them, except those that inflate arrays of meshes in advance:
/// they end when no more are requested, at the latest with the scene, which waits for them. What is read and written is
/// the same for every number.
[[nodiscard]] FBXSDK_DLL int maximumThreads();

/// 1 means the caller's thread alone, the default unless TARNELL_FBX_THREADS in the environment says otherwise; 0 means
/// as many as the machine has. Less counts as 1. Any thread may call this at any time; work in progress may keep the
/// previous number.
FBXSDK_DLL void setMaximumThreads(int count);

} // namespace extensions
FBXSDK_NAMESPACE_END
