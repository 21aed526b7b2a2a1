// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A scene becomes a document to be written: the mirror of SceneReading.
#pragma once

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
class FbxScene;
namespace detail {

/// Fills the document with everything that the scene has and the version has a place for. The document points into the
/// scene: nothing may change before it is written.
void writeScene(FbxScene& scene, const VersionTraits& traits, Document& document);

} // namespace detail
FBXSDK_NAMESPACE_END
