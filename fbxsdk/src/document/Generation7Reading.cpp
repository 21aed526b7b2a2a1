// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files of the 7.x generation: numbered objects and connections between the numbers, with little translation.
#include <algorithm>

#include "document/DocumentBuilder.h"
#include "document/PropertyNames.h"
#include "document/TakeTimes.h"
#include "document/legacy/InlineShapes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

std::vector<DocumentProperty> readProperties(DocumentBuilder& builder, const Record& owner) {
    std::vector<DocumentProperty> properties;
    const Record* list = owner.child("Properties70");
    if (!list)
        return properties;
    std::size_t count = 0;
    for ([[maybe_unused]] const Record& line : list->children())
        ++count;
    properties.reserve(count);
    constexpr std::size_t kTexts = 4; // name, type, sub-type, flags
    for (const Record& line : list->children()) {
        const std::string_view name = line.value(0).toText();
        if (line.name != "P" || name.empty())
            continue;
        DocumentProperty property =
            propertyOf(name, line.value(1).toText(), line.value(2).toText(), line.value(3).toText(),
                       line.values.subspan(std::min(kTexts, line.values.size())));
        builder.rescale(property);
        properties.push_back(property);
    }
    return properties;
}

void readObject(DocumentBuilder& builder, const Record& record) {
    if (record.name == "GlobalSettings") { // some writers put it here
        if (builder.document().globalSettings.empty())
            builder.document().globalSettings = readProperties(builder, record);
        return;
    }
    const std::int64_t id = record.value(0).isNumber() ? record.value(0).toInteger() : 0;
    if (id == 0) {
        builder.warn(record, "the object has no id; it is left out");
        return;
    }
    const std::string_view name = nameWithoutClass(record.value(1).toText(), builder.tree().ascii);
    DocumentObject& object = builder.addObject(id, record.name, record.value(2).toText(), name, &record);
    object.properties = readProperties(builder, record);
    modernizePropertyNames(object.record, object.subClass, object.properties);
}

void readObjects(DocumentBuilder& builder, const Record& list) {
    std::size_t count = builder.document().objects.size();
    for ([[maybe_unused]] const Record& record : list.children())
        ++count;
    builder.document().objects.reserve(count);
    for (const Record& record : list.children())
        readObject(builder, record);
}

void readConnections(DocumentBuilder& builder, const Record& list) {
    for (const Record& record : list.children()) {
        const ConnectionEnds ends = connectionEnds(record);
        if (ends.source && ends.source->isNumber() && ends.destination->isNumber())
            builder.connect(ends.source->toInteger(), ends.destination->toInteger(), ends.destinationProperty,
                            ends.sourceProperty);
        else
            builder.warn(record, "not a connection between two objects; it is left out");
    }
}

void readDefinitions(DocumentBuilder& builder, const Record& list) {
    for (const Record& type : list.children()) {
        if (type.name != "ObjectType")
            continue;
        for (const Record& record : type.children()) {
            if (record.name != "PropertyTemplate")
                continue;
            DocumentTemplate& defaults = builder.document().templates.emplace_back();
            defaults.record = type.value(0).toText();
            defaults.className = record.value(0).toText();
            defaults.properties = readProperties(builder, record);
            modernizePropertyNames(defaults.record, defaults.className, defaults.properties);
        }
    }
}

void readGlobalSettings(DocumentBuilder& builder, const Record& record) {
    builder.document().globalSettings = readProperties(builder, record);
}

void readDocuments(DocumentBuilder& builder, const Record& list) {
    for (const Record& record : list.children())
        for (const DocumentProperty& property : readProperties(builder, record))
            if (property.name == "ActiveAnimStackName" && !property.values.empty())
                builder.document().activeStackName = property.values.front().toText();
}

/// The top-level records that are read, in any order.
struct Section {
    std::string_view name;
    void (*read)(DocumentBuilder&, const Record&);
};
constexpr Section kSections[] = {
    {"GlobalSettings", readGlobalSettings}, {"Documents", readDocuments},
    {"Definitions", readDefinitions},       {"Objects", readObjects},
    {"Connections", readConnections},       {"Takes", readTakeTimes},
};

} // namespace

void readGeneration7(DocumentBuilder& builder) {
    for (const Record& record : builder.root().children())
        for (const Section& section : kSections)
            if (section.name == record.name)
                section.read(builder, record);
    fillStackTimes(builder);
    builder.indexObjects();
    translateInlineShapes(builder);
}

} // namespace detail
FBXSDK_NAMESPACE_END
