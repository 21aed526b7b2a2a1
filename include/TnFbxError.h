// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Why the last call failed.
#pragma once

#include "TnFbxExport.h"

#include <string>

namespace Tarnell::Fbx {

/// The reason of the last failure of `Fbx` or `FbxSdk` on the calling thread, a sentence that names the file and the
/// place where there are any; empty after a success.
///
/// Every operation of `Fbx`, and every one of `FbxSdk` that says so, sets or clears it. The reference stays valid as
/// long as the thread; the text until the thread's next call.
TARNELL_FBX_API const std::string& lastError();

} // namespace Tarnell::Fbx
