// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "document/Document.h"

#include <algorithm>
#include <utility>

#include "document/WrittenLines.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

const DocumentProperty* DocumentObject::property(std::string_view propertyName) const {
    const auto found = std::find_if(properties.rbegin(), properties.rend(),
                                    [&](const DocumentProperty& property) { return property.name == propertyName; });
    return found == properties.rend() ? nullptr : &*found;
}

const DocumentObject* Document::find(std::int64_t objectId) const {
    if (idIndex.empty())
        return nullptr;
    // Ids are like random numbers: a search with branches takes the wrong one at half of its steps.
    const auto* entry = idIndex.data();
    for (std::size_t count = idIndex.size(); count > 1;) {
        const std::size_t half = count / 2;
        entry += half * std::size_t{entry[half - 1].first < objectId};
        count -= half;
    }
    return entry->first == objectId ? &objects[entry->second] : nullptr;
}

std::span<const Value> Document::keep(std::initializer_list<Value> values) {
    const std::span<Value> kept = tree->newValues(values.size());
    std::copy(values.begin(), values.end(), kept.begin());
    return kept;
}

void Document::settleProperties(DocumentObject& object) const {
    WrittenLines lines;
    lines.fill(object);
    object.properties = lines.kept(*tree);
    object.content->properties = nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
