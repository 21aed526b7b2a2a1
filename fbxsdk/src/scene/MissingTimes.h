// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Defaults for times that a file does not state: the spans of its stacks, and the rate of a custom time mode.
#pragma once

#include <string>
#include <vector>

#include "document/Document.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Sets the span of every stack of the document that states none to that of its keys; without keys to its reference
/// span, and without that to the span of the scene, if the file states one. `objects` are the scene's objects, by their
/// index in Document::objects.
void fillStackSpans(const Document& document, const std::vector<FbxObject*>& objects, FbxScene& scene);

/// Sets the rate of a scene with the custom time mode, when the document states none, to one that fits the keys of its
/// first stack, or else the span of that stack. Returns a warning; empty when there was nothing to do. Notes in the
/// scene whether the document states one.
[[nodiscard]] std::string fillFrameRate(const Document& document, const std::vector<FbxObject*>& objects,
                                        FbxScene& scene);

} // namespace detail
FBXSDK_NAMESPACE_END
