// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties of objects become property lines of a document.
#pragma once

#include <vector>

#include "document/Document.h"
#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Which properties of an object are written.
enum class PropertyChoice {
    changed, ///< those that differ from their class's defaults, or are connected
    all
};

/// The lines in file order: those of the class, then the dynamic ones. Properties that are not to be saved are left
/// out.
[[nodiscard]] std::vector<DocumentProperty> writableProperties(const FbxObject& object, PropertyChoice choice,
                                                               RecordTree& texts);

/// The defaults of a class, as its template holds them.
[[nodiscard]] std::vector<DocumentProperty> templateProperties(std::span<const PropertyRow> rows, RecordTree& texts);

/// The name by which connections know a property.
[[nodiscard]] std::string_view propertyName(const FbxObject& object, int index);

/// Replaces the values of the line of that name, or appends the line.
void setProperty(std::vector<DocumentProperty>& properties, const DocumentProperty& line);

/// One value for a line.
[[nodiscard]] std::span<const Value> keepValue(RecordTree& texts, const Value& value);

/// How the type of a property is spelt on the curve node that drives a property of one number.
[[nodiscard]] std::string_view channelTypeName(const FbxDataType& type);

} // namespace detail
FBXSDK_NAMESPACE_END
