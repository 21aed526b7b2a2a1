// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Node attributes of files before 6.0: their values are plain records, which become properties.
#pragma once

#include <string_view>
#include <vector>

#include "document/DocumentBuilder.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The kind of attribute a Model record holds, in the spelling of 7.x: "Mesh", "Camera", …; empty for none.
[[nodiscard]] std::string_view legacyKindOf(const Record& model);

/// The properties of an attribute of that kind.
[[nodiscard]] std::vector<DocumentProperty> legacyAttributeProperties(DocumentBuilder& builder, std::string_view kind,
                                                                      const Record& model);

/// The properties of a Model apart from its transform.
[[nodiscard]] std::vector<DocumentProperty> legacyModelProperties(DocumentBuilder& builder, const Record& model);

/// The properties of a material.
[[nodiscard]] std::vector<DocumentProperty> legacyMaterialProperties(DocumentBuilder& builder, const Record& material);

} // namespace detail
FBXSDK_NAMESPACE_END
