// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Shading modes of nodes as files spell them: one letter.
#pragma once

#include <fbxsdk/FbxNode.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// eHardShading, which nodes have that nobody set a mode for, for a letter that is none of them.
[[nodiscard]] FbxNode::EShadingMode shadingModeOf(char letter);
[[nodiscard]] char shadingLetterOf(FbxNode::EShadingMode mode);

} // namespace detail
FBXSDK_NAMESPACE_END
