// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A binary record is
//
//     end offset  value count  value bytes  name length  name  values  [records, 13 zero bytes]
//     u32         u32          u32          u8
//
// of which the sizes are known at its end and patched then. The whole file is in memory until it is saved.
#include "FbxEmitter.h"

#include <libdeflate.h>

#include <array>
#include <charconv>
#include <cstring>
#include <fstream>
#include <stdexcept>
#include <vector>

namespace bench {
namespace {

constexpr std::uint32_t kVersion = 7400;

void saveBytes(const std::filesystem::path& path, const std::string& bytes) {
    std::ofstream stream(path, std::ios::binary);
    stream.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (!stream.flush())
        throw std::runtime_error("cannot write " + path.string());
}

class BinaryEmitter : public FbxEmitter {
public:
    explicit BinaryEmitter(bool compressed) : mCompressed(compressed) {
        using namespace std::string_literals;
        mBytes = "Kaydara FBX Binary  \0\x1A\0"s;
        append(kVersion);
    }

    FbxEmitter& begin(std::string_view name) override {
        mOpen.push_back({.start = mBytes.size()});
        mBytes.append(kHeadSize - 1, '\0');
        mBytes += static_cast<char>(name.size());
        mBytes += name;
        mOpen.back().valuesStart = mBytes.size();
        return *this;
    }
    FbxEmitter& integer(std::int32_t value) override { return value_('I', value); }
    FbxEmitter& id(std::int64_t value) override { return value_('L', value); }
    FbxEmitter& real(double value) override { return value_('D', value); }
    FbxEmitter& text(std::string_view value) override {
        value_('S', static_cast<std::uint32_t>(value.size()));
        mBytes += value;
        return *this;
    }
    FbxEmitter& name(std::string_view value, std::string_view ofClass) override {
        return text(std::string(value) + std::string("\0\1", 2) + std::string(ofClass));
    }
    FbxEmitter& array(std::span<const double> values) override { return array_('d', values); }
    FbxEmitter& array(std::span<const float> values) override { return array_('f', values); }
    FbxEmitter& array(std::span<const std::int32_t> values) override { return array_('i', values); }
    FbxEmitter& array(std::span<const std::int64_t> values) override { return array_('l', values); }
    FbxEmitter& block() override {
        closeValues();
        mOpen.back().hasBlock = true;
        return *this;
    }
    void end() override {
        const Open record = mOpen.back();
        if (record.hasBlock)
            mBytes.append(kHeadSize, '\0');
        else
            closeValues();
        patch(record.start, mBytes.size());
        mOpen.pop_back();
    }
    void save(const std::filesystem::path& path) override {
        mBytes.append(kHeadSize, '\0');
        appendFooter();
        saveBytes(path, mBytes);
    }

private:
    static constexpr std::size_t kHeadSize = 13;

    struct Open {
        std::size_t start = 0;
        std::size_t valuesStart = 0;
        std::size_t values = 0;
        bool hasBlock = false;
    };

    template <class T>
    void append(T value) {
        std::array<char, sizeof(T)> bytes{};
        std::memcpy(bytes.data(), &value, sizeof(T));
        mBytes.append(bytes.data(), bytes.size());
    }
    void patch(std::size_t at, std::size_t value) {
        if (value > UINT32_MAX)
            throw std::length_error("the file needs more than 4 GiB");
        const auto narrow = static_cast<std::uint32_t>(value);
        std::memcpy(mBytes.data() + at, &narrow, sizeof narrow);
    }
    void closeValues() {
        const Open& record = mOpen.back();
        patch(record.start + 4, record.values);
        patch(record.start + 8, mBytes.size() - record.valuesStart);
    }
    template <class T>
    FbxEmitter& value_(char code, T value) {
        ++mOpen.back().values;
        mBytes += code;
        append(value);
        return *this;
    }
    template <class T>
    FbxEmitter& array_(char code, std::span<const T> values) {
        ++mOpen.back().values;
        mBytes += code;
        append(static_cast<std::uint32_t>(values.size()));
        const auto* raw = reinterpret_cast<const char*>(values.data());
        if (mCompressed)
            appendCompressed(raw, values.size_bytes());
        else
            appendStored(raw, values.size_bytes());
        return *this;
    }
    void appendStored(const char* raw, std::size_t size) {
        append(std::uint32_t{0});
        append(static_cast<std::uint32_t>(size));
        mBytes.append(raw, size);
    }
    void appendCompressed(const char* raw, std::size_t size) {
        constexpr int kFastestLevel = 1; // what applications use
        const std::unique_ptr<libdeflate_compressor, decltype(&libdeflate_free_compressor)> compressor(
            libdeflate_alloc_compressor(kFastestLevel), &libdeflate_free_compressor);
        std::string packed(libdeflate_zlib_compress_bound(compressor.get(), size), '\0');
        packed.resize(libdeflate_zlib_compress(compressor.get(), raw, size, packed.data(), packed.size()));
        append(std::uint32_t{1});
        append(static_cast<std::uint32_t>(packed.size()));
        mBytes += packed;
    }
    void appendFooter() {
        constexpr std::array<unsigned char, 16> kCode = {0xFA, 0xBC, 0xAB, 0x09, 0xD0, 0xC8, 0xD4, 0x66,
                                                         0xB1, 0x76, 0xFB, 0x83, 0x1C, 0xF7, 0x26, 0x7E};
        constexpr std::array<unsigned char, 16> kEnd = {0xF8, 0x5A, 0x8C, 0x6A, 0xDE, 0xF5, 0xD9, 0x7E,
                                                        0xEC, 0xE9, 0x0C, 0xE3, 0x75, 0x8F, 0x29, 0x0B};
        constexpr std::size_t kAlignment = 16;
        constexpr std::size_t kZeros = 120;
        mBytes.append(kCode.begin(), kCode.end());
        mBytes.append(kAlignment - mBytes.size() % kAlignment, '\0');
        append(std::uint32_t{0});
        append(kVersion);
        mBytes.append(kZeros, '\0');
        mBytes.append(kEnd.begin(), kEnd.end());
    }

