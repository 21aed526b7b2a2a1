// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Two passes: unique names stay unchanged, whatever numbered names the others need.
#include "document/legacy/LegacyNames.h"

#include "container/FileFormat.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The root is never declared, but no object may take its name.
constexpr std::string_view kRootClass = "Model", kRootName = "Scene";

std::string keyOf(std::string_view nameClass, std::string_view name) {
    std::string key(nameClass);
    key += kAsciiNameSeparator;
    key += name;
    return key;
}

} // namespace

LegacyNames::LegacyNames(const std::vector<DocumentObject>& objects) {
    mNames.emplace(0, LegacyName{kRootClass, std::string(kRootName)});
    std::unordered_set<std::string> taken{keyOf(kRootClass, kRootName)};
    std::vector<const DocumentObject*> clashing;
    for (const DocumentObject& object : objects)
        if (taken.insert(keyOf(object.content->nameClass, object.name)).second)
            mNames.emplace(object.id, LegacyName{object.content->nameClass, std::string(object.name)});
        else
            clashing.push_back(&object);
    std::unordered_map<std::string, int> numbers; // the last one that was used after a name
    for (const DocumentObject* object : clashing) {
        const std::string base = std::string(object->name) + "_ncl1_";
        int& number = numbers[keyOf(object->content->nameClass, base)];
        std::string name;
        do
            name = base + std::to_string(++number);
        while (!taken.insert(keyOf(object->content->nameClass, name)).second);
        mNames.emplace(object->id, LegacyName{object->content->nameClass, std::move(name)});
    }
}

} // namespace detail
FBXSDK_NAMESPACE_END
