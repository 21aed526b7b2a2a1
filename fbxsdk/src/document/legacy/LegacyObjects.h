// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Objects of files that identify them by name: the common part of the translations of the 5.x and 6.x generations.
#pragma once

#include <cstdint>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "document/DocumentBuilder.h"
#include "document/legacy/InlineShapes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The objects that one Model record became.
struct LegacyModel {
    std::int64_t attribute = 0;                                       ///< 0 when it has none
    std::unordered_map<std::string_view, std::int64_t> shapeChannels; ///< by the shape's name
};

/// The objects of a document by the names that the file uses for them. Ids are assigned in order, so that the object
/// with the id n is the n-th.
class LegacyObjects {
public:
    explicit LegacyObjects(DocumentBuilder& builder) : mBuilder(builder) {}

    [[nodiscard]] DocumentBuilder& builder() { return mBuilder; }

    /// Adds an object under its full name, class included. Of equal names the first is found, but both are objects.
    std::int64_t add(std::string_view fullName, std::string_view record, std::string_view subClass,
                     const Record* body = nullptr);
    /// A second name for an object, unless the name is taken.
    void addAlias(std::string_view fullName, std::int64_t id) { mIds.emplace(fullName, id); }

    /// 0 when there is none.
    [[nodiscard]] std::int64_t find(std::string_view fullName) const;
    [[nodiscard]] DocumentObject& at(std::int64_t id);
    /// Like DocumentObject::property, but fast for many look-ups. Properties may be added in between, not removed.
    [[nodiscard]] DocumentProperty* property(std::int64_t id, std::string_view name);
    /// Sets the values of a property, which is added when the object has none of the name.
    void setProperty(std::int64_t id, const DocumentProperty& property);

    /// The parts of a Model; empty for other objects.
    [[nodiscard]] LegacyModel& model(std::int64_t id) { return mModels[id]; }
    [[nodiscard]] const LegacyModel* findModel(std::int64_t id) const;

    /// Adds an attribute below a Model: "Geometry" or "NodeAttribute", as its kind demands.
    std::int64_t addAttribute(std::int64_t model, std::string_view kind, std::string_view fullName,
                              std::vector<DocumentProperty> properties, const Record* body);
    /// Connects the deformers of a Model to its geometry, which is a separate object from 7.x on.
    [[nodiscard]] std::int64_t deformedBy(std::int64_t source, std::int64_t destination);

    /// A pose whose nodes are named, in the form of those whose nodes are numbered.
    [[nodiscard]] const Record& numberedPose(const Record& pose);

private:
    struct PropertyIndex {
        std::size_t indexed = 0; ///< how many of the object's properties are indexed
        std::unordered_map<std::string_view, std::size_t> positions;
    };

    DocumentBuilder& mBuilder;
    std::unordered_map<std::string_view, std::int64_t> mIds;
    std::unordered_map<std::int64_t, LegacyModel> mModels;
    std::unordered_map<std::int64_t, PropertyIndex> mProperties;
};

/// "Geometry" for the kinds with points, "NodeAttribute" for all others.
[[nodiscard]] std::string_view attributeRecordOf(std::string_view kind);

} // namespace detail
FBXSDK_NAMESPACE_END
