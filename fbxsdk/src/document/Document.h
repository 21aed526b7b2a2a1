// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// One form for files of every generation: objects with properties, and connections. Files of the 5.x and 6.x
// generations are translated here, once, to the form of a 7.x file; later stages are independent of the version.
#pragma once

#include <cstdint>
#include <functional>
#include <initializer_list>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "container/FileId.h"
#include "container/Record.h"
#include "document/CurveKeys.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

class RecordSink;
class WrittenLines;
struct VersionTraits;

/// Ticks of one second in all later stages, whatever unit the file counts in.
inline constexpr std::int64_t kTicksPerSecond = 46186158000;

/// One `P:` line (or its counterpart in an older file).
struct DocumentProperty {
    std::string_view name;
    std::string_view typeName;     ///< "Lcl Translation", "double", "KString", …
    std::string_view subTypeName;  ///< "Number", "Vector", …
    std::string_view flags;        ///< "A+U", …
    std::span<const Value> values; ///< times (type "KTime") are already in ticks of kTicksPerSecond
};

/// Adds an object's lines in file order. Called while the document is written, so that those of one object exist.
using AddLines = std::function<void(WrittenLines& lines)>;
/// Writes some of an object's records. Called while the document is written, so that one large array exists at a time.
using WriteRecords = std::function<void(RecordSink& sink, const VersionTraits& traits)>;
using UseKeys = std::function<void(const CurveKeys& keys)>;

/// An object to be written has this instead of the sub-records of one that was read.
struct ObjectContent {
    std::string_view nameClass; ///< the part before "::" in its name
    /// The class whose template holds the defaults; empty for a class without one.
    std::string_view templateClass;
    /// From 7.x on those that differ from the defaults, before that all of them; behind DocumentObject::properties.
    AddLines properties;
    WriteRecords before; ///< the records before the properties …
    WriteRecords after;  ///< … and after them; either may be empty
    /// Of a curve: returns its keys, with tangents that the version supports.
    std::function<void(const VersionTraits& traits, const UseKeys& use)> curve;
};

/// One object. Names and spellings are those of the 7.x generation.
struct DocumentObject {
    std::int64_t id = 0;       ///< to be written: small, from a counter
    std::string_view record;   ///< "Model", "NodeAttribute", "Geometry", "Deformer", "Material", "AnimationCurve", …
    std::string_view subClass; ///< "Mesh", "Camera", "LimbNode", "Skin", "Cluster", … may be empty
    std::string_view name;     ///< without the class prefix; may be empty; bytes as in the file
    /// To be written: those that are known in advance, usually none.
    std::vector<DocumentProperty> properties;
    /// The object's sub-records in 7.x spelling (Vertices, LayerElementNormal, Shading, Indexes, …). Never null in a
    /// document that was read.
    const Record* body = nullptr;
    std::unique_ptr<ObjectContent> content{}; ///< never null in a document that is to be written
    /// Index into Document::legacyCurves for a curve translated from a take; -1 for one that `body` describes.
    int legacyCurve = -1;

    [[nodiscard]] const DocumentProperty* property(std::string_view propertyName) const; ///< the last of that name
};

/// OO, OP, PO or PP: an end is a property when its name is not empty. Destination 0 is the scene's root.
struct DocumentConnection {
    std::int64_t source = 0;
    std::int64_t destination = 0;
    std::string_view sourceProperty;
    std::string_view destinationProperty;
};

/// The class defaults that the file itself states, to be applied to objects of exactly that class.
struct DocumentTemplate {
    std::string_view record;    ///< "Model", "NodeAttribute", …
    std::string_view className; ///< "FbxNode", "FbxCamera", …
    std::vector<DocumentProperty> properties;
};

struct DocumentTake {
    std::string_view name;
    std::string_view description{};
    std::int64_t localStart = 0, localStop = 0, referenceStart = 0, referenceStop = 0; ///< ticks
    bool hasLocal = false, hasReference = false;
};

/// Fog and ambient light, which only files before 7.x can hold.
struct DocumentLightSettings {
    bool hasAmbient = false, hasFog = false;
    double ambientColor[4] = {0, 0, 0, 1};
    bool fogEnable = false;
    int fogMode = 0;
    double fogDensity = 0.002, fogStart = 0.3, fogEnd = 1000;
    double fogColor[4] = {1, 1, 1, 1};
};

/// Data that a later stage keeps with a document.
struct DocumentCompanion {
    DocumentCompanion() = default;
    DocumentCompanion(const DocumentCompanion&) = delete;
    DocumentCompanion& operator=(const DocumentCompanion&) = delete;
    virtual ~DocumentCompanion() = default;
};

/// A document that was read, or is to be written. Views point into `tree`, or into the scene that is written.
struct Document {
    std::unique_ptr<RecordTree> tree;                  ///< owns values and texts
    std::uint32_t version = 0;                         ///< of the document: 3000, 5000, 5800, 6100, 7100 … 7700
    std::int64_t fileTicksPerSecond = kTicksPerSecond; ///< unit of the times that readCurve still finds in the tree
    std::string creator;
    CreationTime created;    ///< to be written: as the file states it …
    CreationTime createdGmt; ///< … and the same moment at Greenwich
    std::int64_t id = 0;     ///< to be written: that of the document itself
    std::vector<DocumentProperty> globalSettings;
    DocumentLightSettings lightSettings;
    std::string activeStackName;
    std::vector<DocumentTemplate> templates;
    std::vector<DocumentObject> objects;         ///< in file order; ids are unique and not 0
    std::vector<DocumentConnection> connections; ///< in file order; both ends exist (or the root), none is duplicated
    std::vector<DocumentTake> takes;
    std::vector<CurveKeys> legacyCurves;
    /// What was repaired or dropped, one sentence each, with its place; bounded in number.
    std::vector<std::string> warnings;

    [[nodiscard]] const DocumentObject* find(std::int64_t objectId) const;
    /// Stores values for a property.
    [[nodiscard]] std::span<const Value> keep(std::initializer_list<Value> values);
    /// Stores the lines of an object that is to be written; from now on its list has all of them.
    void settleProperties(DocumentObject& object) const;

    std::vector<std::pair<std::int64_t, std::uint32_t>> idIndex; ///< sorted; filled by readDocument
    mutable std::unique_ptr<DocumentCompanion> companion;        ///< the last member, since it refers to others
};

/// Reads a file of any generation. Null on failure; the status then names the file, the place and the fault.
[[nodiscard]] std::unique_ptr<Document> readDocument(const std::string& fileName, FbxStatus& status);
/// The same from an existing record tree.
[[nodiscard]] std::unique_ptr<Document> readDocument(std::unique_ptr<RecordTree> tree, FbxStatus& status);

/// Writes all records of the document, of the generation of the traits. Stops early when the sink fails; the sink
/// reports that.
void writeDocument(Document& document, const VersionTraits& traits, RecordSink& sink);

/// The keys of an object of record "AnimationCurve", whichever generation it came from. Times and values of different
/// length are cut to the shorter; unsorted keys are sorted; of equal times the later is kept.
[[nodiscard]] CurveKeys readCurve(const Document& document, const DocumentObject& object);

} // namespace detail
FBXSDK_NAMESPACE_END
