// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converts an object of a document to an object of a scene.
#pragma once

#include <memory>
#include <span>
#include <string_view>
#include <vector>

#include "document/Document.h"
#include "object/ObjectData.h"

FBXSDK_NAMESPACE_BEGIN
class FbxScene;
namespace detail {

struct SchemaClass;

/// Sets the properties that the object's class has, converting where a writer chose another type, and appends the
/// others as dynamic ones.
void readProperties(FbxObject& object, std::span<const DocumentProperty> properties);

/// A line of a class's defaults that differs from the class's own row.
struct TemplateLine {
    int index; ///< of the property
    const DocumentProperty* line;
};

/// Sets only properties that the class has: the defaults that a file states for a class. The changes needed for further
/// new objects of the class are added to the lines.
void readTemplate(FbxObject& object, std::span<const DocumentProperty> properties, std::vector<TemplateLine>& lines);
void applyTemplate(FbxObject& object, std::span<const TemplateLine> lines);

/// Creates the objects of one document, one after the other. Their properties are read on first access.
class ObjectReader {
public:
    ObjectReader(std::shared_ptr<const Document> document, FbxScene& scene);
    ObjectReader(const ObjectReader&) = delete;
    ObjectReader& operator=(const ObjectReader&) = delete;
    ~ObjectReader();

    /// Null when the platform has no class for the object.
    FbxObject* read(const DocumentObject& source);

private:
    [[nodiscard]] FbxClassId classOf(const DocumentObject& source);

    std::shared_ptr<const Document> mDocument;
    std::shared_ptr<const PropertySource> mProperties;
    FbxScene& mScene;
    // Objects of one kind usually come in a row.
    std::string_view mLastRecord, mLastSubClass;
    const SchemaClass* mLastSchema = nullptr;
};

} // namespace detail
FBXSDK_NAMESPACE_END
