// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Whether a read or a write keeps the behaviours that hosts of the library rely on, or follows what the application
// shows.
#pragma once

namespace Tarnell::Fbx {

/// An option of `TnFbxReadInfo` and `TnFbxWriteInfo`.
enum EFbxFidelity : int {
    kFbxFidelityCompatible, ///< Every behaviour that hosts rely on, also where it hides what the file contains.
    kFbxFidelityFaithful    ///< What the application that saved the file shows.
};

} // namespace Tarnell::Fbx
