// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Why a mesh that has a point cache shows without it.
#pragma once

#include <string>

#include <fbxsdk.h>

namespace tool {

/// Opens the mesh's cache and reads its samples as the library would; empty when every one of them can be used, and
/// when the mesh has no cache.
std::string cacheFault(FbxMesh& mesh);

} // namespace tool
