// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The names of the kinds of objects in files, and the platform's class for each.
#pragma once

#include <span>
#include <string_view>

#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// One kind of object: record name and sub-class in files, and the platform's class.
/// Readers and writers share these rows.
struct SchemaClass {
    std::string_view record;    ///< "Model", "NodeAttribute", …
    std::string_view subClass;  ///< "Camera", "LimbNode", …; kAnySubClass where the record alone decides
    std::string_view nameClass; ///< the part before "::" in names: "SubDeformer", "AnimStack", …
    const ClassInfo* info;
    std::span<const PropertyRow> rows; ///< of the class's property template; empty where files have none

    [[nodiscard]] FbxClassId classId() const { return FbxClassId(info); }
    /// The name of the class's property template: "FbxNode", "FbxSurfacePhong", …
    [[nodiscard]] const char* templateName() const { return info->name; }
};

inline constexpr std::string_view kAnySubClass = "*";

/// All classes that files have. Of several rows for one class the usual one comes first.
[[nodiscard]] std::span<const SchemaClass> schemaClasses();

/// The class for a record and sub-class; null for objects without a class in the platform. A material's class depends
/// on its shading model as well: here it is the generic one.
[[nodiscard]] const SchemaClass* findSchema(std::string_view record, std::string_view subClass);

/// The first row of the class, or of its nearest base class that files have; null when there is none.
[[nodiscard]] const SchemaClass* findSchema(const FbxClassId& id);

} // namespace detail
FBXSDK_NAMESPACE_END
