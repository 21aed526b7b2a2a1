// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One object of a document becomes one object of a scene.
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

/// A line of a class's defaults that says something else than the class's own row.
struct TemplateLine {
    int index; ///< of the property
    const DocumentProperty* line;
};

/// Sets only properties that the class has: the defaults that a file states for a class. What it takes for the next
/// object of the class that is as fresh as this one is added to the lines.
void readTemplate(FbxObject& object, std::span<const DocumentProperty> properties, std::vector<TemplateLine>& lines);
void applyTemplate(FbxObject& object, std::span<const TemplateLine> lines);

/// Objects of one document, one after the other. Their properties are read when they are asked for.
class ObjectReader {
public:
    ObjectReader(std::shared_ptr<const Document> document, FbxScene& scene);
    ObjectReader(const ObjectReader&) = delete;
    ObjectReader& operator=(const ObjectReader&) = delete;
    ~ObjectReader();

    /// Null when the object's class is not one that the platform knows.
    FbxObject* read(const DocumentObject& source);

private:
    [[nodiscard]] FbxClassId classOf(const DocumentObject& source);

    std::shared_ptr<const Document> mDocument;
    std::shared_ptr<const PropertySource> mProperties;
    FbxScene& mScene;
    // Objects of one kind mostly come in a row.
    std::string_view mLastRecord, mLastSubClass;
    const SchemaClass* mLastSchema = nullptr;
};

} // namespace detail
FBXSDK_NAMESPACE_END
