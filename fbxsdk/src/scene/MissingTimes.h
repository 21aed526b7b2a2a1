// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What a file leaves out about its times: the spans of its stacks, and the rate of a custom time mode.
#pragma once

#include <string>
#include <vector>

#include "document/Document.h"
#include "scene/SceneData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Gives every stack of the document that states no span that of its keys; without keys its reference span, and
/// without that the span of the scene, if the file states one. `objects` are the scene's by their place in
/// Document::objects.
void fillStackSpans(const Document& document, const std::vector<FbxObject*>& objects, FbxScene& scene);

/// Gives a scene of the custom time mode, when the document states no rate for it, the one that the keys of its first
/// stack tell, or else the span of that stack. A sentence about it; empty when there was nothing to do.
[[nodiscard]] std::string fillFrameRate(const Document& document, const std::vector<FbxObject*>& objects,
                                        FbxScene& scene);

} // namespace detail
FBXSDK_NAMESPACE_END
