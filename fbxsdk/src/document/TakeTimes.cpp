// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "document/TakeTimes.h"

#include <unordered_map>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

bool readRange(DocumentBuilder& builder, const Record* record, std::int64_t& start, std::int64_t& stop) {
    std::int64_t range[2] = {0, 0};
    if (!record || record->numberCount() < 2 || !record->readNumbers(range))
        return false;
    start = builder.ticks(range[0]);
    stop = builder.ticks(range[1]);
    return true;
}

bool hasProperty(const DocumentObject& object, std::string_view first, std::string_view second) {
    return object.property(first) || object.property(second);
}

std::int64_t timeOf(const DocumentObject& stack, std::string_view name) {
    const DocumentProperty* line = stack.property(name);
    return line && !line->values.empty() ? line->values.front().toInteger() : 0;
}

} // namespace

void readTakeTimes(DocumentBuilder& builder, const Record& takes) {
    Document& document = builder.document();
    if (document.activeStackName.empty())
        document.activeStackName = takes.childValue("Current").toText();
    for (const Record& record : takes.children()) {
        if (record.name != "Take")
            continue;
        DocumentTake& take = document.takes.emplace_back();
        take.name = record.value(0).toText();
        take.hasLocal = readRange(builder, record.child("LocalTime"), take.localStart, take.localStop);
        take.hasReference = readRange(builder, record.child("ReferenceTime"), take.referenceStart, take.referenceStop);
    }
}

void addTakeTimes(DocumentBuilder& builder, const DocumentTake& take, std::vector<DocumentProperty>& properties) {
    const auto add = [&](std::string_view name, std::int64_t time) {
        properties.push_back(propertyOf(name, "KTime", "Time", "", builder.keep({Value::ofInteger(time)})));
    };
    if (take.hasLocal) {
        add("LocalStart", take.localStart);
        add("LocalStop", take.localStop);
    }
    if (take.hasReference) {
        add("ReferenceStart", take.referenceStart);
        add("ReferenceStop", take.referenceStop);
    }
}

void fillStackTimes(DocumentBuilder& builder) {
    Document& document = builder.document();
    std::unordered_map<std::string_view, const DocumentTake*> takes;
    for (const DocumentTake& take : document.takes)
        takes.emplace(take.name, &take);
    for (DocumentObject& object : document.objects) {
        const auto take = object.record == "AnimationStack" ? takes.find(object.name) : takes.end();
        if (take == takes.end())
            continue;
        DocumentTake missing = *take->second;
        missing.hasLocal = missing.hasLocal && !hasProperty(object, "LocalStart", "LocalStop");
        missing.hasReference = missing.hasReference && !hasProperty(object, "ReferenceStart", "ReferenceStop");
        addTakeTimes(builder, missing, object.properties);
    }
}

std::vector<DocumentTake> listTakes(const Document& document) {
    std::vector<DocumentTake> takes;
    for (const DocumentObject& object : document.objects) {
        if (object.record != "AnimationStack")
            continue;
        DocumentTake& take = takes.emplace_back();
        take.name = object.name;
        take.localStart = timeOf(object, "LocalStart");
        take.localStop = timeOf(object, "LocalStop");
        take.referenceStart = timeOf(object, "ReferenceStart");
        take.referenceStop = timeOf(object, "ReferenceStop");
        take.hasLocal = hasProperty(object, "LocalStart", "LocalStop");
        take.hasReference = hasProperty(object, "ReferenceStart", "ReferenceStop");
        if (const DocumentProperty* text = object.property("Description"); text && !text->values.empty())
            take.description = text->values.front().toText();
    }
    return takes.empty() ? document.takes : takes;
}

} // namespace detail
FBXSDK_NAMESPACE_END
