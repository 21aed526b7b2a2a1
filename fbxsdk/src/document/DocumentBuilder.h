// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <initializer_list>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "container/Record.h"
#include "document/Document.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A document under construction: the common part of the readers of all generations. Views passed in must be valid as
/// long as the record tree; the functions that make values and records store them there.
class DocumentBuilder {
public:
    DocumentBuilder(std::unique_ptr<RecordTree> tree, std::uint32_t version);

    [[nodiscard]] Document& document() { return *mDocument; }
    [[nodiscard]] RecordTree& tree() { return *mDocument->tree; }
    [[nodiscard]] const Record& root() const { return mDocument->tree->root; }
    [[nodiscard]] std::unique_ptr<Document> release() { return std::move(mDocument); }

    /// An id that no object of the index has. In files without ids of their own they are 1, 2, 3, …
    [[nodiscard]] std::int64_t newId();
    /// Appends an object. The reference is valid until the next one is added.
    DocumentObject& addObject(std::int64_t id, std::string_view record, std::string_view subClass,
                              std::string_view name, const Record* body = nullptr);
    /// Sorts the ids. Of objects with the same id the first stays.
    void indexObjects();

    void connect(std::int64_t source, std::int64_t destination, std::string_view destinationProperty = {},
                 std::string_view sourceProperty = {});

    /// Records a repair. Beyond a limited number of sentences the rest is only counted.
    void warn(std::string sentence);
    /// The same with the record's place in front.
    void warn(const Record& record, const std::string& sentence);

    // Values and records equivalent to what an older file states in another form.
    [[nodiscard]] std::span<const Value> keep(std::initializer_list<Value> values);
    [[nodiscard]] std::span<const Value> keepReals(std::span<const double> numbers);
    /// The first `count` numbers of a record as single values, whether it stores scalars or an array.
    [[nodiscard]] std::span<const Value> numbersOf(const Record& record, std::size_t count);
    /// A new record with values, to be put below another one with addChild.
    Record& newRecord(std::string_view name, std::span<const Value> values = {});
    /// A copy under another name; values and children are shared with the original.
    Record& aliasOf(const Record& original, std::string_view name);

    /// A time of this file in ticks of kTicksPerSecond.
    [[nodiscard]] std::int64_t ticks(std::int64_t fileTicks) const;
    /// Rescales the values of a KTime property; any other property stays as it is.
    void rescale(DocumentProperty& property);

private:
    std::unique_ptr<Document> mDocument;
    std::int64_t mLastNewId = 0;
    std::size_t mSilentWarnings = 0;
};

/// Appends records below one in order, without traversing the list each time.
class ChildAppender {
public:
    explicit ChildAppender(Record& parent) : mParent(parent) { parent.hasBlock = true; }
    void add(Record& child);

private:
    Record& mParent;
    Record* mLast = nullptr;
};

/// One `P` or `Property` line: a name, its types and flags, followed by values.
[[nodiscard]] DocumentProperty propertyOf(std::string_view name, std::string_view typeName,
                                          std::string_view subTypeName, std::string_view flags,
                                          std::span<const Value> values);

/// A name from the file as part of a sentence: in quotes, and truncated when it is very long.
[[nodiscard]] std::string quotedName(std::string_view name);

/// The name without its class: `name 00 01 class` of a binary file, `class::name` of an ASCII one.
[[nodiscard]] std::string_view nameWithoutClass(std::string_view fullName, bool ascii);

/// Drops what cannot be connected and makes the Models a tree; DocumentConnection states the result.
void cleanConnections(DocumentBuilder& builder);

/// The ends of a connection record, however the generation refers to objects.
struct ConnectionEnds {
    const Value* source = nullptr; ///< null when the record is no connection
    const Value* destination = nullptr;
    std::string_view sourceProperty, destinationProperty;
};
[[nodiscard]] ConnectionEnds connectionEnds(const Record& record);

// The readers, by generation. Each reads objects and connections; the rest is common.
void readGeneration7(DocumentBuilder& builder);
void readGeneration6(DocumentBuilder& builder);
bool readGeneration5(DocumentBuilder& builder, FbxStatus& status);

/// False, with the line in the status, when a line of an ASCII file holds more numbers than a value of its type has.
/// Such files come from programs that spell numbers with the decimal comma of their country: of "35,5" only 35 would be
/// read, and every later number would be misplaced. Properties of users may hold bounds after the value.
[[nodiscard]] bool checkValueCounts(const RecordTree& tree, FbxStatus& status);

} // namespace detail
FBXSDK_NAMESPACE_END
