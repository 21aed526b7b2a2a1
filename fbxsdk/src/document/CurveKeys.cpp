// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "document/CurveKeys.h"

#include <algorithm>
#include <limits>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Drops the attributes that no key uses any more.
void compactAttributes(CurveKeys& keys) {
    constexpr auto kUnused = std::numeric_limits<std::uint32_t>::max();
    std::vector<std::uint32_t> newIndex(keys.attributes.size(), kUnused);
    std::vector<KeyAttributes> used;
    for (std::uint32_t& index : keys.attributeOfKey) {
        if (index >= newIndex.size())
            continue;
        if (newIndex[index] == kUnused) {
            newIndex[index] = static_cast<std::uint32_t>(used.size());
            used.push_back(keys.attributes[index]);
        }
        index = newIndex[index];
    }
    keys.attributes = std::move(used);
}

} // namespace

void CurveKeys::setAttributes(std::size_t key, const KeyAttributes& keyAttributes) {
    const bool hasBefore = key > 0 && key - 1 < attributeOfKey.size() && attributeOfKey[key - 1] < attributes.size();
    if (hasBefore && attributes[attributeOfKey[key - 1]] == keyAttributes) {
        attributeOfKey[key] = attributeOfKey[key - 1];
        return;
    }
    // A key that is set in several steps alternates between several attributes and those of the keys before.
    constexpr std::size_t kLatest = 4;
    const std::size_t oldest = attributes.size() - std::min(attributes.size(), kLatest);
    for (std::size_t i = attributes.size(); i > oldest; --i) {
        if (attributes[i - 1] == keyAttributes) {
            attributeOfKey[key] = static_cast<std::uint32_t>(i - 1);
            return;
        }
    }
    if (attributes.size() > 2 * attributeOfKey.size())
        compactAttributes(*this);
    attributes.push_back(keyAttributes);
    attributeOfKey[key] = static_cast<std::uint32_t>(attributes.size() - 1);
}

} // namespace detail
FBXSDK_NAMESPACE_END
