// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Binary files. The head of a record states where the record ends, which is known only after writing it: a head is
// written empty first and filled in when its record ends. BinaryReader.cpp draws the layout.
#include "container/BinarySink.h"

#include <cassert>
#include <cstring>
#include <limits>
#include <memory>
#include <utility>

#include "container/ByteOrder.h"
#include "container/FileFormat.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Size in bytes from which on an array is compressed. The applications use the same limit.
constexpr std::size_t kShortestCompressed = 1024;
constexpr std::size_t kFooterAlignment = 16;
constexpr std::size_t kFooterZeros = 120;
constexpr FileCode kFooterMagic{0xF8, 0x5A, 0x8C, 0x6A, 0xDE, 0xF5, 0xD9, 0x7E,
                                0xEC, 0xE9, 0x0C, 0xE3, 0x75, 0x8F, 0x29, 0x0B};
/// What follows pending arrays is in memory, up to this size.
constexpr std::size_t kMostBytesAfter = std::size_t{1} << 20;
/// Sizes of texts and arrays are 32 bits wide in every version.
constexpr std::uint64_t kMaxValueBytes = std::numeric_limits<std::uint32_t>::max();

/// The number's bytes in the file's order, which is little-endian.
template <class Number>
void storeNumber(char* bytes, Number number) {
    auto bits = std::bit_cast<BitsOf<Number>>(number);
    if (needsSwap(/*bigEndian*/ false))
        bits = swapBytes(bits);
    std::memcpy(bytes, &bits, sizeof bits);
}

std::span<const char> bytesOf(std::string_view text) { return {text.data(), text.size()}; }

std::span<const char> bytesOf(const FileCode& code) {
    return {reinterpret_cast<const char*>(code.data()), code.size()};
}

/// Packed elements in the file's byte order: the memory itself wherever that is the machine's order.
template <class Number>
std::span<const char> fileBytes(std::span<const Number> values, std::vector<char>& swapped) {
    if (!needsSwap(/*bigEndian*/ false))
        return {reinterpret_cast<const char*>(values.data()), values.size_bytes()};
    swapped.resize(values.size_bytes());
    for (std::size_t i = 0; i < values.size(); ++i)
        storeNumber(swapped.data() + i * sizeof(Number), values[i]);
    return swapped;
}

/// An array of a version that packs them.
template <class Number>
struct PackedArray {
    char code;
    std::span<const Number> values;

    /// Passes on the array as files hold it, compressed where that is shorter.
    template <class Write>
    void encode(Deflater& deflater, const Write& write) const {
        std::vector<char> swapped;
        const std::span<const char> bytes = fileBytes(values, swapped);
        std::span<const char> stream;
        if (bytes.size() >= kShortestCompressed)
            stream = deflater.deflated(bytes);
        const std::span<const char> stored = stream.empty() ? bytes : stream;
        char head[13];
        head[0] = code;
        storeNumber(head + 1, static_cast<std::uint32_t>(values.size()));
        storeNumber(head + 5, std::uint32_t{!stream.empty()});
        storeNumber(head + 9, static_cast<std::uint32_t>(stored.size()));
        write(std::span<const char>(head));
        write(stored);
    }
};

} // namespace

BinarySink::BinarySink(ByteOutput& output, std::uint32_t version, std::uint64_t maxNarrowSize)
    : mWindow(output), mVersion(version), mWide(version >= kFirstWideVersion),
      mMaxSize(mWide ? std::numeric_limits<std::uint64_t>::max() : maxNarrowSize) {
    char versionBytes[4];
    storeNumber(versionBytes, version);
    mWindow.write(bytesOf(kBinaryHead));
    mWindow.write(versionBytes);
}

BinarySink::BinarySink(ByteOutput& output, const BinarySink& whole)
    : mWindow(output), mVersion(whole.mVersion), mWide(whole.mWide), mMaxSize(whole.mMaxSize), mIsFragment(true) {}

