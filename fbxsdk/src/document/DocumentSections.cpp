// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Head, counts and takes.
#include "document/DocumentSections.h"

#include <algorithm>
#include <optional>
#include <unordered_map>

#include "document/RecordWriting.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

void writeTimeStamp(const CreationTime& time, RecordSink& sink) {
    const BlockScope block(sink, "CreationTimeStamp");
    const std::pair<std::string_view, int> parts[] = {
        {"Version", 1000},   {"Year", time.year},     {"Month", time.month},   {"Day", time.day},
        {"Hour", time.hour}, {"Minute", time.minute}, {"Second", time.second}, {"Millisecond", time.millisecond}};
    for (const auto& [name, number] : parts)
        writeInteger(sink, name, number);
}

/// Old applications restore their view from this.
void writeCameraResolution(const Document& document, RecordSink& sink) {
    const DocumentProperty* camera = findProperty(document.globalSettings, "DefaultCamera");
    const BlockScope block(sink, "CurrentCameraResolution");
    writeText(sink, "CameraName", camera && !camera->values.empty() ? camera->values[0].toText() : std::string_view());
    writeText(sink, "CameraResolutionMode", "Window Size");
    writeReal(sink, "CameraResolutionW", 320);
    writeReal(sink, "CameraResolutionH", 200);
}

void writeMetaData(RecordSink& sink) {
    const BlockScope block(sink, "MetaData");
    writeInteger(sink, "Version", 100);
    for (const std::string_view name : {"Title", "Subject", "Author", "Keywords", "Revision", "Comment"})
        writeText(sink, name, "");
}

/// Who created the scene and who saved it last, which here is the same.
std::vector<DocumentProperty> originOf(std::string_view gmt, std::vector<std::array<Value, 1>>& values) {
    struct Row {
        std::string_view name, typeName, subTypeName;
        std::optional<std::string_view> text; ///< none for objects without data
    };
    constexpr std::string_view kUnstated; // the same scene gives the same bytes, whatever the program and the machine
    const Row rows[] = {{"DocumentUrl", "KString", "Url", kUnstated},
                        {"SrcDocumentUrl", "KString", "Url", kUnstated},
                        {"Original", "Compound", "", std::nullopt},
                        {"Original|ApplicationVendor", "KString", "", kUnstated},
                        {"Original|ApplicationName", "KString", "", kUnstated},
                        {"Original|ApplicationVersion", "KString", "", kUnstated},
                        {"Original|DateTime_GMT", "DateTime", "", gmt},
                        {"Original|FileName", "KString", "", kUnstated},
                        {"LastSaved", "Compound", "", std::nullopt},
                        {"LastSaved|ApplicationVendor", "KString", "", kUnstated},
                        {"LastSaved|ApplicationName", "KString", "", kUnstated},
                        {"LastSaved|ApplicationVersion", "KString", "", kUnstated},
                        {"LastSaved|DateTime_GMT", "DateTime", "", gmt}};
    values.reserve(std::size(rows));
    std::vector<DocumentProperty> properties;
    for (const Row& row : rows) {
        DocumentProperty property{row.name, row.typeName, row.subTypeName, "", {}};
        if (row.text)
            property.values = values.emplace_back(std::array{Value::ofText(*row.text)});
        properties.push_back(property);
    }
    return properties;
}

} // namespace

const DocumentProperty* findProperty(std::span<const DocumentProperty> properties, std::string_view name) {
    const auto found = std::find_if(properties.begin(), properties.end(),
                                    [&](const DocumentProperty& property) { return property.name == name; });
    return found == properties.end() ? nullptr : &*found;
}

void writeSceneInfo(const Document& document, const VersionTraits& traits, RecordSink& sink) {
    std::vector<std::array<Value, 1>> values;
    const std::string gmt = document.createdGmt.dayFirstText();
    const std::vector<DocumentProperty> origin = originOf(gmt, values);
    sink.beginRecord("SceneInfo");
    sink.objectName("SceneInfo", "GlobalInfo");
    sink.text("UserData");
    sink.beginBlock();
    writeText(sink, "Type", "UserData");
    writeInteger(sink, "Version", 100);
    writeMetaData(sink);
    if (traits.generation == 7) {
        writeProperties70(sink, origin);
    } else {
        const BlockScope block(sink, "Properties60");
        for (const DocumentProperty& property : origin)
            writeProperty60(sink, property, property.flags);
    }
    sink.endRecord();
}

void writeHeader(const Document& document, const VersionTraits& traits, RecordSink& sink) {
    {
        const BlockScope block(sink, "FBXHeaderExtension");
        writeInteger(sink, "FBXHeaderVersion", 1003);
        writeInteger(sink, "FBXVersion", static_cast<std::int32_t>(traits.version));
        if (sink.isBinary())
            writeInteger(sink, "EncryptionType", 0);
        if (traits.views)
            writeCameraResolution(document, sink);
        writeTimeStamp(document.created, sink);
        writeText(sink, "Creator", document.creator);
        if (traits.generation == 7)
            writeSceneInfo(document, traits, sink);
    }
    if (!sink.isBinary())
        return;
    const FileCode code = fileId(document.created);
    sink.beginRecord("FileId");
    sink.raw(std::span(reinterpret_cast<const char*>(code.data()), code.size()));
    sink.endRecord();
    writeText(sink, "CreationTime", document.created.text());
    writeText(sink, "Creator", document.creator);
}

std::vector<ObjectCount> countObjects(const Document& document) {
    std::vector<ObjectCount> counts;
    std::unordered_map<std::string_view, std::size_t> places;
    for (const DocumentObject& object : document.objects) {
        const auto [place, isNew] = places.emplace(object.record, counts.size());
        if (isNew)
            counts.push_back({object.record, 0, &object});
        ++counts[place->second].count;
    }
    return counts;
}

void writeTakeTimes(const DocumentTake& take, RecordSink& sink) {
    std::string fileName(take.name);
    std::replace(fileName.begin(), fileName.end(), ' ', '_');
    writeText(sink, "FileName", fileName + ".tak");
    writeLongs(sink, "LocalTime", {take.localStart, take.localStop});
    writeLongs(sink, "ReferenceTime", {take.referenceStart, take.referenceStop});
}

} // namespace detail
FBXSDK_NAMESPACE_END
