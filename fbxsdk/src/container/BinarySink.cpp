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

#include <fbxsdk/extensions/Threads.h>

#include "container/ByteOrder.h"
#include "container/FileFormat.h"
#include "core/Parallel.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Size in bytes from which on an array is compressed. The applications use the same limit.
constexpr std::size_t kShortestCompressed = 1024;
constexpr std::size_t kFooterAlignment = 16;
constexpr std::size_t kFooterZeros = 120;
constexpr FileCode kFooterMagic{0xF8, 0x5A, 0x8C, 0x6A, 0xDE, 0xF5, 0xD9, 0x7E,
                                0xEC, 0xE9, 0x0C, 0xE3, 0x75, 0x8F, 0x29, 0x0B};
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

void BinarySink::writeZeros(std::size_t count) { std::memset(mWindow.extend(count), 0, count); }

void BinarySink::beginRecord(std::string_view name) {
    assert(name.size() <= std::numeric_limits<std::uint8_t>::max());
    assert(mOpen.empty() || mOpen.back().hasBlock);
    const std::uint64_t start = mWindow.size();
    writeZeros(headSize() - 1);
    char* const lengthAndName = mWindow.extend(1 + name.size());
    storeNumber(lengthAndName, static_cast<std::uint8_t>(name.size()));
    std::copy(name.begin(), name.end(), lengthAndName + 1);
    mOpen.push_back({.start = start, .valuesStart = start + headSize() + name.size()});
}

void BinarySink::beginBlock() {
    assert(!mOpen.empty() && !mOpen.back().hasBlock);
    mOpen.back().hasBlock = true;
    mOpen.back().valuesEnd = mWindow.size();
}

void BinarySink::endRecord() {
    assert(!mOpen.empty());
    OpenRecord record = mOpen.back();
    mOpen.pop_back();
    if (record.hasBlock)
        writeZeros(headSize());
    else
        record.valuesEnd = mWindow.size();
    checkSize();
    if (!failed())
        patchHead(record);
}

void BinarySink::checkSize() {
    if (mWindow.size() > mMaxSize) {
        setFault("the file exceeds the " + std::to_string(mMaxSize) + " bytes that a binary file of version " +
                 std::to_string(mVersion) + " can have; files of version " + std::to_string(kFirstWideVersion) +
                 " can be larger");
    }
}

void BinarySink::patchHead(const OpenRecord& record) {
    const std::uint64_t fields[] = {mWindow.size(), record.valueCount, record.valuesEnd - record.valuesStart};
    char head[3 * sizeof(std::uint64_t)];
    std::size_t size = 0;
    for (const std::uint64_t field : fields)
        size += storeOffset(head + size, field);
    mWindow.overwrite(record.start, std::span(head, size));
    if (mIsFragment)
        mHeads.push_back(record.start);
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

// Most of the time is spent deflating arrays. Each part becomes a fragment of a file with offsets of its own, to which
// its final position is added at the end: the bytes are the same as when the parts are written one after the other.
void BinarySink::parts(std::span<const Part> list) {
    assert(mOpen.empty() || mOpen.back().hasBlock);
    if (extensions::maximumThreads() == 1) {
        RecordSink::parts(list);
        return;
    }
    std::vector<MemoryOutput> outputs(list.size());
    std::vector<std::unique_ptr<BinarySink>> fragments;
    fragments.reserve(list.size());
    for (MemoryOutput& output : outputs)
        fragments.emplace_back(new BinarySink(output, *this));
    forEachInParallel(list.size(), [&](std::size_t i) {
        list[i](*fragments[i]);
        fragments[i]->mWindow.flush();
    });
    for (std::size_t i = 0; i < list.size(); ++i) {
        append(*fragments[i], outputs[i].takeBytes());
        fragments[i].reset();
    }
}

void BinarySink::append(const BinarySink& fragment, std::string bytes) {
    const std::uint64_t place = mWindow.size();
    for (const std::uint64_t head : fragment.mHeads) {
        if (mIsFragment)
            mHeads.push_back(place + head);
        moveHead(bytes.data() + head, place);
    }
    mWindow.write(bytes);
    if (!fragment.mFault.empty())
        setFault(fragment.mFault);
    checkSize();
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
    const std::uint64_t place = mWindow.size();
    char* const bytes = mWindow.extend(records.bytes.size());
    std::copy(records.bytes.begin(), records.bytes.end(), bytes);
    for (const std::uint32_t head : records.places) {
        if (mIsFragment)
            mHeads.push_back(place + head);
        moveHead(bytes + head, place);
    }
    checkSize();
}

template <class Number>
void BinarySink::scalar(char code, Number value) {
    assert(!mOpen.empty() && !mOpen.back().hasBlock);
    char* const bytes = mWindow.extend(1 + sizeof(Number));
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
        mWindow.write(bytesOf(part));
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

template <class Number>
void BinarySink::packedArray(char code, std::span<const Number> values) {
    if (values.size_bytes() > kMaxValueBytes) {
        setFault("an array of " + std::to_string(values.size()) + " elements is too long for the file format");
        return;
    }
    std::vector<char> swapped;
    std::span<const char> bytes = fileBytes(values, swapped);
    std::span<const char> stream;
    if (bytes.size() >= kShortestCompressed)
        stream = mDeflater.deflated(bytes);
    const bool compressed = !stream.empty();
    if (compressed)
        bytes = stream;
    scalar(code, static_cast<std::uint32_t>(values.size()));
    char head[8];
    storeNumber(head, std::uint32_t{compressed});
    storeNumber(head + 4, static_cast<std::uint32_t>(bytes.size()));
    mWindow.write(head);
    mWindow.write(bytes);
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
