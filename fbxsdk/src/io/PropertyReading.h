// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Property lines of a document become properties of an object.
#pragma once

#include <span>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
class FbxObject;
namespace detail {

/// Sets the properties that the object's class has, converting where a writer chose another type, and appends the
/// others as dynamic ones.
void readProperties(FbxObject& object, std::span<const DocumentProperty> properties);

/// Sets only properties that the class has: the defaults that a file states for a class.
void readTemplate(FbxObject& object, std::span<const DocumentProperty> properties);

} // namespace detail
FBXSDK_NAMESPACE_END
