// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Files from 7.1 on: objects with ids, connections between ids, and defaults in templates.
#include <algorithm>
#include <numeric>

#include "document/DocumentSections.h"
#include "document/RecordWriting.h"
#include "document/WrittenLines.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

void writeGlobalSettings(const Document& document, RecordSink& sink) {
    const BlockScope block(sink, "GlobalSettings");
    writeInteger(sink, "Version", 1000);
    writeProperties70(sink, document.globalSettings);
}

void writeDocuments(const Document& document, RecordSink& sink) {
    const Value activeStack[] = {Value::ofText(document.activeStackName)};
    const DocumentProperty properties[] = {{"SourceObject", "object", "", "", {}},
                                           {"ActiveAnimStackName", "KString", "", "", activeStack}};
    sink.heading("Documents Description");
    const BlockScope block(sink, "Documents");
    writeInteger(sink, "Count", 1);
    sink.beginRecord("Document");
    sink.longInteger(document.id);
    sink.text("");
    sink.text("Scene");
    sink.beginBlock();
    writeProperties70(sink, properties);
    writeLong(sink, "RootNode", 0);
    sink.endRecord();
}

void writeReferences(RecordSink& sink) {
    sink.heading("Document References");
    const BlockScope block(sink, "References");
}

const DocumentTemplate* templateOf(const Document& document, const DocumentObject& object) {
    const auto found = std::find_if(document.templates.begin(), document.templates.end(), [&](const auto& each) {
        return each.record == object.record && each.className == object.content->templateClass;
    });
    return found == document.templates.end() ? nullptr : &*found;
}

/// A kind has at most one template: that of its first object's class.
void writeObjectType(const Document& document, const ObjectCount& kind, RecordSink& sink) {
    const BlockScope block(sink, "ObjectType", kind.record);
    writeInteger(sink, "Count", kind.count);
    const DocumentTemplate* defaults = kind.first ? templateOf(document, *kind.first) : nullptr;
    if (!defaults || defaults->properties.empty())
        return;
    const BlockScope templateBlock(sink, "PropertyTemplate", defaults->className);
    writeProperties70(sink, defaults->properties);
}

bool isTake(const ObjectCount& kind) { return kind.record == "AnimationStack" || kind.record == "AnimationLayer"; }

void writeDefinitions(const Document& document, RecordSink& sink) {
    std::vector<ObjectCount> kinds = countObjects(document);
    std::stable_partition(kinds.begin(), kinds.end(), isTake);
    sink.heading("Object definitions");
    const BlockScope block(sink, "Definitions");
    writeInteger(sink, "Version", 100);
    const auto total = std::accumulate(kinds.begin(), kinds.end(), std::int32_t{1},
                                       [](std::int32_t sum, const ObjectCount& kind) { return sum + kind.count; });
    writeInteger(sink, "Count", total);
    writeObjectType(document, {"GlobalSettings", 1, nullptr}, sink);
    for (const ObjectCount& kind : kinds)
        writeObjectType(document, kind, sink);
}

void writeObject(const DocumentObject& object, WrittenLines& lines, const VersionTraits& traits, RecordSink& sink) {
    sink.beginRecord(object.record);
    sink.longInteger(object.id);
    sink.objectName(object.content->nameClass, object.name);
    sink.text(object.subClass);
    sink.beginBlock();
    if (object.content->before)
        object.content->before(sink, traits);
    lines.fill(object);
    writeLines70(sink, lines.all());
    if (object.content->curve)
        object.content->curve(traits, [&](const CurveKeys& keys) { writeCurve(sink, traits, keys); });
    if (object.content->after)
        object.content->after(sink, traits);
    sink.endRecord();
}

void writeObjects(const Document& document, const VersionTraits& traits, RecordSink& sink) {
    sink.heading("Object properties");
    const BlockScope block(sink, "Objects");
    WrittenLines lines;
    for (const DocumentObject& object : document.objects) {
        if (sink.failed())
            return;
        writeObject(object, lines, traits, sink);
    }
}

void writeConnection(const DocumentConnection& connection, RecordSink& sink) {
    const bool fromProperty = !connection.sourceProperty.empty();
    const bool toProperty = !connection.destinationProperty.empty();
    sink.beginRecord("C");
    sink.text(fromProperty ? (toProperty ? "PP" : "PO") : (toProperty ? "OP" : "OO"));
    sink.longInteger(connection.source);
    if (fromProperty)
        sink.text(connection.sourceProperty);
    sink.longInteger(connection.destination);
    if (toProperty)
        sink.text(connection.destinationProperty);
    sink.endRecord();
}

void writeConnections(const Document& document, RecordSink& sink) {
    sink.heading("Object connections");
    const BlockScope block(sink, "Connections");
    for (const DocumentConnection& connection : document.connections)
        writeConnection(connection, sink);
}

void writeTakes(const Document& document, RecordSink& sink) {
    sink.heading("Takes section");
    const BlockScope block(sink, "Takes");
    writeText(sink, "Current", document.activeStackName);
    for (const DocumentTake& take : document.takes) {
        const BlockScope takeBlock(sink, "Take", take.name);
        writeTakeTimes(take, sink);
    }
}

} // namespace

void writeGeneration7(const Document& document, const VersionTraits& traits, RecordSink& sink) {
    writeHeader(document, traits, sink);
    writeGlobalSettings(document, sink);
    writeDocuments(document, sink);
    writeReferences(sink);
    writeDefinitions(document, sink);
    writeObjects(document, traits, sink);
    writeConnections(document, sink);
    writeTakes(document, sink);
}

} // namespace detail
FBXSDK_NAMESPACE_END
