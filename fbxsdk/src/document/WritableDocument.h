// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// What is to be written, in the shape of the 7.x generation. The scene is turned into this once; the writers of all
// generations start from it, as their readers end at Document.
#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "container/FileId.h"
#include "container/RecordSink.h"
#include "document/Document.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Writes some of an object's records. Called while the document is written, so that large arrays exist one at a time.
using WriteRecords = std::function<void(RecordSink& sink, const VersionTraits& traits)>;

using UseKeys = std::function<void(const CurveKeys& keys)>;

struct WritableObject {
    std::int64_t id = 0;
    std::string_view record;    ///< "Model", "NodeAttribute", …
    std::string_view nameClass; ///< what stands before "::" in its name
    std::string_view subClass;
    std::string_view name;
    /// The class whose template would hold the defaults; empty for a class without one.
    std::string_view templateClass;
    /// From 7.x on those that differ from the defaults, before all of them.
    std::vector<DocumentProperty> properties;
    WriteRecords before; ///< the records before the properties …
    WriteRecords after;  ///< … and behind them; either may be empty
    /// Of a curve: shows its keys, with tangents that the version has.
    std::function<void(const VersionTraits& traits, const UseKeys& use)> curve;
};

/// Views point into the scene or into `texts`; both outlive the writing.
struct WritableDocument {
    std::string creator;
    std::string applicationVendor, applicationName, applicationVersion;
    CreationTime created;    ///< as the file states it
    CreationTime createdGmt; ///< the same moment at Greenwich
    std::int64_t id = 0;     ///< of the document itself
    std::vector<DocumentProperty> globalSettings;
    DocumentLightSettings lightSettings;
    std::string activeStackName;
    std::vector<DocumentTemplate> templates; ///< of all classes that objects have
    std::vector<WritableObject> objects;     ///< in the order of writing
    std::vector<DocumentConnection> connections;
    std::vector<DocumentTake> takes;

    RecordTree texts; ///< owns values and texts made for the document

    /// Keeps values for a property.
    [[nodiscard]] std::span<const Value> keep(std::initializer_list<Value> values) {
        const std::span<Value> kept = texts.newValues(values.size());
        std::copy(values.begin(), values.end(), kept.begin());
        return kept;
    }
};

/// Writes all records of the document, of the generation that the traits tell. Stops early when the sink fails; whether
/// it did, the sink says.
void writeDocument(WritableDocument& document, const VersionTraits& traits, RecordSink& sink);

} // namespace detail
FBXSDK_NAMESPACE_END
