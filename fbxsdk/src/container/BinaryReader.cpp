// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Binary files. A record is
//
//     EndOffset  ValueCount  ValueBytes  NameLength  name  values  [records  null record]
//     |-- 32 bits each, 64 from 7500 on --|  8 bits               |- if EndOffset lies further -|
//
// and offsets count from the start of the file. Nothing is trusted: each size is compared with the remaining bytes
// of the file, of the enclosing block, or of the record itself, before anything is allocated.
#include "container/BinaryReader.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

#include "container/ByteOrder.h"
#include "container/FileBytes.h"
#include "container/FileFormat.h"
#include "container/NumberDecoding.h"
#include "container/ReadLimits.h"
#include "container/ZlibStream.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

constexpr std::size_t kByteOrderOffset = kBinaryHead.size() - 1;
constexpr std::size_t kVersionOffset = kBinaryHead.size();
constexpr std::size_t kHeaderSize = 27;

/// Deflate's ratio holds for long streams; a short one may have a few bytes more for its head.
constexpr std::uint64_t kDeflateSlack = 1024;

/// All compressed arrays of a file together may expand to this many bytes per byte of the file, as doubles, plus
/// a constant. Real files stay below a tenth of the first; without a bound, a megabyte of crafted zeros could expand
/// to a gigabyte.
constexpr std::uint64_t kMaxExpansion = 512;
constexpr std::uint64_t kFreeExpansion = std::uint64_t{32} << 20;

/// One type code of an array or of a scalar that may come in long lists.
struct ElementCode {
    char code;
    StoredArray::Element element;
};
constexpr ElementCode kArrayCodes[] = {
    {'d', StoredArray::Element::float64}, {'i', StoredArray::Element::int32}, {'f', StoredArray::Element::float32},
    {'l', StoredArray::Element::int64},   {'b', StoredArray::Element::int8},  {'c', StoredArray::Element::int8},
};
constexpr ElementCode kListCodes[] = {
    {'D', StoredArray::Element::float64},
    {'I', StoredArray::Element::int32},
    {'F', StoredArray::Element::float32},
    {'L', StoredArray::Element::int64},
};

template <std::size_t size>
const ElementCode* findCode(const ElementCode (&table)[size], char code) {
    for (const ElementCode& row : table)
        if (row.code == code)
            return &row;
    return nullptr;
}

/// The fixed part of a record.
struct Head {
    std::uint64_t end = 0;
    std::uint64_t valueCount = 0;
    std::uint64_t valueBytes = 0;
    std::size_t nameLength = 0;

    [[nodiscard]] bool isNull() const { return end == 0 && nameLength == 0; }
};

/// A record whose block is being read.
struct OpenBlock {
    Record* record = nullptr;
    Record* lastChild = nullptr;
    std::size_t end = 0; ///< offset behind the block
};

template <class Number>
const char* readPlainNumber(Value& value, const char* bytes, std::size_t left, bool swap) {
    if (left < sizeof(Number))
        return nullptr;
    value.code = bytes[-1];
    if constexpr (std::is_integral_v<Number>) {
        value.type = Value::Type::integer;
        value.integer = loadNumber<Number>(bytes, swap);
    } else {
        value.type = Value::Type::real;
        value.real = loadNumber<Number>(bytes, swap);
    }
    return bytes + sizeof(Number);
}

/// Reads a value of a usual type. The end of its bytes; null, with nothing done, for other and faulty ones.
const char* readPlainValue(Value& value, const char* at, const char* end, bool swap) {
    if (at == end)
        return nullptr;
    const char* const bytes = at + 1;
    const auto left = static_cast<std::size_t>(end - bytes);
    switch (*at) {
    case 'I':
        return readPlainNumber<std::int32_t>(value, bytes, left, swap);
    case 'L':
        return readPlainNumber<std::int64_t>(value, bytes, left, swap);
    case 'D':
        return readPlainNumber<double>(value, bytes, left, swap);
    case 'S': {
        constexpr std::size_t kSizeBytes = 4;
        if (left < kSizeBytes)
            return nullptr;
        const std::size_t size = loadNumber<std::uint32_t>(bytes, swap);
        if (size > left - kSizeBytes)
            return nullptr;
        value.type = Value::Type::text;
        value.code = 'S';
        value.text = {bytes + kSizeBytes, size};
        return value.text.data() + size;
    }
    default:
        return nullptr;
    }
}

