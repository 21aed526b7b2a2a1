// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Converts a scene to a document to be written: the inverse of SceneReading.
#pragma once

#include <span>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "document/WrittenLines.h"
#include "io/SchemaClass.h"
#include "object/ObjectData.h"
#include "schema/VersionTraits.h"

FBXSDK_NAMESPACE_BEGIN

class FbxNodeAttribute;
class FbxObject;
class FbxScene;

namespace detail {

/// Fills the document with everything that the scene has and the version can hold. The document points into the
/// scene: nothing may change before it is written.
void writeScene(FbxScene& scene, const VersionTraits& traits, Document& document);

/// Whether the attribute is one of the application's views: a producer camera or the switcher between them, on nodes
/// that are unparented.
[[nodiscard]] bool isView(const FbxNodeAttribute& attribute);

/// Which properties of an object are written.
enum class PropertyChoice {
    changed, ///< those that differ from their class's defaults, or are connected
    all
};

/// The lines of a class's properties as long as they have their defaults, as its template holds them.
struct DefaultLines {
    std::vector<DocumentProperty> lines;
    int firstNumber = 0; ///< of these lines among those of all classes
};

/// Texts that many lines have, stored once in the document.
class CommonTexts {
public:
    explicit CommonTexts(RecordTree& tree) : mTree(tree) {}
    /// How files spell the flags of a property.
    [[nodiscard]] std::string_view flags(unsigned flags);
    /// The name of a curve node's channel in files.
    [[nodiscard]] std::string_view channel(std::string_view name);

private:
    RecordTree& mTree;
    std::unordered_map<unsigned, std::string_view> mFlags;
    std::unordered_map<std::string_view, std::string_view> mChannels;
};

struct ClassWriter;

/// What all objects of one class of a scene that is written have in common.
struct ClassOutput {
    const SchemaClass& schema;
    const ClassWriter* writer; ///< null for a class that is only properties
    const DefaultLines& defaults;
    PropertyChoice choice;
    CommonTexts& texts;
};

/// The classes of a scene that is written.
class ClassOutputs final : public DocumentCompanion {
public:
    ClassOutputs(RecordTree& tree, const VersionTraits& traits)
        : mTree(tree), mTexts(tree), mChoice(traits.defaultsLeftOut ? PropertyChoice::changed : PropertyChoice::all) {}

    [[nodiscard]] const ClassOutput& of(const FbxObject& object, const SchemaClass& schema);
    [[nodiscard]] const DefaultLines& defaultsOf(std::span<const PropertyRow> rows);
    [[nodiscard]] CommonTexts& texts() { return mTexts; }

private:
    RecordTree& mTree;
    CommonTexts mTexts;
    PropertyChoice mChoice;
    WrittenLines mLines; ///< of the class that is added
    int mNextNumber = 0;
    std::unordered_map<const PropertyRow*, DefaultLines> mDefaults;
    std::unordered_map<const ClassInfo*, ClassOutput> mClasses;
};

/// Everything about the object except its id. Its properties and large arrays are fetched when they are written.
[[nodiscard]] DocumentObject writableObject(FbxObject& object, const ClassOutput& common);

/// The start and end that files state for a span: where it is empty, as it is when not set, those of the keys.
struct WrittenSpan {
    std::int64_t start = 0, stop = 0;
};
[[nodiscard]] WrittenSpan writtenSpan(const FbxTimeSpan& span, const FbxAnimStack& stack);

/// Adds the lines in file order: those of the class, then the dynamic ones. Properties that are not to be saved are
/// omitted.
void addLines(const FbxObject& object, PropertyChoice choice, const DefaultLines& defaults, CommonTexts& texts,
              WrittenLines& lines);

/// The name by which connections refer to a property.
[[nodiscard]] std::string_view propertyName(const FbxObject& object, int index);

/// The type string of a property on the curve node that drives it, for a property of one number.
[[nodiscard]] std::string_view channelTypeName(const FbxDataType& type);

} // namespace detail
FBXSDK_NAMESPACE_END