std::size_t BinarySink::headSize() const { return mWide ? 25 : 13; }

void BinarySink::setFault(const std::string& fault) {
    if (mFault.empty())
        mFault = fault;
}

/// In the file, or while arrays are pending, in the bytes after the last one.
std::uint64_t BinarySink::place() { return mPending.isEmpty() ? mWindow.size() : mPending.last().after.size(); }

char* BinarySink::extend(std::size_t count) {
    if (mPending.isEmpty())
        return mWindow.extend(count);
    std::string& bytes = mPending.last().after;
    bytes.resize(bytes.size() + count);
    return bytes.data() + bytes.size() - count;
}

void BinarySink::write(std::span<const char> bytes) {
    if (mPending.isEmpty())
        mWindow.write(bytes);
    else
        mPending.last().after.append(bytes.data(), bytes.size());
}

void BinarySink::writeZeros(std::size_t count) { std::memset(extend(count), 0, count); }

void BinarySink::beginRecord(std::string_view name) {
    assert(name.size() <= std::numeric_limits<std::uint8_t>::max());
    assert(mOpen.empty() || mOpen.back().hasBlock);
    mOpen.emplace_back();
    mark(RecordMark::Kind::begin, place(), headSize() + name.size());
    writeZeros(headSize() - 1);
    char* const lengthAndName = extend(1 + name.size());
    storeNumber(lengthAndName, static_cast<std::uint8_t>(name.size()));
    std::copy(name.begin(), name.end(), lengthAndName + 1);
}

void BinarySink::beginBlock() {
    assert(!mOpen.empty() && !mOpen.back().hasBlock);
    mOpen.back().hasBlock = true;
    mark(RecordMark::Kind::block, place());
}

void BinarySink::endRecord() {
    assert(!mOpen.empty());
    const OpenRecord record = mOpen.back();
    mOpen.pop_back();
    if (record.hasBlock)
        writeZeros(headSize());
    mark(RecordMark::Kind::end, place(), record.valueCount);
    if (!mPending.isEmpty() && mPending.last().after.size() > kMostBytesAfter)
        settleAll();
}

void BinarySink::checkSize(std::uint64_t size) {
    if (size > mMaxSize) {
        setFault("the file exceeds the " + std::to_string(mMaxSize) + " bytes that a binary file of version " +
                 std::to_string(mVersion) + " can have; files of version " + std::to_string(kFirstWideVersion) +
                 " can be larger");
    }
}

// While arrays are pending nobody knows where in the file a record is: what is to be done there is marked.
void BinarySink::mark(RecordMark::Kind kind, std::uint64_t place, std::uint64_t count) {
    if (mPending.isEmpty())
        apply({kind, place, count}, 0);
    else
        mPending.last().marks.push_back({kind, place, count});
}

void BinarySink::apply(const RecordMark& mark, std::uint64_t base) {
    const std::uint64_t place = base + mark.place;
    if (mark.kind == RecordMark::Kind::begin) {
        mPlaces.push_back({place, place + mark.count});
        return;
    }
    RecordPlace& record = mPlaces.back();
    if (mark.kind == RecordMark::Kind::block) {
        record.valuesEnd = place;
        return;
    }
    if (record.valuesEnd == 0)
        record.valuesEnd = place;
    checkSize(place);
    if (!failed())
        patchHead(record, place, mark.count);
    mPlaces.pop_back();
}

void BinarySink::patchHead(const RecordPlace& record, std::uint64_t end, std::uint64_t valueCount) {
    const std::uint64_t fields[] = {end, valueCount, record.valuesEnd - record.valuesStart};
    char head[3 * sizeof(std::uint64_t)];
    std::size_t size = 0;
    for (const std::uint64_t field : fields)
        size += storeOffset(head + size, field);
    mWindow.overwrite(record.start, std::span(head, size));
    if (mIsFragment)
        mHeads.push_back(record.start);
}