class BinaryReader {
public:
    BinaryReader(std::span<const char> bytes, RecordTree& tree, FbxStatus& status)
        : mBytes(bytes), mAhead(bytes, tree.file.get()), mTree(tree), mStatus(status) {}

    bool read() { return readHeader() && readRecords(); }

private:
    [[gnu::cold]] bool fail(std::size_t offset, const std::string& what,
                            FbxStatus::EStatusCode code = FbxStatus::eInvalidFile) {
        mStatus.SetCode(code, "%s: offset %zu: %s", mTree.fileName.c_str(), offset, what.c_str());
        return false;
    }

    template <class Number>
    [[nodiscard]] Number numberAt(std::size_t offset) {
        mAhead.need(offset, sizeof(Number));
        return loadNumber<Number>(mBytes.data() + offset, mSwap);
    }
    [[nodiscard]] std::string_view textAt(std::size_t offset, std::size_t size) {
        mAhead.need(offset, size);
        return {mBytes.data() + offset, size};
    }

    // Apart from what they are called by, which is short without their texts.
    [[gnu::cold]] bool failForSize(const Head& head, std::size_t start);
    [[gnu::cold]] bool failForEnd(const Head& head, std::size_t start, std::string_view name, std::size_t valuesEnd);
    [[gnu::cold]] bool failForCount(const Head& head, std::size_t end);

    bool readHeader();
    bool readRecords();
    bool readHead(Head& head);
    template <class Field>
    void loadFields(Head& head, const char* bytes) const;
    bool readRecord(const Head& head, std::size_t start);
    void closeBlock();
    Record& appendRecord(std::string_view name);

    bool readValues(Record& record, const Head& head, std::size_t end);
    [[gnu::noinline]] bool readScalarList(Record& record, std::size_t count, std::size_t end);
    std::size_t readPlainValues(std::span<Value> values, std::size_t end);
    [[gnu::noinline]] bool readOtherValues(std::span<Value> values, std::size_t end);
    bool readValue(Value& value, std::size_t end);
    bool readValueOf(char code, Value& value, std::size_t end);
    template <class Number>
    bool readScalar(Value& value, std::size_t end);
    bool readLetter(Value& value, std::size_t end);
    bool readText(Value& value, Value::Type type, std::size_t end);
    bool readArray(Value& value, StoredArray::Element element, std::size_t end);
    void keepPayload(StoredArray& array, std::size_t size);
    bool checkArray(const StoredArray& array, std::size_t offset);

    std::span<const char> mBytes;
    ReadAhead mAhead;
    RecordTree& mTree;
    FbxStatus& mStatus;
    bool mSwap = false;
    bool mWide = false; ///< 64-bit record heads
    std::size_t mOffset = 0;
    std::uint64_t mExpanded = 0; ///< expanded size of the compressed arrays so far, as doubles
    std::vector<OpenBlock> mOpen;
};

bool BinaryReader::readHeader() {
    if (mBytes.size() < kHeaderSize)
        return fail(mBytes.size(), "the file ends within its header");
    mTree.bigEndian = numberAt<std::uint8_t>(kByteOrderOffset) != 0;
    mSwap = needsSwap(mTree.bigEndian);
    mTree.version = numberAt<std::uint32_t>(kVersionOffset);
    mWide = mTree.version >= kFirstWideVersion;
    mOffset = kHeaderSize;
    if (!isSupportedVersion(mTree.version)) {
        return fail(kVersionOffset, "unsupported version " + std::to_string(mTree.version),
                    FbxStatus::eInvalidFileVersion);
    }
    return true;
}

// The top level ends with a null record as every block does. What follows it, a footer and in old files a second
// list of records, adds nothing to the first.
bool BinaryReader::readRecords() {
    mOpen.push_back({&mTree.root, nullptr, mBytes.size()});
    while (!mOpen.empty()) {
        if (mOffset == mOpen.back().end && mOpen.size() > 1) {
            closeBlock();
            continue;
        }
        const std::size_t start = mOffset;
        Head head;
        if (!readHead(head))
            return false;
        if (head.isNull())
            closeBlock();
        else if (!readRecord(head, start))
            return false;
    }
    return true;
}

