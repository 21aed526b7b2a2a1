// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The number of threads that a call may use. Only the bundled platform supports it: with another one the number is
// stored without effect.
#include "TnFbxLimits.h"

#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
#include <algorithm>
#include <atomic>
#else
#include <fbxsdk/extensions/Threads.h>
#endif

namespace Tarnell::Fbx {

#ifdef TARNELL_FBX_EXTERNAL_FBXSDK
namespace {

std::atomic<int> chosen{1};

} // namespace

int maximumThreads() { return chosen; }

void setMaximumThreads(int count) { chosen = std::max(count, 1); }
#else
int maximumThreads() { return fbxsdk::extensions::maximumThreads(); }

void setMaximumThreads(int count) { fbxsdk::extensions::setMaximumThreads(count); }
#endif

} // namespace Tarnell::Fbx
