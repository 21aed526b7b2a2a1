// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "document/PropertyNames.h"

#include <algorithm>
#include <iterator>

#include "schema/NameIndex.h"
#include "schema/OldNames.h"
#include "schema/PropertyFlags.h"
#include "schema/Schema.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr std::pair<std::string_view, std::string_view> kAttributeFlags[] = {
    {"N", ""}, {"AN", "A"}, {"A+N", "A+"}, {"HN", "H"}, {"AUN", "AU"}, {"UN", "U"},
};

} // namespace

bool isModelProperty(std::string_view name) {
    static const NameIndex names(kNodeRows, [](const PropertyRow& row) { return row.name; });
    return names.find(NameKey(name)) >= 0;
}

std::string_view modernPropertyName(std::string_view subClass, std::string_view name) {
    for (const OldPropertyName& row : kOldPropertyNames)
        if (row.oldName == name && (row.subClass == subClass || row.className == subClass))
            return row.newName;
    return name;
}

std::string_view legacyPropertyName(std::string_view subClass, std::string_view name) {
    for (const OldPropertyName& row : kOldPropertyNames)
        if (row.written && row.subClass == subClass && row.newName == name)
            return row.oldName;
    return name;
}

void modernizePropertyNames(std::string_view record, std::string_view subClass,
                            std::vector<DocumentProperty>& properties) {
    if (record != "NodeAttribute")
        return;
    for (const OldPropertyName& row : kOldPropertyNames) {
        if (row.subClass != subClass && row.className != subClass)
            continue;
        const auto isCalled = [&](std::string_view name) {
            return [name](const DocumentProperty& property) { return property.name == name; };
        };
        if (std::none_of(properties.begin(), properties.end(), isCalled(row.newName)))
            for (DocumentProperty& property : properties)
                if (property.name == row.oldName)
                    property.name = row.newName;
    }
}

std::string_view attributeFlags(RecordTree& tree, std::string_view flags) {
    if (flags.find(kAttributeFlagLetter) == std::string_view::npos)
        return flags;
    const auto* found = std::find_if(std::begin(kAttributeFlags), std::end(kAttributeFlags),
                                     [&](const auto& row) { return row.first == flags; });
    if (found != std::end(kAttributeFlags))
        return found->second;
    std::string kept(flags);
    std::erase(kept, kAttributeFlagLetter);
    return tree.keepText(std::move(kept));
}

} // namespace detail
FBXSDK_NAMESPACE_END
