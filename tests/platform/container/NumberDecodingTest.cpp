// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers in every stored form, read in every type.
#include "container/NumberDecoding.h"

#include <bit>
#include <cmath>
#include <cstring>
#include <limits>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "container/NumberConversion.h"
#include "support/BinaryRecordBuilder.h"
#include "support/RecordText.h"

using fbxsdk::FbxStatus;
using namespace fbxsdk::detail;

namespace {

enum class Form { array, compressed, scalars };

struct Storage {
    Form form;
    ByteOrder order;
};

void PrintTo(const Storage& storage, std::ostream* stream) {
    constexpr const char* kForms[] = {"array", "compressed", "scalars"};
    *stream << kForms[static_cast<int>(storage.form)] << (storage.order == ByteOrder::big ? " big" : " little");
}

/// A record of one list in the storage under test.
class StoredNumbers : public testing::TestWithParam<Storage> {
protected:
    template <class Number>
    const Record& store(char code, const std::vector<Number>& numbers) {
        BinaryRecordBuilder file(7400, GetParam().order);
        file.begin("List");
        switch (GetParam().form) {
        case Form::array:
            file.array(code, numbers);
            break;
        case Form::compressed:
            file.compressedArray(code, numbers);
            break;
        case Form::scalars:
            for (const Number number : numbers)
                file.value(static_cast<char>(code - 'a' + 'A')).number(number);
            break;
        }
        mBytes = std::make_unique<ExactBytes>(file.end().finish());
        FbxStatus status;
        mTree = readRecords(mBytes->span(), "test.fbx", status);
        EXPECT_TRUE(mTree) << status.GetErrorString();
        EXPECT_EQ(mTree->root.firstChild->values.size(), 1U);
        EXPECT_EQ(mTree->root.firstChild->value(0).type, Value::Type::array);
        return *mTree->root.firstChild;
    }

    template <class Number>
    static std::vector<Number> as(const Record& record) {
        std::vector<Number> numbers(record.numberCount(), Number{77});
        EXPECT_TRUE(record.readNumbers(std::span<Number>(numbers)));
        return numbers;
    }

