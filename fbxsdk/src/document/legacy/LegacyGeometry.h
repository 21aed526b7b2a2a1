// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes of files before 6.0.
#pragma once

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The geometry that a Model record of a 5.x file holds, with its normals, texture coordinates and material indices as
/// layer elements. The arrays are shared with the original.
[[nodiscard]] const Record& layeredGeometry(DocumentBuilder& builder, const Record& model);

} // namespace detail
FBXSDK_NAMESPACE_END