void BinaryReader::closeBlock() {
    mOffset = mOpen.back().end;
    mOpen.pop_back();
}

bool BinaryReader::readHead(Head& head) {
    const std::size_t size = mWide ? 3 * sizeof(std::uint64_t) + 1 : 3 * sizeof(std::uint32_t) + 1;
    if (mOpen.back().end - mOffset < size)
        return fail(mOffset, "record header exceeds " + std::string(mOpen.size() > 1 ? "its block" : "the file"));
    mAhead.need(mOffset, size);
    const char* const bytes = mBytes.data() + mOffset;
    if (mWide)
        loadFields<std::uint64_t>(head, bytes);
    else
        loadFields<std::uint32_t>(head, bytes);
    mOffset += size;
    return true;
}

template <class Field>
void BinaryReader::loadFields(Head& head, const char* bytes) const {
    head.end = loadNumber<Field>(bytes, mSwap);
    head.valueCount = loadNumber<Field>(bytes + sizeof(Field), mSwap);
    head.valueBytes = loadNumber<Field>(bytes + 2 * sizeof(Field), mSwap);
    head.nameLength = static_cast<std::uint8_t>(bytes[3 * sizeof(Field)]);
}

Record& BinaryReader::appendRecord(std::string_view name) {
    OpenBlock& block = mOpen.back();
    Record& record = mTree.newRecord(name);
    (block.lastChild != nullptr ? block.lastChild->nextSibling : block.record->firstChild) = &record;
    block.lastChild = &record;
    return record;
}

bool BinaryReader::readRecord(const Head& head, std::size_t start) {
    const std::size_t blockEnd = mOpen.back().end;
    const std::size_t left = blockEnd - mOffset;
    if (head.nameLength > left || head.valueBytes > left - head.nameLength)
        return failForSize(head, start);
    Record& record = appendRecord(textAt(mOffset, head.nameLength));
    record.location = start;
    mOffset += head.nameLength;

    // Some writers omit the end of records without a block: such a record ends with its values.
    const std::size_t valuesEnd = mOffset + static_cast<std::size_t>(head.valueBytes);
    if (head.end != 0 && (head.end < valuesEnd || head.end > blockEnd))
        return failForEnd(head, start, record.name, valuesEnd);
    if (!readValues(record, head, valuesEnd))
        return false;
    mOffset = valuesEnd;
    record.hasBlock = head.end > valuesEnd;
    if (!record.hasBlock)
        return true;
    if (mOpen.size() > kMaxDepth)
        return fail(start, "records are nested deeper than " + std::to_string(kMaxDepth) + " levels");
    mOpen.push_back({&record, nullptr, static_cast<std::size_t>(head.end)});
    return true;
}

bool BinaryReader::failForSize(const Head& head, std::size_t start) {
    return fail(start, "values of " + std::to_string(head.valueBytes) + " bytes exceed " +
                           (mOpen.size() > 1 ? "the block that contains the record" : "the file"));
}

bool BinaryReader::failForEnd(const Head& head, std::size_t start, std::string_view name, std::size_t valuesEnd) {
    return fail(start, "end offset " + std::to_string(head.end) + " of record '" + std::string(name) +
                           "' is outside the range " + std::to_string(valuesEnd) + " to " +
                           std::to_string(mOpen.back().end));
}

bool BinaryReader::failForCount(const Head& head, std::size_t end) {
    return fail(mOffset, std::to_string(head.valueCount) + " values do not fit into " + std::to_string(end - mOffset) +
                             " bytes");
}

