// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A document becomes a scene: settings and connections, and one small reader per object class.
#pragma once

#include <memory>
#include <span>
#include <string>
#include <vector>

#include <fbxsdk/FbxStatus.h>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN

class FbxObject;
class FbxScene;

namespace detail {

/// Adds everything the document holds to the scene. The scene keeps the document alive: geometry is read from it on
/// first use.
///
/// What had to be worked out because the file does not state it goes to `notes`, a sentence each.
bool readScene(const std::shared_ptr<const Document>& document, FbxScene& scene, FbxStatus& status,
               std::vector<std::string>* notes = nullptr);

/// Null when the object's class is not one that the platform knows.
FbxObject* readObject(const std::shared_ptr<const Document>& document, const DocumentObject& source, FbxScene& scene);

/// Sets the properties that the object's class has, converting where a writer chose another type, and appends the
/// others as dynamic ones.
void readProperties(FbxObject& object, std::span<const DocumentProperty> properties);

/// Sets only properties that the class has: the defaults that a file states for a class.
void readTemplate(FbxObject& object, std::span<const DocumentProperty> properties);

} // namespace detail
FBXSDK_NAMESPACE_END
