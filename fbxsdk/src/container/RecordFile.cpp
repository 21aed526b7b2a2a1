// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The public interface to records: handles to the tree, values by value.
#include <fbxsdk/extensions/RecordFile.h>

#include <utility>

#include "container/BinaryReader.h"
#include "container/FileBytes.h"
#include "container/LineCounter.h"
#include "container/Record.h"

FBXSDK_NAMESPACE_BEGIN
namespace extensions {
namespace {

RecordValue::EElement elementOf(const detail::StoredArray& array) {
    switch (array.element) {
    case detail::StoredArray::Element::int8:
        return RecordValue::eInt8;
    case detail::StoredArray::Element::int32:
        return RecordValue::eInt32;
    case detail::StoredArray::Element::int64:
        return RecordValue::eInt64;
    case detail::StoredArray::Element::float32:
        return RecordValue::eFloat32;
    case detail::StoredArray::Element::float64:
        return RecordValue::eFloat64;
    case detail::StoredArray::Element::text:
        return RecordValue::eWritten;
    }
    return RecordValue::eWritten;
}

RecordValue listValue(const detail::StoredArray& array) {
    RecordValue value;
    value.type = RecordValue::eList;
    value.count = array.count;
    value.storedBytes = array.bytes.size();
    value.element = elementOf(array);
    value.compressed = array.compressed;
    return value;
}

RecordValue::EType typeOf(detail::Value::Type type) {
    switch (type) {
    case detail::Value::Type::text:
        return RecordValue::eText;
    case detail::Value::Type::raw:
        return RecordValue::eBytes;
    case detail::Value::Type::word:
        return RecordValue::eWord;
    case detail::Value::Type::real:
        return RecordValue::eReal;
    case detail::Value::Type::array:
        return RecordValue::eList;
    case detail::Value::Type::none:
    case detail::Value::Type::integer:
        return RecordValue::eInteger;
    }
    return RecordValue::eInteger;
}

} // namespace

std::string_view FileRecord::name() const { return mRecord->name; }
std::uint64_t FileRecord::location() const { return mRecord->location; }
bool FileRecord::hasBlock() const { return mRecord->hasBlock; }
FileRecord FileRecord::firstChild() const { return FileRecord(mRecord->firstChild); }
FileRecord FileRecord::nextSibling() const { return FileRecord(mRecord->nextSibling); }
std::size_t FileRecord::valueCount() const { return mRecord->values.size(); }

RecordValue FileRecord::value(std::size_t index) const {
    const detail::Value& stored = mRecord->value(index);
    RecordValue value;
    if (stored.type == detail::Value::Type::array) {
        value = listValue(*stored.array);
    } else {
        value.type = typeOf(stored.type);
        value.integer = stored.isNumber() ? stored.toInteger() : 0;
        value.real = stored.isNumber() ? stored.toReal() : 0.0;
        value.text = stored.toText();
    }
    value.code = stored.code;
    return value;
}

bool FileRecord::readNumbers(double* destination, std::size_t count) const {
    return mRecord->readNumbers(std::span(destination, count));
}

bool FileRecord::readNumbers(std::int64_t* destination, std::size_t count) const {
    return mRecord->readNumbers(std::span(destination, count));
}

RecordFile::RecordFile(std::unique_ptr<detail::RecordTree> tree)
    : mTree(std::move(tree)), mLines(std::make_unique<detail::LineCounter>(mTree->source)) {}
RecordFile::~RecordFile() = default;

std::unique_ptr<RecordFile> RecordFile::open(const char* fileName, FbxStatus& status) {
    auto tree = detail::readRecords(fileName ? fileName : "", status);
    return tree ? std::unique_ptr<RecordFile>(new RecordFile(std::move(tree))) : nullptr;
}

std::uint32_t RecordFile::version() const { return mTree->version; }
bool RecordFile::isAscii() const { return mTree->ascii; }
bool RecordFile::isBigEndian() const { return mTree->bigEndian; }
std::uint64_t RecordFile::size() const { return mTree->fileSize; }
FileRecord RecordFile::first() const { return FileRecord(mTree->root.firstChild); }

std::uint64_t RecordFile::lineOf(const FileRecord& record) { return isAscii() ? mLines->lineAt(record.location()) : 0; }

std::uint64_t RecordFile::endOf(const FileRecord& record) const {
    return mTree->ascii || !mTree->file ? 0 : detail::binaryRecordEnd(mTree->file->bytes(), *mTree, record.record());
}

} // namespace extensions
FBXSDK_NAMESPACE_END
