// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Independent work on several threads.
#pragma once

#include <cstddef>
#include <functional>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Calls `work` with each number below the count, on this thread and on as many others as `maximumThreads()` allows.
/// Returns when all calls have; rethrows what the first of them to fail threw, and starts no further ones then. Where
/// no thread can be created, this one does all the work.
void forEachInParallel(std::size_t count, const std::function<void(std::size_t)>& work);

} // namespace detail
FBXSDK_NAMESPACE_END