    std::unique_ptr<ExactBytes> mBytes;
    std::unique_ptr<RecordTree> mTree;
};

INSTANTIATE_TEST_SUITE_P(EveryForm, StoredNumbers,
                         testing::Values(Storage{Form::array, ByteOrder::little}, Storage{Form::array, ByteOrder::big},
                                         Storage{Form::compressed, ByteOrder::little},
                                         Storage{Form::compressed, ByteOrder::big},
                                         Storage{Form::scalars, ByteOrder::little},
                                         Storage{Form::scalars, ByteOrder::big}));

/// Seventeen numbers and more, so that scalars become a list.
template <class Number>
std::vector<Number> padded(std::vector<Number> numbers) {
    for (int i = 0; i < 20; ++i)
        numbers.push_back(static_cast<Number>(i));
    return numbers;
}

template <class To, class From>
std::vector<To> cast(const std::vector<From>& numbers) {
    return {numbers.begin(), numbers.end()};
}

TEST_P(StoredNumbers, ConvertsDoublesToEveryType) {
    constexpr double kHuge = 1e300;
    const auto numbers = padded<double>({0.1, -2.75, kHuge, -kHuge, 2147483647.5, -2147483648.5, 1e10});
    const Record& record = store('d', numbers);

    EXPECT_EQ(as<double>(record), numbers);
    EXPECT_EQ(as<float>(record),
              padded<float>({0.1F, -2.75F, HUGE_VALF, -HUGE_VALF, 2147483648.0F, -2147483648.0F, 1e10F}));
    constexpr auto kMax = std::numeric_limits<std::int32_t>::max();
    constexpr auto kMin = std::numeric_limits<std::int32_t>::min();
    EXPECT_EQ(as<std::int32_t>(record), padded<std::int32_t>({0, -2, kMax, kMin, kMax, kMin, kMax}));
    constexpr auto kMax64 = std::numeric_limits<std::int64_t>::max();
    constexpr auto kMin64 = std::numeric_limits<std::int64_t>::min();
    EXPECT_EQ(as<std::int64_t>(record),
              padded<std::int64_t>({0, -2, kMax64, kMin64, 2147483647, -2147483648, 10000000000}));
}

TEST_P(StoredNumbers, ConvertsFloatsToEveryType) {
    const auto numbers = padded<float>({0.1F, -2.75F, 3e38F, -3e38F});
    const Record& record = store('f', numbers);

    EXPECT_EQ(as<float>(record), numbers);
    EXPECT_EQ(as<double>(record), cast<double>(numbers));
    EXPECT_EQ(as<std::int32_t>(record), padded<std::int32_t>({0, -2, std::numeric_limits<std::int32_t>::max(),
                                                              std::numeric_limits<std::int32_t>::min()}));
    EXPECT_EQ(as<std::int64_t>(record), padded<std::int64_t>({0, -2, std::numeric_limits<std::int64_t>::max(),
                                                              std::numeric_limits<std::int64_t>::min()}));
}

TEST_P(StoredNumbers, ConvertsIntsToEveryType) {
    const auto numbers = padded<std::int32_t>({2147483647, -2147483647 - 1, 16777217});
    const Record& record = store('i', numbers);

    EXPECT_EQ(as<std::int32_t>(record), numbers);
    EXPECT_EQ(as<std::int64_t>(record), cast<std::int64_t>(numbers));
    EXPECT_EQ(as<double>(record), cast<double>(numbers));
    EXPECT_EQ(as<float>(record), padded<float>({2147483648.0F, -2147483648.0F, 16777216.0F}));
}

TEST_P(StoredNumbers, ConvertsLongsToEveryType) {
    const auto numbers = padded<std::int64_t>({1LL << 62, -(1LL << 40), 46186158000});
    const Record& record = store('l', numbers);

    EXPECT_EQ(as<std::int64_t>(record), numbers);
    EXPECT_EQ(as<std::int32_t>(record),
              padded<std::int32_t>({std::numeric_limits<std::int32_t>::max(), std::numeric_limits<std::int32_t>::min(),
                                    std::numeric_limits<std::int32_t>::max()}));
    EXPECT_EQ(as<double>(record), padded<double>({4611686018427387904.0, -1099511627776.0, 46186158000.0}));
    EXPECT_EQ(as<float>(record), padded<float>({4611686018427387904.0F, -1099511627776.0F, 46186158000.0F}));
}

TEST_P(StoredNumbers, KeepsTheBitsOfFloats) {
    const std::vector<std::uint32_t> bits = {0x0D050D05, 0x7FA00001, 0xFFC12345, 0x80000000, 0x00000001, 0x3F800000,
                                             0,          0,          0,          0,          0,          0,
                                             0,          0,          0,          0,          0,          0xFFFFFFFF};
    const Record& record = store('f', bits);

    std::vector<std::uint32_t> read(bits.size());
    ASSERT_TRUE(record.readFloatBits(std::span(read)));

    EXPECT_EQ(read, bits);
}

TEST_P(StoredNumbers, RoundsDoublesToFloatsForTheirBits) {
    const Record& record = store('d', padded<double>({0.1, -1.0}));

    std::vector<std::uint32_t> bits(2);
    ASSERT_TRUE(record.readFloatBits(std::span(bits)));

    EXPECT_EQ(bits, (std::vector<std::uint32_t>{0x3DCCCCCD, 0xBF800000}));
}

TEST_P(StoredNumbers, ReadsNaNAsZeroIntoWholeNumbers) {
    const Record& record = store('d', padded<double>({std::nan(""), HUGE_VAL}));

    EXPECT_EQ(as<std::int32_t>(record), padded<std::int32_t>({0, std::numeric_limits<std::int32_t>::max()}));
    EXPECT_TRUE(std::isnan(as<double>(record)[0]));
}

TEST_P(StoredNumbers, ReadsTheFirstOfManyNumbers) {
    const Record& record = store('d', padded<double>({5, 6, 7}));

    std::vector<double> two(2);
    ASSERT_TRUE(record.readNumbers(std::span(two)));
    std::vector<std::int32_t> one(1);
    ASSERT_TRUE(record.readNumbers(std::span(one)));
    ASSERT_TRUE(record.readNumbers(std::span<double>()));

    EXPECT_EQ(two, (std::vector<double>{5, 6}));
    EXPECT_EQ(one, std::vector<std::int32_t>{5});
}

TEST_P(StoredNumbers, FillsWithZerosWhenMoreAreRequestedThanThereAre) {
    const Record& record = store('i', padded<std::int32_t>({5}));

    std::vector<double> numbers(record.numberCount() + 1, 77.0);
    EXPECT_FALSE(record.readNumbers(std::span(numbers)));

    EXPECT_EQ(numbers, std::vector<double>(numbers.size(), 0.0));
}

TEST(NumberDecoding, InflatesLargeArraysInPlace) {
    std::vector<std::int32_t> numbers(100'000);
    for (std::size_t i = 0; i < numbers.size(); ++i)
        numbers[i] = static_cast<std::int32_t>(i * 2654435761U % 1000003);
    BinaryRecordBuilder file(7500);
    const ExactBytes bytes(file.begin("List").compressedArray('i', numbers).end().finish());
    FbxStatus status;
    const auto tree = readRecords(bytes.span(), "test.fbx", status);
    ASSERT_TRUE(tree);

    std::vector<double> wide(numbers.size());
    ASSERT_TRUE(tree->root.firstChild->readNumbers(std::span(wide)));
    std::vector<std::int64_t> longs(numbers.size());
    ASSERT_TRUE(tree->root.firstChild->readNumbers(std::span(longs)));

    EXPECT_EQ(wide, cast<double>(numbers));
    EXPECT_EQ(longs, cast<std::int64_t>(numbers));
}

TEST(NumberDecoding, InflatesStreamsOfEveryLevel) {
    const std::vector<double> numbers = padded<double>({1.5, -2.5});
    for (const int level : {0, 1, 6, 9, 12}) {
        BinaryRecordBuilder file(7500);
        const std::string stream = BinaryRecordBuilder::deflated(file.encode(numbers), level);
        const std::string bytes = file.begin("List").arrayOf('d', numbers.size(), 1, stream).end().finish();

        EXPECT_EQ(readText(bytes).substr(0, 16), "List: [1.5 -2.5 ") << level;
    }
}

TEST(NumberDecoding, NoticesCorruptStreams) {
    const std::vector<double> numbers = padded<double>({1.5, -2.5});
    const std::string good = BinaryRecordBuilder::deflated(BinaryRecordBuilder(7500).encode(numbers));
    for (std::size_t i = 0; i < good.size(); ++i) {
        std::string bad = good;
        bad[i] = static_cast<char>(bad[i] ^ 0x55);
        const ExactBytes bytes(
            BinaryRecordBuilder(7500).begin("List").arrayOf('d', numbers.size(), 1, bad).end().finish());
        FbxStatus status;
        const auto tree = readRecords(bytes.span(), "test.fbx", status);
        ASSERT_TRUE(tree);

        std::vector<double> read(numbers.size(), 77.0);
        ASSERT_FALSE(tree->root.firstChild->readNumbers(std::span(read))) << "byte " << i;

        EXPECT_EQ(read, std::vector<double>(numbers.size(), 0.0));
    }
}

TEST(NumberDecoding, NoticesStreamsOfAnotherLength) {
    const std::vector<double> numbers = padded<double>({1.5});
    BinaryRecordBuilder encoder(7500);
    const std::string stream = BinaryRecordBuilder::deflated(encoder.encode(numbers));
    for (const std::size_t count : {std::size_t{1}, numbers.size() - 1, numbers.size() + 1}) {
        const ExactBytes bytes(BinaryRecordBuilder(7500).begin("List").arrayOf('d', count, 1, stream).end().finish());
        FbxStatus status;
        const auto tree = readRecords(bytes.span(), "test.fbx", status);
        ASSERT_TRUE(tree);

        std::vector<double> read(count, 77.0);
        EXPECT_EQ(tree->root.firstChild->numberCount(), count);
        EXPECT_FALSE(tree->root.firstChild->readNumbers(std::span(read)));
        EXPECT_EQ(read, std::vector<double>(count, 0.0));
    }
}

std::vector<std::int64_t> textAsLongs(const std::string& list) {
    const ExactBytes bytes("; FBX 7.5.0\nA: *99 { a: " + list + " }");
    FbxStatus status;
    const auto tree = readRecords(bytes.span(), "test.fbx", status);
    std::vector<std::int64_t> numbers(tree->root.firstChild->numberCount());
    EXPECT_TRUE(tree->root.firstChild->readNumbers(std::span(numbers)));
    return numbers;
}

TEST(NumberDecoding, ReadsTextAsWholeNumbersWithoutLosingDigits) {
    EXPECT_EQ(textAsLongs("9223372036854775807,-9223372036854775808,+7,007"),
              (std::vector<std::int64_t>{std::numeric_limits<std::int64_t>::max(),
                                         std::numeric_limits<std::int64_t>::min(), 7, 7}));
}

TEST(NumberDecoding, TruncatesAndSaturatesTextInWholeNumbers) {
    EXPECT_EQ(textAsLongs("1.9,-1.9,1e3,1e30,-1e30,nan,-inf,99999999999999999999"),
              (std::vector<std::int64_t>{
                  1, -1, 1000, std::numeric_limits<std::int64_t>::max(), std::numeric_limits<std::int64_t>::min(), 0,
                  std::numeric_limits<std::int64_t>::min(), std::numeric_limits<std::int64_t>::max()}));
}

TEST(NumberDecoding, ReadsNegativeZeroIntoReals) {
    const ExactBytes bytes("; FBX 7.5.0\nA: *1 { a: -0 }\nB: -0");
    FbxStatus status;
    const auto tree = readRecords(bytes.span(), "test.fbx", status);
    ASSERT_TRUE(tree);

    for (const char* const name : {"A", "B"}) {
        double number = 1;
        float narrow = 1;
        ASSERT_TRUE(tree->root.child(name)->readNumbers(std::span(&number, 1)));
        ASSERT_TRUE(tree->root.child(name)->readNumbers(std::span(&narrow, 1)));
        EXPECT_TRUE(number == 0 && std::signbit(number)) << name;
        EXPECT_TRUE(narrow == 0 && std::signbit(narrow)) << name;
    }
}

TEST(NumberDecoding, ReadsScalarsBetweenTexts) {
    const ExactBytes bytes("; FBX 7.5.0\nP: \"Lcl\", \"\", \"A\",1,-2.5,T,3");
    FbxStatus status;
    const auto tree = readRecords(bytes.span(), "test.fbx", status);
    ASSERT_TRUE(tree);

    std::vector<std::int32_t> numbers(tree->root.firstChild->numberCount());
    ASSERT_TRUE(tree->root.firstChild->readNumbers(std::span(numbers)));

    EXPECT_EQ(numbers, (std::vector<std::int32_t>{1, -2, 3}));
}

TEST(NumberConversion, TruncatesTowardZeroAndSaturates) {
    constexpr auto kMax = std::numeric_limits<std::int64_t>::max();
    constexpr auto kMin = std::numeric_limits<std::int64_t>::min();
    EXPECT_EQ(truncateTo<std::int64_t>(9223372036854775807.0), kMax);
    EXPECT_EQ(truncateTo<std::int64_t>(9223372036854774784.0), 9223372036854774784);
    EXPECT_EQ(truncateTo<std::int64_t>(-9223372036854775808.0), kMin);
    EXPECT_EQ(truncateTo<std::int64_t>(-HUGE_VAL), kMin);
    EXPECT_EQ(truncateTo<std::int32_t>(2147483647.9), 2147483647);
    EXPECT_EQ(truncateTo<std::int32_t>(2147483648.0), 2147483647);
    EXPECT_EQ(truncateTo<std::int32_t>(-2147483648.9), -2147483647 - 1);
    EXPECT_EQ(truncateTo<std::int32_t>(std::nan("")), 0);
    EXPECT_EQ(truncateTo<std::int32_t>(-0.9), 0);
}

} // namespace