bool BinaryReader::readValues(Record& record, const Head& head, std::size_t end) {
    constexpr std::size_t kSmallestValue = 2;
    if (head.valueCount > (end - mOffset) / kSmallestValue)
        return failForCount(head, end);
    const auto count = static_cast<std::size_t>(head.valueCount);
    if (count >= kShortestList && readScalarList(record, count, end))
        return true;
    const std::span<Value> values = mTree.newValues(count);
    const bool isSmall = end - mOffset <= kMostReadAlong;
    const std::size_t plain = isSmall ? readPlainValues(values, end) : 0;
    record.values = values;
    return plain == count || readOtherValues(values.subspan(plain), end);
}

bool BinaryReader::readOtherValues(std::span<Value> values, std::size_t end) {
    return std::all_of(
        values.begin(), values.end(), [&](Value& value) { return readValue(value, end); });
}

/// Reads values of usual types up to the first that is of another one, or faulty. The number of those read.
std::size_t BinaryReader::readPlainValues(std::span<Value> values, std::size_t end) {
    mAhead.need(mOffset, end - mOffset);
    const char* at = mBytes.data() + mOffset;
    const char* const last = mBytes.data() + end;
    const bool swap = mSwap;
    std::size_t count = 0;
    for (; count < values.size(); ++count) {
        const char* const next = readPlainValue(values[count], at, last, swap);
        if (next == nullptr)
            break;
        at = next;
    }
    mOffset = static_cast<std::size_t>(at - mBytes.data());
    return count;
}

// Before 7.x there are no arrays: a mesh has a scalar per coordinate. If all have the same type, that is an array with
// a type code before each element.
bool BinaryReader::readScalarList(Record& record, std::size_t count, std::size_t end) {
    mAhead.need(mOffset, 1);
    const ElementCode* const code = findCode(kListCodes, mBytes[mOffset]);
    if (code == nullptr)
        return false;
    const std::size_t stride = 1 + elementSize(code->element);
    if (count > (end - mOffset) / stride)
        return false;
    mAhead.need(mOffset, count * stride);
    for (std::size_t i = 0; i < count; ++i)
        if (mBytes[mOffset + i * stride] != code->code)
            return false;
    StoredArray& array = mTree.newArray();
    array.element = code->element;
    array.bigEndian = mTree.bigEndian;
    array.count = count;
    array.stride = static_cast<std::uint8_t>(stride);
    array.bytes = mBytes.subspan(mOffset + 1, count * stride - 1);
    const std::span<Value> values = mTree.newValues(1);
    values[0] = Value::ofArray(array);
    values[0].code = code->code;
    record.values = values;
    return true;
}

bool BinaryReader::readValue(Value& value, std::size_t end) {
    if (mOffset == end)
        return fail(mOffset, "the record has fewer values than its header states");
    mAhead.need(mOffset, 1);
    const char code = mBytes[mOffset++];
    const bool read = readValueOf(code, value, end);
    value.code = code;
    return read;
}

bool BinaryReader::readValueOf(char code, Value& value, std::size_t end) {
    switch (code) {
    case 'C':
    case 'B':
        return readLetter(value, end);
    case 'Z':
        return readScalar<std::uint8_t>(value, end);
    case 'Y':
        return readScalar<std::int16_t>(value, end);
    case 'I':
        return readScalar<std::int32_t>(value, end);
    case 'L':
        return readScalar<std::int64_t>(value, end);
    case 'F':
        return readScalar<float>(value, end);
    case 'D':
        return readScalar<double>(value, end);
    case 'S':
        return readText(value, Value::Type::text, end);
    case 'R':
        return readText(value, Value::Type::raw, end);
    default:
        break;
    }
    if (const ElementCode* const array = findCode(kArrayCodes, code))
        return readArray(value, array->element, end);
    return fail(mOffset - 1, "unknown value type " + std::to_string(static_cast<unsigned char>(code)));
}

template <class Number>
bool BinaryReader::readScalar(Value& value, std::size_t end) {
    if (end - mOffset < sizeof(Number))
        return fail(mOffset, "a number exceeds its record");
    const auto number = numberAt<Number>(mOffset);
    if constexpr (std::is_integral_v<Number>)
        value = Value::ofInteger(number);
    else
        value = Value::ofReal(static_cast<double>(number));
    mOffset += sizeof(Number);
    return true;
}

bool BinaryReader::readLetter(Value& value, std::size_t end) {
    if (mOffset == end)
        return fail(mOffset, "a character exceeds its record");
    value = Value::ofWord(textAt(mOffset++, 1));
    return true;
}

