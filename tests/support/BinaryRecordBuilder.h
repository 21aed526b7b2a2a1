// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Hand-built binary files for tests: every version, both byte orders, and, where a test needs it, deliberately invalid.
//
//     BinaryRecordBuilder file(7400);
//     file.begin("Objects").block();
//     file.begin("Model").int64(17).text("Cube").end();
//     file.end();
//     const std::string bytes = file.finish();
#pragma once

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include <libdeflate.h>

enum class ByteOrder { little, big };

class BinaryRecordBuilder {
public:
    explicit BinaryRecordBuilder(std::uint32_t version, ByteOrder order = ByteOrder::little)
        : mOrder(order), mWide(version >= 7500) {
        mBytes = std::string("Kaydara FBX Binary  \0\x1A", 22);
        mBytes += order == ByteOrder::big ? '\1' : '\0';
        number(version);
    }

    /// Starts a record; its values follow, then, if it has a block, block() and the records in it, then end().
    BinaryRecordBuilder& begin(std::string_view name) {
        mOpen.push_back({mBytes.size()});
        mBytes.append(headSize() - 1, '\0');
        mBytes += static_cast<char>(name.size());
        mBytes += name;
        mOpen.back().valuesStart = mBytes.size();
        return *this;
    }
    BinaryRecordBuilder& block() {
        closeValues();
        mOpen.back().hasBlock = true;
        return *this;
    }
    BinaryRecordBuilder& end() {
        if (mOpen.back().hasBlock)
            nullRecord();
        else
            closeValues();
        const OpenRecord& record = mOpen.back();
        patch(record.start, 0, record.endLost ? 0 : mBytes.size());
        mOpen.pop_back();
        return *this;
    }
    /// The current record will state an end of 0, as some writers' leaf records do.
    BinaryRecordBuilder& loseEnd() {
        mOpen.back().endLost = true;
        return *this;
    }
    BinaryRecordBuilder& nullRecord() { return bytes(std::string(headSize(), '\0')); }

    BinaryRecordBuilder& letter(char letter, char code = 'C') { return value(code).bytes(std::string(1, letter)); }
    BinaryRecordBuilder& uint8(std::uint8_t number) { return scalar('Z', number); }
    BinaryRecordBuilder& int16(std::int16_t number) { return scalar('Y', number); }
    BinaryRecordBuilder& int32(std::int32_t number) { return scalar('I', number); }
    BinaryRecordBuilder& int64(std::int64_t number) { return scalar('L', number); }
    BinaryRecordBuilder& float32(float number) { return scalar('F', number); }
    BinaryRecordBuilder& float64(double number) { return scalar('D', number); }
    BinaryRecordBuilder& text(std::string_view text) { return sized('S', text); }
    BinaryRecordBuilder& raw(std::string_view bytes) { return sized('R', bytes); }

    template <class Number>
    BinaryRecordBuilder& array(char code, const std::vector<Number>& numbers) {
        const std::string elements = encode(numbers);
        return arrayOf(code, numbers.size(), 0, elements);
    }
    template <class Number>
    BinaryRecordBuilder& compressedArray(char code, const std::vector<Number>& numbers) {
        return arrayOf(code, numbers.size(), 1, deflated(encode(numbers)));
    }
    /// An array with arbitrary fields in its head.
    BinaryRecordBuilder& arrayOf(char code, std::size_t count, std::uint32_t encoding, std::string_view payload) {
        value(code).number(static_cast<std::uint32_t>(count));
        number(encoding).number(static_cast<std::uint32_t>(payload.size()));
        return bytes(payload);
    }

    /// Arbitrary bytes, as part of the current record's values (or between records).
    BinaryRecordBuilder& bytes(std::string_view anything) {
        mBytes += anything;
        return *this;
    }
    /// One more value, of which the caller writes the bytes.
    BinaryRecordBuilder& value(char code) {
        ++mOpen.back().valueCount;
        return bytes(std::string(1, code));
    }
    template <class Number>
    BinaryRecordBuilder& number(Number number) {
        return bytes(encode(std::vector<Number>{number}));
    }

    /// Ends the top level and adds a footer's worth of zeros.
    [[nodiscard]] std::string finish() {
        nullRecord();
        return mBytes + std::string(160, '\0');
    }
    /// The bytes so far.
    [[nodiscard]] std::string& soFar() { return mBytes; }

    template <class Number>
    [[nodiscard]] std::string encode(const std::vector<Number>& numbers) const {
        std::string result;
        for (const Number number : numbers) {
            char element[sizeof number];
            std::memcpy(element, &number, sizeof number);
            if (mOrder == ByteOrder::big)
                std::reverse(std::begin(element), std::end(element));
            result.append(element, sizeof element);
        }
        return result;
    }

    [[nodiscard]] static std::string deflated(std::string_view bytes, int level = 9) {
        const std::unique_ptr<libdeflate_compressor, decltype(&libdeflate_free_compressor)> compressor(
            libdeflate_alloc_compressor(level), &libdeflate_free_compressor);
        std::string result(libdeflate_zlib_compress_bound(compressor.get(), bytes.size()), '\0');
        result.resize(
            libdeflate_zlib_compress(compressor.get(), bytes.data(), bytes.size(), result.data(), result.size()));
        return result;
    }

private:
    struct OpenRecord {
        std::size_t start = 0;
        std::size_t valuesStart = 0;
        std::uint64_t valueCount = 0;
        bool hasBlock = false;
        bool endLost = false;
    };

    [[nodiscard]] std::size_t headSize() const { return mWide ? 25 : 13; }

    void closeValues() {
        const OpenRecord& record = mOpen.back();
        patch(record.start, 1, record.valueCount);
        patch(record.start, 2, mBytes.size() - record.valuesStart);
    }
    void patch(std::size_t start, std::size_t field, std::uint64_t number) {
        const std::string encoded = mWide ? encode(std::vector<std::uint64_t>{number})
                                          : encode(std::vector<std::uint32_t>{static_cast<std::uint32_t>(number)});
        mBytes.replace(start + field * encoded.size(), encoded.size(), encoded);
    }
    template <class Number>
    BinaryRecordBuilder& scalar(char code, Number scalar) {
        return value(code).number(scalar);
    }
    BinaryRecordBuilder& sized(char code, std::string_view content) {
        return value(code).number(static_cast<std::uint32_t>(content.size())).bytes(content);
    }

    std::string mBytes;
    ByteOrder mOrder;
    bool mWide;
    std::vector<OpenRecord> mOpen;
};
