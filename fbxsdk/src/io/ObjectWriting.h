// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One object of a scene becomes one object of a document: the mirror of ObjectReading.
#pragma once

#include "document/Document.h"
#include "io/SchemaClass.h"

FBXSDK_NAMESPACE_BEGIN
class FbxNodeAttribute;
class FbxObject;
namespace detail {

/// Whether the attribute is one of the application's views: a producer camera or the switcher between them, on nodes
/// that hang nowhere.
[[nodiscard]] bool isView(const FbxNodeAttribute& attribute);

/// Everything about the object but its id. What the object holds in large arrays is fetched when it is written.
[[nodiscard]] DocumentObject writableObject(FbxObject& object, const SchemaClass& schema, const VersionTraits& traits,
                                            RecordTree& texts);

/// The start and end that files state for a span: where it is empty, as it is when nobody set it, those of the keys.
struct WrittenSpan {
    std::int64_t start = 0, stop = 0;
};
[[nodiscard]] WrittenSpan writtenSpan(const FbxTimeSpan& span, const FbxAnimStack& stack);

} // namespace detail
FBXSDK_NAMESPACE_END
