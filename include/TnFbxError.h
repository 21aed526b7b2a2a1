// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Why the last call failed, and what it could not do as asked.
#pragma once

#include "TnFbxExport.h"

#include <string>
#include <vector>

namespace Tarnell::Fbx {

/// The reason of the last failure of `Fbx` or `FbxSdk` on the calling thread, a sentence that names the file and the
/// place where there are any; empty after a success.
///
/// Every operation of `Fbx`, and every one of `FbxSdk` whose comment says so, sets or clears it. The reference stays
/// valid as long as the thread; the text until the thread's next call.
TARNELL_FBX_API const std::string& lastError();

/// What the last call on the calling thread noticed without failing: one sentence each, in the order in which they
/// were noticed; empty when there was nothing. An unreadable point cache is an example.
///
/// Every operation of `Fbx` starts with an empty list, and so do `loadScene`, `createScene`, `saveScene` and the lists
/// of `FbxSdk` when the host calls them itself. The reference stays valid as long as the thread; the sentences until
/// the thread's next call.
TARNELL_FBX_API const std::vector<std::string>& lastWarnings();

} // namespace Tarnell::Fbx