/// Writes the first pending array and what follows it.
void BinarySink::settleFirst() {
    const PendingArray first = mPending.takeFirst();
    mWindow.write(first.bytes);
    const std::uint64_t base = mWindow.size();
    mWindow.write(first.after);
    for (const RecordMark& mark : first.marks)
        apply(mark, base);
}

void BinarySink::settleAll() {
    while (!mPending.isEmpty())
        settleFirst();
}

/// Size in bytes of an offset or a count in heads.
std::size_t BinarySink::storeOffset(char* bytes, std::uint64_t offset) const {
    if (mWide) {
        storeNumber(bytes, offset);
        return sizeof offset;
    }
    storeNumber(bytes, static_cast<std::uint32_t>(offset));
    return sizeof(std::uint32_t);
}

/// Adds to the offset of the record's end.
void BinarySink::moveHead(char* head, std::uint64_t distance) const {
    const bool swap = needsSwap(/*bigEndian*/ false);
    storeOffset(head,
                distance + (mWide ? loadNumber<std::uint64_t>(head, swap) : loadNumber<std::uint32_t>(head, swap)));
}

RecordSink::EncodedRecords BinarySink::encoded(const Part& part) const {
    MemoryOutput output;
    BinarySink fragment(output, *this);
    part(fragment);
    fragment.mWindow.flush();
    assert(output.size() < OutputWindow::kBytes && fragment.mFault.empty());
    return {output.takeBytes(), {fragment.mHeads.begin(), fragment.mHeads.end()}};
}

void BinarySink::repeat(const EncodedRecords& records) {
    settleAll();
    const std::uint64_t place = mWindow.size();
    char* const bytes = mWindow.extend(records.bytes.size());
    std::copy(records.bytes.begin(), records.bytes.end(), bytes);
    for (const std::uint32_t head : records.places)
        moveHead(bytes + head, place);
    if (mIsFragment)
        for (const std::uint32_t head : records.places)
            mHeads.push_back(place + head);
    checkSize(mWindow.size());
}

template <class Number>
void BinarySink::scalar(char code, Number value) {
    assert(!mOpen.empty() && !mOpen.back().hasBlock);
    char* const bytes = extend(1 + sizeof(Number));
    bytes[0] = code;
    storeNumber(bytes + 1, value);
    ++mOpen.back().valueCount;
}

void BinarySink::byte(std::uint8_t value) { scalar('Z', value); }
void BinarySink::shortInteger(std::int16_t value) { scalar('Y', value); }
void BinarySink::integer(std::int32_t value) { scalar('I', value); }
void BinarySink::longInteger(std::int64_t value) { scalar('L', value); }
void BinarySink::singleReal(float value) { scalar('F', value); }
void BinarySink::real(double value) { scalar('D', value); }
void BinarySink::letter(char value) { scalar('C', value); }

void BinarySink::sizedBytes(char code, std::string_view first, std::string_view second, std::string_view third) {
    const std::uint64_t size = first.size() + second.size() + third.size();
    if (size > kMaxValueBytes) {
        setFault("a string of " + std::to_string(size) + " bytes is too long for the file format");
        return;
    }
    scalar(code, static_cast<std::uint32_t>(size));
    for (const std::string_view part : {first, second, third})
        write(bytesOf(part));
}

void BinarySink::text(std::string_view value) { sizedBytes('S', value); }

void BinarySink::raw(std::span<const char> bytes) { sizedBytes('R', {bytes.data(), bytes.size()}); }

void BinarySink::objectName(std::string_view className, std::string_view name) {
    sizedBytes('S', name, kBinaryNameSeparator, className);
}

template <class Number>
void BinarySink::arrayOf(char arrayCode, char scalarCode, std::span<const Number> values) {
    if (mVersion >= kFirstVersionWithArrays)
        packedArray(arrayCode, values);
    else
        scalarList(scalarCode, values);
}

