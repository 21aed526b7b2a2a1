// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A document becomes a scene.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <fbxsdk/FbxStatus.h>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN

class FbxScene;

namespace detail {

/// Adds everything the document holds to the scene. The scene keeps the document alive: geometry is read from it on
/// first use.
///
/// What had to be worked out because the file does not state it goes to `notes`, a sentence each.
bool readScene(const std::shared_ptr<const Document>& document, FbxScene& scene, FbxStatus& status,
               std::vector<std::string>* notes = nullptr);

} // namespace detail
FBXSDK_NAMESPACE_END
