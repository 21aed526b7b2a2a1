// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Two passes: unique names stay unchanged, whatever numbered names the others need.
#include "document/legacy/LegacyNames.h"

#include <functional>
#include <unordered_map>
#include <unordered_set>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The root is never declared, but no object may take its name.
constexpr std::string_view kRootClass = "Model", kRootName = "Scene";

struct HashOfName {
    std::size_t operator()(const LegacyName& name) const {
        constexpr std::size_t kFactor = 31;
        const std::hash<std::string_view> hash;
        return hash(name.nameClass) * kFactor + hash(name.name);
    }
};

} // namespace

LegacyNames::LegacyNames(const std::vector<DocumentObject>& objects) {
    mNames.at(0) = {kRootClass, kRootName};
    std::unordered_set<LegacyName, HashOfName> taken{mNames[0]};
    taken.reserve(objects.size());
    std::vector<const DocumentObject*> clashing;
    for (const DocumentObject& object : objects) {
        const LegacyName name{object.content->nameClass, object.name};
        if (taken.insert(name).second)
            mNames.at(object.id) = name;
        else
            clashing.push_back(&object);
    }
    std::unordered_map<LegacyName, int, HashOfName> numbers; // the last one that was used after a name
    for (const DocumentObject* object : clashing) {
        int& number = numbers[{object->content->nameClass, object->name}];
        const std::string base = std::string(object->name) + "_ncl1_";
        LegacyName& name = mNames.at(object->id);
        std::string& text = mNumbered.emplace_back();
        do {
            text = base + std::to_string(++number);
            name = {object->content->nameClass, text};
        } while (!taken.insert(name).second);
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
