// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The names of properties in older files, and the objects that they belong to.
#pragma once

#include <string_view>
#include <vector>

#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// True for the properties that every Model has.
[[nodiscard]] bool isModelProperty(std::string_view name);

/// The present name of a property of a node attribute ("Light", "Camera" or the class names "FbxLight", "FbxCamera").
[[nodiscard]] std::string_view modernPropertyName(std::string_view subClass, std::string_view name);

/// The name in files before 7.0 of a property of a kind of attribute.
[[nodiscard]] std::string_view legacyPropertyName(std::string_view subClass, std::string_view name);

/// Renames old properties of lights and cameras to their present names, unless the list has a property of that name.
/// `record` is the object's record name; only node attributes have such properties.
void modernizePropertyNames(std::string_view record, std::string_view subClass,
                            std::vector<DocumentProperty>& properties);

/// The flags of a node attribute's property without the letter N, which states to which object it belongs.
[[nodiscard]] std::string_view attributeFlags(RecordTree& tree, std::string_view flags);

} // namespace detail
FBXSDK_NAMESPACE_END
