// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The record tree that both containers, binary and ASCII, are parsed into. Later stages are independent of the
// container. Records and values point into the bytes of the file (or into the tree's own arena of texts), so a tree is
// valid exactly as long as its RecordTree.
#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory>
#include <memory_resource>
#include <new>
#include <span>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

#include <fbxsdk/FbxArch.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

class FileBytes;

/// A numeric array as the file stores it; decoded by readNumbers on access.
struct StoredArray {
    /// int8 holds booleans and bytes and counts from 0 to 255.
    enum class Element : std::uint8_t { int8, int32, int64, float32, float64, text };
    Element element = Element::float64;
    bool compressed = false;  ///< one zlib stream of the raw elements
    bool bigEndian = false;   ///< byte order of the raw elements
    bool bitPatterns = false; ///< ASCII: whole numbers that are the bits of 32-bit floats
    std::uint8_t stride = 0;  ///< bytes from one element to the next; 0 when they are packed
    std::uint64_t count =
        0; ///< elements; already checked against the bytes (deflate cannot expand further than 1032:1)
    std::span<const char> bytes;     ///< the payload in the file; for `text` the source text of the list
    const FileBytes* file = nullptr; ///< where the payload must be read from; null when it is in memory
};

/// One value of a record. Whole numbers and reals convert into each other; text never converts into a number.
struct Value {
    enum class Type : std::uint8_t { none, integer, real, text, raw, word, array };
    Type type = Type::none;
    char code = 0; ///< letter of its type in a binary file, of its elements' type for a list; 0 in an ASCII file
    union {
        std::int64_t integer = 0;
        double real;
        const StoredArray* array;
    };
    std::string_view text; ///< of text (entities decoded, UTF-8 as stored), raw (bytes) and word (bare word or letter)

    static Value ofInteger(std::int64_t number) {
        Value value;
        value.type = Type::integer;
        value.integer = number;
        return value;
    }
    static Value ofReal(double number) {
        Value value;
        value.type = Type::real;
        value.real = number;
        return value;
    }
    static Value ofText(std::string_view text) {
        Value value;
        value.type = Type::text;
        value.text = text;
        return value;
    }
    static Value ofWord(std::string_view word) {
        Value value;
        value.type = Type::word;
        value.text = word;
        return value;
    }
    static Value ofArray(const StoredArray& array) {
        Value value;
        value.type = Type::array;
        value.array = &array;
        return value;
    }

    [[nodiscard]] bool isNumber() const { return type == Type::integer || type == Type::real; }
    /// Reals are truncated toward zero and saturate; NaN gives 0; a one-byte word gives its character code.
    [[nodiscard]] std::int64_t toInteger(std::int64_t fallback = 0) const;
    [[nodiscard]] double toReal(double fallback = 0.0) const;
    /// Text, raw or word; empty for anything else.
    [[nodiscard]] std::string_view toText() const {
        return type == Type::text || type == Type::raw || type == Type::word ? text : std::string_view();
    }
    /// The letter of a one-letter code ('T', 'C'), whether the file stores it as a char, a word or a string; 0 if none.
    [[nodiscard]] char toLetter() const;
};

/// One record: a name, values, and, when it has a block, records below it.
///
/// A long list of plain numbers, whether an array of a 7.x file or the scalar list of an older one, is a single value
/// of type array.
struct Record {
    static constexpr Value kNoValue{};

    std::string_view name;
    std::span<const Value> values;
    const Record* firstChild = nullptr;
    const Record* nextSibling = nullptr;
    std::uint64_t location = 0; ///< byte offset in the file
    bool hasBlock = false;

    class Iterator {
    public:
        explicit Iterator(const Record* record) : mRecord(record) {}
        const Record& operator*() const { return *mRecord; }
        const Record* operator->() const { return mRecord; }
        Iterator& operator++() {
            mRecord = mRecord->nextSibling;
            return *this;
        }
        bool operator==(const Iterator&) const = default;

    private:
        const Record* mRecord;
    };
    struct Children {
        const Record* first;
        [[nodiscard]] Iterator begin() const { return Iterator(first); }
        [[nodiscard]] Iterator end() const { return Iterator(nullptr); }
    };

    [[nodiscard]] Children children() const { return {firstChild}; }
    /// The first record of that name below this one; null when there is none.
    [[nodiscard]] const Record* child(std::string_view childName) const;
    /// The value at an index, or a value of type none.
    [[nodiscard]] const Value& value(std::size_t index) const {
        return index < values.size() ? values[index] : kNoValue;
    }
    /// The first value of the child of that name, or a value of type none.
    [[nodiscard]] const Value& childValue(std::string_view childName) const;

