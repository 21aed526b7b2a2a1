// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Documents from text in a test, and queries to them.
#pragma once

#include <algorithm>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "document/Document.h"

namespace fbxsdk::detail {

/// Null on failure; the status is then in `*status`.
inline std::unique_ptr<Document> tryDocument(std::string text, FbxStatus* status = nullptr) {
    FbxStatus own;
    FbxStatus& outcome = status ? *status : own;
    const auto kept = std::make_shared<const std::string>(std::move(text));
    std::unique_ptr<RecordTree> tree = readRecords(std::span(kept->data(), kept->size()), "test.fbx", outcome);
    if (!tree)
        return nullptr;
    tree->mapping = kept;
    return readDocument(std::move(tree), outcome);
}

/// A document that must load; the text is preceded by a version comment.
inline std::unique_ptr<Document> documentOf(const std::string& version, const std::string& text) {
    FbxStatus status;
    std::unique_ptr<Document> document = tryDocument("; FBX " + version + " project file\n" + text, &status);
    if (!document) {
        ADD_FAILURE() << status.GetErrorString();
        document = std::make_unique<Document>();
    }
    return document;
}

inline const DocumentObject* objectNamed(const Document& document, std::string_view record, std::string_view name,
                                         std::string_view subClass = {}) {
    for (const DocumentObject& object : document.objects)
        if (object.record == record && object.name == name && (subClass.empty() || object.subClass == subClass))
            return &object;
    return nullptr;
}

inline std::int64_t idOf(const Document& document, std::string_view record, std::string_view name,
                         std::string_view subClass = {}) {
    const DocumentObject* object = objectNamed(document, record, name, subClass);
    EXPECT_NE(object, nullptr) << record << " " << name;
    return object ? object->id : -12345;
}

inline bool isConnected(const Document& document, std::int64_t source, std::int64_t destination,
                        std::string_view destinationProperty = {}) {
    return std::any_of(
        document.connections.begin(), document.connections.end(),
        [&](const DocumentConnection& edge) {
            return edge.source == source && edge.destination == destination &&
                   edge.destinationProperty == destinationProperty;
        });
}

/// The names of the sources of that record kind, in order of connection.
inline std::vector<std::string> sourceNames(const Document& document, std::int64_t destination,
                                            std::string_view record) {
    std::vector<std::string> names;
    for (const DocumentConnection& edge : document.connections)
        if (const DocumentObject* source = document.find(edge.source);
            edge.destination == destination && source && source->record == record)
            names.emplace_back(source->name);
    return names;
}

inline std::vector<double> numbersOf(const DocumentProperty* property) {
    std::vector<double> numbers;
    if (property)
        for (const Value& value : property->values)
            numbers.push_back(value.toReal());
    return numbers;
}

inline std::vector<double> numbersOf(const DocumentObject* object, std::string_view property) {
    return object ? numbersOf(object->property(property)) : std::vector<double>();
}

inline std::vector<double> numbersOf(const Record* record) {
    std::vector<double> numbers(record ? record->numberCount() : 0);
    EXPECT_TRUE(!record || record->readNumbers(numbers));
    return numbers;
}

inline const DocumentProperty* settingNamed(const Document& document, std::string_view name) {
    for (const DocumentProperty& property : document.globalSettings)
        if (property.name == name)
            return &property;
    return nullptr;
}

/// True when some warning contains the words.
inline bool warnsOf(const Document& document, std::string_view words) {
    return std::any_of(
        document.warnings.begin(), document.warnings.end(),
        [&](const std::string& warning) { return warning.find(words) != std::string::npos; });
}

using Numbers = std::vector<double>;
using Names = std::vector<std::string>;

} // namespace fbxsdk::detail
