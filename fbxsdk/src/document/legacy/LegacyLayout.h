// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What of a document stands where in a file before 7.0: attributes inside their Models, animation inside takes.
#pragma once

#include <unordered_map>
#include <vector>

#include "document/legacy/LegacyNames.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A curve node of a document, resolved: what it drives, and its curves by component.
struct DrivenProperty {
    std::string_view property;
    const DocumentObject* node = nullptr;
    using Curves = std::unordered_map<std::string_view, const DocumentObject*>;
    Curves curves; ///< by "d|X", …
};

class LegacyLayout {
public:
    explicit LegacyLayout(const Document& document);

    [[nodiscard]] const Document& document() const { return mDocument; }
    [[nodiscard]] const LegacyName& nameOf(std::int64_t id) const { return mNames[id]; }
    /// Null when there is none of that id.
    [[nodiscard]] const DocumentObject* find(std::int64_t id) const;

    /// The attribute that stands inside a Model; null when it has none.
    [[nodiscard]] const DocumentObject* attributeOf(std::int64_t model) const;
    /// The Models that an attribute stands in; empty for what has a record of its own.
    [[nodiscard]] const std::vector<std::int64_t>& holdersOf(std::int64_t attribute) const;
    /// Whether the object has a record of its own in the file.
    [[nodiscard]] bool standsAlone(const DocumentObject& object) const;

    /// The stacks, and what the base layer of each drives: by object, in the order of objects. Takes have no further
    /// layers.
    using Driven = std::vector<std::pair<std::int64_t, std::vector<DrivenProperty>>>;
    [[nodiscard]] Driven drivenBy(std::string_view stack) const;

private:
    void findAttributes();
    void findAnimation();

    const Document& mDocument;
    LegacyNames mNames;
    std::unordered_map<std::int64_t, const DocumentObject*> mObjects;
    std::unordered_map<std::int64_t, const DocumentObject*> mAttributes;
    std::unordered_map<std::int64_t, std::vector<std::int64_t>> mHolders;
    std::unordered_map<std::string_view, std::int64_t> mBaseLayers; ///< by the name of the first stack that has one
    // Of each layer its curve nodes, of each curve node its curves and what it drives.
    std::unordered_map<std::int64_t, std::vector<std::int64_t>> mMembers;
    std::unordered_map<std::int64_t, DrivenProperty::Curves> mCurves;
    std::unordered_map<std::int64_t, std::vector<const DocumentConnection*>> mDriving;
};

/// The section with all takes and their animation.
void writeLegacyTakes(const LegacyLayout& layout, const VersionTraits& traits, RecordSink& sink);

} // namespace detail
FBXSDK_NAMESPACE_END