    /// The record's array; null when it has none.
    [[nodiscard]] const StoredArray* array() const;
    /// The number of the record's numbers: the elements of its array, or its numeric scalars.
    [[nodiscard]] std::size_t numberCount() const;
    /// Decodes the first destination.size() numbers directly into the destination, converting where the stored type
    /// differs (reals to whole numbers by truncation with saturation). False when a compressed array is corrupt or the
    /// record has fewer numbers; the destination is then zero-filled. Throws FileFault when the file was changed
    /// meanwhile and std::bad_alloc.
    [[nodiscard]] bool readNumbers(std::span<double> destination) const;
    [[nodiscard]] bool readNumbers(std::span<float> destination) const;
    [[nodiscard]] bool readNumbers(std::span<std::int32_t> destination) const;
    [[nodiscard]] bool readNumbers(std::span<std::int64_t> destination) const;
    /// The bits of 32-bit floats, exact for every container: binary floats, ASCII whole numbers, ASCII reals rounded to
    /// the nearest float.
    [[nodiscard]] bool readFloatBits(std::span<std::uint32_t> destination) const;
};

/// The bytes of a file and the records parsed from it.
class RecordTree {
public:
    RecordTree() = default;
    RecordTree(const RecordTree&) = delete;
    RecordTree& operator=(const RecordTree&) = delete;

    /// The container's own version number: the header of a binary file, the first comment of an ASCII one; 0 when an
    /// ASCII file states none.
    std::uint32_t version = 0;
    bool ascii = false;
    bool bigEndian = false;
    std::span<const char> source{}; ///< all of an ASCII file; empty for a binary one
    std::string fileName;           ///< as given to readRecords, for messages
    std::uint64_t fileSize = 0;
    Record root; ///< without name and values; its children are the top-level records

    /// "line" or "offset" and the number, for messages about a record.
    [[nodiscard]] std::string placeOf(const Record& record) const;

    // For building records, by readers and by the translation of old generations. Memory is released with the tree.
    Record& newRecord(std::string_view name) {
        auto* const record = new (allocate<Record>(1)) Record;
        record->name = name;
        return *record;
    }
    std::span<Value> newValues(std::size_t count) {
        auto* const values = static_cast<Value*>(allocate<Value>(count));
        std::uninitialized_default_construct_n(values, count);
        return {values, count};
    }
    StoredArray& newArray() { return *new (allocate<StoredArray>(1)) StoredArray; }
    std::string_view keepText(std::string text);

    std::shared_ptr<const void> mapping;   ///< keeps the bytes valid
    std::shared_ptr<const FileBytes> file; ///< the bytes, when they are those of a file

private:
    // Released without destructors.
    template <class T>
    [[nodiscard]] void* allocate(std::size_t count) {
        static_assert(std::is_trivially_destructible_v<T> && alignof(T) == kAlignment);
        if (count * sizeof(T) > mFree.size())
            addBlock(count * sizeof(T));
        void* const place = mFree.data();
        mFree = mFree.subspan(count * sizeof(T));
        return place;
    }
    void addBlock(std::size_t leastSize);

    static constexpr std::size_t kAlignment = alignof(std::uint64_t);

    std::pmr::monotonic_buffer_resource mMemory;
    std::span<std::byte> mFree;                     ///< of the last block
    std::size_t mBlockSize = std::size_t{16} << 10; ///< of the next one, at least
    std::deque<std::string> mTexts;
};

/// Reads a file into a tree: detects the container by content and parses it into records. Large arrays are read later.
///
/// Null on failure; the status then says which file, where in it and what is wrong. Arrays are not decoded here.
[[nodiscard]] std::unique_ptr<RecordTree> readRecords(const std::string& fileName, FbxStatus& status);
/// The same for bytes in memory, which must outlive the tree. `fileName` is for messages only.
[[nodiscard]] std::unique_ptr<RecordTree> readRecords(std::span<const char> bytes, const std::string& fileName,
                                                      FbxStatus& status);

enum class Container { binary, ascii, unknown };
/// Which container a file is; unknown also when it cannot be opened, for which the status has the reason.
[[nodiscard]] Container containerOf(const std::string& fileName, FbxStatus& status);

} // namespace detail
FBXSDK_NAMESPACE_END
