// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <span>
#include <unordered_map>
#include <vector>

#include "document/legacy/LegacyNames.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A curve node of a document, resolved: its target, and its curves by component.
struct DrivenProperty {
    std::string_view property;
    const DocumentObject* node = nullptr;
    using Curves = std::unordered_map<std::string_view, const DocumentObject*>;
    Curves curves; ///< by "d|X", …
};

/// The positions of a document's parts in a file before 7.0: attributes inside their Models, animation inside takes.
class LegacyLayout {
public:
    explicit LegacyLayout(const Document& document);

    [[nodiscard]] const Document& document() const { return mDocument; }
    [[nodiscard]] LegacyName nameOf(std::int64_t id) const { return mNames[id]; }
    /// Null when there is none of that id.
    [[nodiscard]] const DocumentObject* find(std::int64_t id) const;

    /// The attribute inside a Model; null when it has none.
    [[nodiscard]] const DocumentObject* attributeOf(std::int64_t model) const;
    /// The Models that contain an attribute; empty for objects with a record of their own.
    [[nodiscard]] std::span<const std::int64_t> holdersOf(std::int64_t attribute) const;
    /// Whether the object has a record of its own in the file.
    [[nodiscard]] bool standsAlone(const DocumentObject& object) const;

    /// The stacks, and the objects that the base layer of each drives, in the order of objects. Takes have no further
    /// layers.
    using Driven = std::vector<std::pair<std::int64_t, std::vector<DrivenProperty>>>;
    [[nodiscard]] Driven drivenBy(std::string_view stack) const;

private:
    void findAttributes();
    void findAnimation();

    const Document& mDocument;
    LegacyNames mNames;
    IdTable<const DocumentObject*> mObjects, mAttributes;
    std::vector<std::int64_t> mHolders; ///< those of one attribute next to each other
    IdTable<std::span<const std::int64_t>> mHoldersOf;
    std::unordered_map<std::string_view, std::int64_t> mBaseLayers; ///< by the name of the first stack that has one
    // The curve nodes of each layer; the curves of each curve node and its target.
    std::unordered_map<std::int64_t, std::vector<std::int64_t>> mMembers;
    std::unordered_map<std::int64_t, DrivenProperty::Curves> mCurves;
    std::unordered_map<std::int64_t, std::vector<const DocumentConnection*>> mDriving;
};

/// The section with all takes and their animation.
void writeLegacyTakes(const LegacyLayout& layout, const VersionTraits& traits, RecordSink& sink);

} // namespace detail
FBXSDK_NAMESPACE_END
