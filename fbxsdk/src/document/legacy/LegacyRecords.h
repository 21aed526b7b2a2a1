// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The data that older files keep in records of their own: settings before 7.0, attributes and meshes before 6.0.
#pragma once

#include <string_view>
#include <vector>

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The content of Version5 of a 6.x file and of the top level of older ones. Only sets what is not set yet.
void readLegacySettings(DocumentBuilder& builder, const Record& parent);

/// The kind of attribute a Model record holds, in the spelling of 7.x: "Mesh", "Camera", …; empty for none.
[[nodiscard]] std::string_view legacyKindOf(const Record& model);

/// The properties of an attribute of that kind.
[[nodiscard]] std::vector<DocumentProperty> legacyAttributeProperties(DocumentBuilder& builder, std::string_view kind,
                                                                      const Record& model);

/// The properties of a Model except its transform.
[[nodiscard]] std::vector<DocumentProperty> legacyModelProperties(DocumentBuilder& builder, const Record& model);

/// The properties of a material.
[[nodiscard]] std::vector<DocumentProperty> legacyMaterialProperties(DocumentBuilder& builder, const Record& material);

/// The geometry that a Model record of a 5.x file holds, with its normals, texture coordinates and material indices as
/// layer elements. The arrays are shared with the original.
[[nodiscard]] const Record& layeredGeometry(DocumentBuilder& builder, const Record& model);

} // namespace detail
FBXSDK_NAMESPACE_END
