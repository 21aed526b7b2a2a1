// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converts a scene to a document to be written: the inverse of SceneReading.
#pragma once

#include <vector>

#include "document/Document.h"
#include "io/SchemaClass.h"
#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN

class FbxNodeAttribute;
class FbxObject;
class FbxScene;

namespace detail {

/// Fills the document with everything that the scene has and the version can hold. The document points into the
/// scene: nothing may change before it is written.
void writeScene(FbxScene& scene, const VersionTraits& traits, Document& document);

/// Whether the attribute is one of the application's views: a producer camera or the switcher between them, on nodes
/// that are unparented.
[[nodiscard]] bool isView(const FbxNodeAttribute& attribute);

/// Everything about the object except its id. Its large arrays are fetched when they are written.
[[nodiscard]] DocumentObject writableObject(FbxObject& object, const SchemaClass& schema, const VersionTraits& traits,
                                            RecordTree& texts);

/// The start and end that files state for a span: where it is empty, as it is when not set, those of the keys.
struct WrittenSpan {
    std::int64_t start = 0, stop = 0;
};
[[nodiscard]] WrittenSpan writtenSpan(const FbxTimeSpan& span, const FbxAnimStack& stack);

/// Which properties of an object are written.
enum class PropertyChoice {
    changed, ///< those that differ from their class's defaults, or are connected
    all
};

/// The lines in file order: those of the class, then the dynamic ones. Properties that are not to be saved are
/// omitted.
[[nodiscard]] std::vector<DocumentProperty> writableProperties(const FbxObject& object, PropertyChoice choice,
                                                               RecordTree& texts);

/// The defaults of a class, as its template holds them.
[[nodiscard]] std::vector<DocumentProperty> templateProperties(std::span<const PropertyRow> rows, RecordTree& texts);

/// The name by which connections refer to a property.
[[nodiscard]] std::string_view propertyName(const FbxObject& object, int index);

/// Replaces the values of the line of that name, or appends the line.
void setProperty(std::vector<DocumentProperty>& properties, const DocumentProperty& line);

/// One value for a line.
[[nodiscard]] std::span<const Value> keepValue(RecordTree& texts, const Value& value);

/// The type string of a property on the curve node that drives it, for a property of one number.
[[nodiscard]] std::string_view channelTypeName(const FbxDataType& type);

} // namespace detail
FBXSDK_NAMESPACE_END