// Most of the time is spent deflating arrays. With several threads other ones do that while the caller's goes on with
// the records after them; the bytes are the same.
template <class Number>
void BinarySink::packedArray(char code, std::span<const Number> values) {
    if (!beginPackedArray(values))
        return;
    if (isPassedOn(values.size_bytes()))
        passArray(code, std::vector<Number>(values.begin(), values.end()));
    else
        writeArray(code, values);
}

template <class Number>
void BinarySink::ownedArray(char arrayCode, char scalarCode, std::vector<Number> values) {
    const std::span<const Number> elements = values;
    if (mVersion < kFirstVersionWithArrays || !isPassedOn(elements.size_bytes()))
        arrayOf(arrayCode, scalarCode, elements);
    else if (beginPackedArray(elements))
        passArray(arrayCode, std::move(values));
}

/// False with a fault for more elements than files can hold.
template <class Number>
bool BinarySink::beginPackedArray(std::span<const Number> values) {
    assert(!mOpen.empty() && !mOpen.back().hasBlock);
    ++mOpen.back().valueCount;
    while (mPending.isFirstDue())
        settleFirst();
    if (values.size_bytes() <= kMaxValueBytes)
        return true;
    setFault("an array of " + std::to_string(values.size()) + " elements is too long for the file format");
    return false;
}

bool BinarySink::isPassedOn(std::size_t bytes) {
    return !mIsFragment && bytes >= kShortestCompressed && mPending.hasThreads();
}

template <class Number>
void BinarySink::writeArray(char code, std::span<const Number> values) {
    PackedArray<Number>{code, values}.encode(
        mDeflaters[0], [this](std::span<const char> bytes) { write(bytes); });
}

template <class Number>
void BinarySink::passArray(char code, std::vector<Number> values) {
    while (mDeflaters.size() < mPending.workers())
        mDeflaters.emplace_back();
    const std::size_t size = values.size() * sizeof(Number);
    mPending.add(size, [this, code, elements = std::move(values)](std::size_t worker) {
        std::string encoded;
        PackedArray<Number>{code, elements}.encode(
            mDeflaters[worker], [&](std::span<const char> bytes) { encoded.append(bytes.begin(), bytes.end()); });
        return encoded;
    });
}

template <class Number>
void BinarySink::scalarList(char code, std::span<const Number> values) {
    for (const Number value : values)
        scalar(code, value);
}

void BinarySink::array(std::span<const double> values) { arrayOf('d', 'D', values); }
void BinarySink::array(std::span<const float> values) { arrayOf('f', 'F', values); }
void BinarySink::array(std::span<const std::int32_t> values) { arrayOf('i', 'I', values); }
void BinarySink::array(std::span<const std::int64_t> values) { arrayOf('l', 'L', values); }
void BinarySink::array(std::vector<double>&& values) { ownedArray('d', 'D', std::move(values)); }
void BinarySink::array(std::vector<std::int32_t>&& values) { ownedArray('i', 'I', std::move(values)); }

void BinarySink::array(std::span<const std::uint8_t> values) {
    if (mVersion >= kFirstVersionWithArrays) {
        packedArray('b', values);
        return;
    }
    for (const std::uint8_t value : values)
        integer(value);
}

void BinarySink::floatBits(std::span<const std::uint32_t> words) { arrayOf('f', 'F', words); }

void BinarySink::finish(const CreationTime& time) {
    assert(mOpen.empty());
    settleAll();
    writeZeros(headSize());
    mWindow.write(bytesOf(footerCode(time)));
    // Aligned or not, there is padding.
    writeZeros(kFooterAlignment - mWindow.size() % kFooterAlignment);
    writeZeros(sizeof(std::uint32_t));
    char versionBytes[4];
    storeNumber(versionBytes, mVersion);
    mWindow.write(versionBytes);
    writeZeros(kFooterZeros);
    mWindow.write(bytesOf(kFooterMagic));
    mWindow.flush();
}

} // namespace detail
FBXSDK_NAMESPACE_END
