// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One object of a document becomes one object of a scene.
#pragma once

#include <memory>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
class FbxObject;
class FbxScene;
namespace detail {

/// Null when the object's class is not one that the platform knows.
FbxObject* readObject(const std::shared_ptr<const Document>& document, const DocumentObject& source, FbxScene& scene);

} // namespace detail
FBXSDK_NAMESPACE_END