bool BinaryReader::readText(Value& value, Value::Type type, std::size_t end) {
    constexpr std::size_t kSizeBytes = 4;
    if (end - mOffset < kSizeBytes)
        return fail(mOffset, "the size of a string exceeds its record");
    const auto size = numberAt<std::uint32_t>(mOffset);
    if (size > end - mOffset - kSizeBytes)
        return fail(mOffset, "string of " + std::to_string(size) + " bytes exceeds its record");
    mOffset += kSizeBytes;
    if (type == Value::Type::raw && size > kMostReadAlong) {
        StoredArray& array = mTree.newArray();
        array.element = StoredArray::Element::int8;
        array.count = size;
        keepPayload(array, size);
        value = Value::ofArray(array);
        return true;
    }
    value = Value::ofText(textAt(mOffset, size));
    value.type = type;
    mOffset += size;
    return true;
}

bool BinaryReader::readArray(Value& value, StoredArray::Element element, std::size_t end) {
    constexpr std::size_t kHeadBytes = 12;
    const std::size_t start = mOffset;
    if (end - start < kHeadBytes)
        return fail(start, "array header exceeds its record");
    const auto count = numberAt<std::uint32_t>(start);
    const auto encoding = numberAt<std::uint32_t>(start + 4);
    const auto size = numberAt<std::uint32_t>(start + 8);
    if (size > end - start - kHeadBytes)
        return fail(start, "array of " + std::to_string(size) + " bytes exceeds its record");
    if (encoding > 1)
        return fail(start, "unknown array encoding " + std::to_string(encoding));
    StoredArray& array = mTree.newArray();
    array.element = element;
    array.compressed = encoding == 1;
    array.bigEndian = mTree.bigEndian;
    array.count = count;
    mOffset += kHeadBytes;
    keepPayload(array, size);
    value = Value::ofArray(array);
    return checkArray(array, start);
}

void BinaryReader::keepPayload(StoredArray& array, std::size_t size) {
    array.bytes = mBytes.subspan(mOffset, size);
    if (size > kMostReadAlong)
        array.file = mTree.file.get();
    else
        mAhead.need(mOffset, size);
    mOffset += size;
}

bool BinaryReader::checkArray(const StoredArray& array, std::size_t offset) {
    const std::uint64_t size = array.count * elementSize(array.element);
    const bool fits =
        array.compressed ? size <= kMaxDeflateRatio * array.bytes.size() + kDeflateSlack : size == array.bytes.size();
    if (!fits) {
        return fail(offset, "array of " + std::to_string(array.count) + " elements does not match its " +
                                std::to_string(array.bytes.size()) + " bytes");
    }
    if (array.compressed)
        mExpanded += array.count * sizeof(double);
    if (mExpanded > kMaxExpansion * mBytes.size() + kFreeExpansion) {
        return fail(offset,
                    "the arrays expand to more than " + std::to_string(kMaxExpansion) + " times the size of the file");
    }
    return true;
}

} // namespace

bool isBinary(std::span<const char> bytes) {
    return std::string_view(bytes.data(), bytes.size()).starts_with(kBinaryMagic);
}

std::uint64_t binaryRecordEnd(std::span<const char> bytes, const RecordTree& tree, const Record& record) {
    const bool swap = needsSwap(tree.bigEndian), wide = tree.version >= kFirstWideVersion;
    const std::size_t fieldSize = wide ? 8 : 4;
    const auto field = [&](std::size_t index) {
        const char* const place = bytes.data() + record.location + index * fieldSize;
        return wide ? loadNumber<std::uint64_t>(place, swap) : loadNumber<std::uint32_t>(place, swap);
    };
    const std::uint64_t valuesEnd = record.location + 3 * fieldSize + 1 + record.name.size() + field(2);
    return std::max(field(0), valuesEnd);
}

bool readBinary(std::span<const char> bytes, RecordTree& tree, FbxStatus& status) {
    return BinaryReader(bytes, tree, status).read();
}

} // namespace detail
FBXSDK_NAMESPACE_END
