// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converts a document to a scene.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include <fbxsdk/FbxStatus.h>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN

class FbxScene;

namespace detail {

/// Adds everything the document holds to the scene. The scene shares ownership of the document: geometry is read from
/// it on first use.
///
/// What was derived because the file does not state it is added to `notes`, one sentence each.
bool readScene(const std::shared_ptr<const Document>& document, FbxScene& scene, FbxStatus& status,
               std::vector<std::string>* notes = nullptr);

} // namespace detail
FBXSDK_NAMESPACE_END
