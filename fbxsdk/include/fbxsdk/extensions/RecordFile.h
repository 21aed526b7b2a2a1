// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// An extension of this platform, not part of the documented API, and not included by <fbxsdk.h>: a file as the records
// that it consists of, whatever they mean. For authors of readers and writers of the format, and for finding where a
// program stores something.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>

#include <fbxsdk/FbxArch.h>
#include <fbxsdk/FbxStatus.h>

FBXSDK_NAMESPACE_BEGIN

namespace detail {
struct Record;
class LineCounter;
class RecordTree;
} // namespace detail

namespace extensions {

/// One value of a record.
struct RecordValue {
    /// The kind of the value.
    enum EType {
        eInteger, ///< a whole number
        eReal,    ///< a number with a fraction
        eText,    ///< text
        eBytes,   ///< bytes of any meaning
        eWord,    ///< a bare word of an ASCII file, a single letter of a binary one
        eList     ///< an array, or the numbers that files before 7.0 list one by one
    };
    EType type = eInteger; ///< which of the following members is valid
    /// The letter of the type in a binary file: I, L, D, S …, of a list that of its elements (i, d … for an array, I, D
    /// … for single numbers); 0 in an ASCII file.
    char code = 0;
    std::int64_t integer = 0; ///< of whole numbers
    double real = 0.0;        ///< of numbers with a fraction
    std::string_view text;    ///< of texts, bytes and words, as the file has them

    std::uint64_t count = 0;       ///< of a list: its numbers
    std::uint64_t storedBytes = 0; ///< of a list: its size in the file
    /// How the numbers of a list are stored.
    enum EElement {
        eInt8,    ///< 8 bits
        eInt32,   ///< 32 bits
        eInt64,   ///< 64 bits
        eFloat32, ///< single precision
        eFloat64, ///< double precision
        eWritten  ///< as digits, in an ASCII file
    };
    EElement element = eFloat64; ///< of a list; eWritten: as digits, in an ASCII file
    bool compressed = false;     ///< of a list: its bytes are deflated
};

/// A handle to one record; valid as long as its file. An empty one means that there is none.
class FBXSDK_DLL FileRecord {
public:
    FileRecord() = default;
    explicit FileRecord(const detail::Record* record) : mRecord(record) {} ///< The platform's own.

    /// Whether there is a record; the other calls require one.
    explicit operator bool() const { return mRecord != nullptr; }
    [[nodiscard]] std::string_view name() const; ///< As the file has it; valid as long as the file.
    /// The offset of its first byte in the file.
    [[nodiscard]] std::uint64_t location() const;
    /// Whether a block follows its values, which may be empty.
    [[nodiscard]] bool hasBlock() const;
    [[nodiscard]] FileRecord firstChild() const;  ///< The first record of the block; empty when there is none.
    [[nodiscard]] FileRecord nextSibling() const; ///< The next record of the same block; empty after the last.

    [[nodiscard]] std::size_t valueCount() const; ///< How many values precede the block.
    /// An integer 0 for an index out of range.
    [[nodiscard]] RecordValue value(std::size_t index) const;
    /// The first numbers of the record's list. False, and zeros, when there are fewer or the array is damaged.
    [[nodiscard]] bool readNumbers(double* destination, std::size_t count) const;
    /// The same as whole numbers, those with a fraction truncated toward zero.
    [[nodiscard]] bool readNumbers(std::int64_t* destination, std::size_t count) const;

    /// The platform's own view of the record.
    [[nodiscard]] const detail::Record& record() const { return *mRecord; }

private:
    const detail::Record* mRecord = nullptr;
};

/// A file as a tree of records.
class FBXSDK_DLL RecordFile {
public:
    /// Null when the file cannot be read; the status then says which file, where in it, and what is wrong.
    [[nodiscard]] static std::unique_ptr<RecordFile> open(const char* fileName, FbxStatus& status);
    ~RecordFile();
    RecordFile(const RecordFile&) = delete;
    RecordFile& operator=(const RecordFile&) = delete;

    /// As the header of the file states; 0 when an ASCII file has none.
    [[nodiscard]] std::uint32_t version() const;
    [[nodiscard]] bool isAscii() const;       ///< Text, else binary.
    [[nodiscard]] bool isBigEndian() const;   ///< Whether a binary file is big-endian, as some old ones are.
    [[nodiscard]] std::uint64_t size() const; ///< Size of the file in bytes.
    /// The first record of the top level.
    [[nodiscard]] FileRecord first() const;
    /// The number of the line in an ASCII file that the record starts on, from 1; 0 in a binary one. Quick for records
    /// in the order of the file.
    [[nodiscard]] std::uint64_t lineOf(const FileRecord& record);
    /// The offset behind the record and its block in a binary file; 0 in an ASCII one.
    [[nodiscard]] std::uint64_t endOf(const FileRecord& record) const;

private:
    explicit RecordFile(std::unique_ptr<detail::RecordTree> tree);
    std::unique_ptr<detail::RecordTree> mTree;
    std::unique_ptr<detail::LineCounter> mLines;
};

} // namespace extensions
FBXSDK_NAMESPACE_END