    bool mCompressed;
    std::string mBytes;
    std::vector<Open> mOpen;
};

class AsciiEmitter : public FbxEmitter {
public:
    AsciiEmitter() : mText("; FBX 7.4.0 project file\n; ----------------------------------------------------\n\n") {}

    FbxEmitter& begin(std::string_view name) override {
        mText.append(mOpen.size(), '\t');
        mText += name;
        mText += ": ";
        mOpen.push_back({});
        return *this;
    }
    FbxEmitter& integer(std::int32_t value) override { return number(value); }
    FbxEmitter& id(std::int64_t value) override { return number(value); }
    FbxEmitter& real(double value) override { return number(value); }
    FbxEmitter& text(std::string_view value) override {
        if (mOpen.back().hasValue)
            mText += ", ";
        mOpen.back().hasValue = true;
        mText += '"';
        mText += value;
        mText += '"';
        return *this;
    }
    FbxEmitter& name(std::string_view value, std::string_view ofClass) override {
        return text(std::string(ofClass) + "::" + std::string(value));
    }
    FbxEmitter& array(std::span<const double> values) override { return array_(values); }
    FbxEmitter& array(std::span<const float> values) override { return array_(values); }
    FbxEmitter& array(std::span<const std::int32_t> values) override { return array_(values); }
    FbxEmitter& array(std::span<const std::int64_t> values) override { return array_(values); }
    FbxEmitter& block() override {
        mText += " {\n";
        mOpen.back().hasBlock = true;
        return *this;
    }
    void end() override {
        const bool hasBlock = mOpen.back().hasBlock;
        mOpen.pop_back();
        if (hasBlock) {
            mText.append(mOpen.size(), '\t');
            mText += '}';
        }
        mText += '\n';
    }
    void save(const std::filesystem::path& path) override { saveBytes(path, mText); }

private:
    struct Open {
        bool hasValue = false, hasBlock = false;
    };

    template <class T>
    void print(T value) {
        std::array<char, 32> digits{};
        const std::to_chars_result result = std::to_chars(digits.data(), digits.data() + digits.size(), value);
        mText.append(digits.data(), result.ptr);
    }
    template <class T>
    FbxEmitter& number(T value) {
        if (mOpen.back().hasValue)
            mText += ',';
        mOpen.back().hasValue = true;
        print(value);
        return *this;
    }
    template <class T>
    FbxEmitter& array_(std::span<const T> values) {
        constexpr std::size_t kValuesPerLine = 100;
        mText += '*' + std::to_string(values.size()) + " {\n";
        mText.append(mOpen.size(), '\t');
        mText += "a: ";
        for (std::size_t i = 0; i < values.size(); ++i) {
            if (i > 0)
                mText += i % kValuesPerLine == 0 ? ",\n" : ",";
            print(values[i]);
        }
        mText += '\n';
        mText.append(mOpen.size() - 1, '\t');
        mText += "} ";
        return *this;
    }

    std::string mText;
    std::vector<Open> mOpen;
};

} // namespace

std::unique_ptr<FbxEmitter> makeEmitter(Encoding encoding) {
    if (encoding == Encoding::ascii)
        return std::make_unique<AsciiEmitter>();
    return std::make_unique<BinaryEmitter>(encoding == Encoding::binaryCompressed);
}

} // namespace bench
