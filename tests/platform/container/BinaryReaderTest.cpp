// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Binary files: every value type, both byte orders, both sizes of record heads, and the oddities of real writers.
#include "container/BinaryReader.h"

#include <limits>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/BinaryRecordBuilder.h"
#include "support/RecordText.h"

using fbxsdk::FbxStatus;
using fbxsdk::detail::readRecords;
using fbxsdk::detail::RecordTree;

namespace {

struct Layout {
    std::uint32_t version;
    ByteOrder order;
};

void PrintTo(const Layout& layout, std::ostream* stream) {
    *stream << layout.version << (layout.order == ByteOrder::big ? " big-endian" : " little-endian");
}

class BinaryLayout : public testing::TestWithParam<Layout> {
protected:
    BinaryRecordBuilder file{GetParam().version, GetParam().order};
};

INSTANTIATE_TEST_SUITE_P(EveryLayout, BinaryLayout,
                         testing::Values(Layout{3000, ByteOrder::little}, Layout{6100, ByteOrder::big},
                                         Layout{7400, ByteOrder::little}, Layout{7400, ByteOrder::big},
                                         Layout{7500, ByteOrder::little}, Layout{7700, ByteOrder::big}));

TEST_P(BinaryLayout, StatesVersionAndByteOrder) {
    const ExactBytes bytes(file.finish());
    FbxStatus status;

    const auto tree = readRecords(bytes.span(), "test.fbx", status);

    ASSERT_TRUE(tree) << status.GetErrorString();
    EXPECT_EQ(tree->version, GetParam().version);
    EXPECT_EQ(tree->bigEndian, GetParam().order == ByteOrder::big);
    EXPECT_FALSE(tree->ascii);
    EXPECT_EQ(tree->fileName, "test.fbx");
    EXPECT_EQ(tree->fileSize, bytes.span().size());
    EXPECT_EQ(tree->root.firstChild, nullptr);
}

TEST_P(BinaryLayout, ReadsEveryScalarType) {
    file.begin("Values").letter('T').letter('\1', 'B').uint8(200).int16(-30000).int32(-2000000000);
    file.int64(-9000000000000000000).float32(0.25F).float64(-1e300).text("t\"\n").raw("r").end();

    EXPECT_EQ(readText(file.finish()),
              "Values: 'T', '\1', 200, -30000, -2000000000, -9000000000000000000, 0.25, -1e+300, \"t\"\n\", raw(r)");
}

TEST_P(BinaryLayout, ReadsEveryArrayType) {
    file.begin("i").array<std::int32_t>('i', {1, -2}).end();
    file.begin("l").array<std::int64_t>('l', {1LL << 40, -2}).end();
    file.begin("f").array<float>('f', {0.5F, -2}).end();
    file.begin("d").array<double>('d', {0.1, -2}).end();
    file.begin("b").array<std::uint8_t>('b', {0, 1}).end();
    file.begin("c").array<std::uint8_t>('c', {0, 255}).end();
    file.begin("none").array<double>('d', {}).end();

    EXPECT_EQ(readText(file.finish()),
              "i: [1 -2] l: [1099511627776 -2] f: [0.5 -2] d: [0.1 -2] b: [0 1] c: [0 255] none: []");
}

TEST_P(BinaryLayout, ReadsEveryCompressedArrayType) {
    file.begin("i").compressedArray<std::int32_t>('i', {1, -2}).end();
    file.begin("l").compressedArray<std::int64_t>('l', {1LL << 40, -2}).end();
    file.begin("f").compressedArray<float>('f', {0.5F, -2}).end();
    file.begin("d").compressedArray<double>('d', {0.1, -2}).end();
    file.begin("b").compressedArray<std::uint8_t>('b', {0, 1}).end();
    file.begin("c").compressedArray<std::uint8_t>('c', {0, 255}).end();

    EXPECT_EQ(readText(file.finish()), "i: [1 -2] l: [1099511627776 -2] f: [0.5 -2] d: [0.1 -2] b: [0 1] c: [0 255]");
}

TEST_P(BinaryLayout, KeepsEmptyBlocksApartFromNoBlocks) {
    file.begin("Outer").int32(1).block();
    file.begin("Empty").block().end();
    file.begin("Leaf").end();
    file.end();
    file.begin("Next").end();

    EXPECT_EQ(readText(file.finish()), "Outer: 1 { Empty: { } Leaf: } Next:");
}

TEST_P(BinaryLayout, TakesARecordWhoseEndIsLostForALeaf) {
    file.begin("Outer").block();
    file.begin("Lost").int32(7).loseEnd().end();
    file.begin("Behind").int32(8).end();
    file.end();

    EXPECT_EQ(readText(file.finish()), "Outer: { Lost: 7 Behind: 8 }");
}

TEST_P(BinaryLayout, TurnsALongListOfOneScalarTypeIntoAnArray) {
    std::string expected;
    file.begin("D");
    for (int i = 0; i < 17; ++i) {
        file.float64(i + 0.5);
        expected += (i > 0 ? " " : "") + realText(i + 0.5);
    }
    file.end();
    file.begin("I");
    for (int i = 0; i < 17; ++i)
        file.int32(-i);
    file.end();
    file.begin("L");
    for (int i = 0; i < 17; ++i)
        file.int64(i);
    file.end();
    file.begin("F");
    for (int i = 0; i < 17; ++i)
        file.float32(0.5F);
    file.end();

    EXPECT_EQ(readText(file.finish()), "D: [" + expected +
                                           "] I: [0 -1 -2 -3 -4 -5 -6 -7 -8 -9 -10 -11 -12 -13 -14 -15 -16]"
                                           " L: [0 1 2 3 4 5 6 7 8 9 10 11 12 13 14 15 16]"
                                           " F: [0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5 0.5]");
}

TEST_P(BinaryLayout, KeepsTheValuesOfATupleApart) {
    file.begin("Matrix");
    for (int i = 0; i < 16; ++i)
        file.float64(i + 0.5);
    file.end();
    const ExactBytes bytes(file.finish());
    FbxStatus status;

    const auto tree = readRecords(bytes.span(), "test.fbx", status);

    ASSERT_TRUE(tree);
    const auto& record = *tree->root.firstChild;
    ASSERT_EQ(record.values.size(), 16U);
    EXPECT_EQ(record.value(15).toReal(), 15.5);
    EXPECT_EQ(record.numberCount(), 16U);
}

TEST_P(BinaryLayout, ReadsNumbersFromAListOfMixedTypes) {
    file.begin("Mixed");
    for (int i = 0; i < 20; ++i)
        i % 2 == 0 ? file.float64(i + 0.5) : file.int32(i);
    file.end();
    const ExactBytes bytes(file.finish());
    FbxStatus status;
    const auto tree = readRecords(bytes.span(), "test.fbx", status);
    ASSERT_TRUE(tree);

    std::vector<double> numbers(tree->root.firstChild->numberCount());
    ASSERT_TRUE(tree->root.firstChild->readNumbers(std::span(numbers)));

    ASSERT_EQ(numbers.size(), 20U);
    EXPECT_EQ(numbers[18], 18.5);
    EXPECT_EQ(numbers[19], 19.0);
}

TEST_P(BinaryLayout, KeepsTheLettersOfAKeyList) {
    file.begin("Key");
    for (int i = 0; i < 6; ++i)
        file.int64(i).float64(0.5).letter('L');
    file.end();

    EXPECT_EQ(readText(file.finish()),
              "Key: 0, 0.5, 'L', 1, 0.5, 'L', 2, 0.5, 'L', 3, 0.5, 'L', 4, 0.5, 'L', 5, 0.5, 'L'");
}

TEST_P(BinaryLayout, PlacesRecordsByTheirOffset) {
    file.begin("First").end();
    const std::size_t offset = file.soFar().size();
    file.begin("Second").end();
    const ExactBytes bytes(file.finish());
    FbxStatus status;

    const auto tree = readRecords(bytes.span(), "test.fbx", status);

    ASSERT_TRUE(tree);
    EXPECT_EQ(tree->placeOf(*tree->root.child("First")), "offset 27");
    EXPECT_EQ(tree->placeOf(*tree->root.child("Second")), "offset " + std::to_string(offset));
}

TEST_P(BinaryLayout, IgnoresBytesAfterTheEndOfTheList) {
    file.begin("First").end().nullRecord().bytes("any footer, or a second section");
    file.begin("FileId").end();

    EXPECT_EQ(readText(file.finish()), "First:");
}

TEST(BinaryReader, SkipsBytesAfterTheLastValueOfARecord) {
    BinaryRecordBuilder file(7400);
    file.begin("Padded").int32(1).bytes("padding").end();
    file.begin("Next").int32(2).end();

    EXPECT_EQ(readText(file.finish()), "Padded: 1 Next: 2");
}

TEST(BinaryReader, SkipsBytesAfterTheNullRecordOfABlock) {
    BinaryRecordBuilder file(7400);
    file.begin("Outer").block().nullRecord().bytes("rest").end();
    file.begin("Next").int32(2).end();

    EXPECT_EQ(readText(file.finish()), "Outer: { } Next: 2");
}

TEST(BinaryReader, AcceptsABlockThatEndsWithoutANullRecord) {
    BinaryRecordBuilder file(7400);
    file.begin("Outer").block();
    file.begin("Inner").int32(1).end();
    file.end();
    file.begin("Next").int32(2).end();
    std::string bytes = file.finish();
    // The null record is 13 zeros before the next record; remove it, and subtract 13 from all ends after it.
    const std::size_t next = bytes.find("Next") - 13;
    bytes.erase(next - 13, 13);
    bytes[27] = static_cast<char>(bytes[27] - 13);
    bytes[next - 13] = static_cast<char>(bytes[next - 13] - 13);

    EXPECT_EQ(readText(bytes), "Outer: { Inner: 1 } Next: 2");
}

TEST(BinaryReader, ToleratesAnUnusualByteAfterTheMagic) {
    std::string bytes = BinaryRecordBuilder(7400).begin("Objects").end().finish();
    bytes[20] = '\x80';

    EXPECT_EQ(readText(bytes), "Objects:");
}

TEST(BinaryReader, KeepsNamesAndTextsAsTheyAre) {
    BinaryRecordBuilder file(7400);
    file.begin("").text(std::string_view("Cube\0\1Model", 11)).text("\xFF\xFE").text("").raw("").end();

    EXPECT_EQ(readText(file.finish()), std::string(": \"Cube\0\1Model\", \"\xFF\xFE\", \"\", raw()", 32));
}

TEST(BinaryReader, ReadsALongNameAndManyRecords) {
    BinaryRecordBuilder file(7500);
    const std::string name(255, 'n');
    for (int i = 0; i < 1000; ++i)
        file.begin(name).int32(i).end();
    const ExactBytes bytes(file.finish());
    FbxStatus status;

    const auto tree = readRecords(bytes.span(), "test.fbx", status);

    ASSERT_TRUE(tree);
    int count = 0;
    for (const auto& record : tree->root.children()) {
        EXPECT_EQ(record.name, name);
        EXPECT_EQ(record.value(0).toInteger(-1), count);
        ++count;
    }
    EXPECT_EQ(count, 1000);
}

TEST(BinaryReader, RefusesUnknownVersions) {
    for (const std::uint32_t version : {0U, 2000U, 2999U, 8000U, std::numeric_limits<std::uint32_t>::max()}) {
        const ExactBytes bytes(BinaryRecordBuilder(version).begin("Objects").end().finish());
        FbxStatus status;

        EXPECT_FALSE(readRecords(bytes.span(), "test.fbx", status));
        EXPECT_EQ(status.GetCode(), FbxStatus::eInvalidFileVersion);
        EXPECT_EQ(status.GetErrorString(), "test.fbx: offset 23: unsupported version " + std::to_string(version));
    }
}

TEST(BinaryReader, AcceptsUnknownVersionsBetweenKnownOnes) {
    for (const std::uint32_t version : {3000U, 4050U, 7499U, 7501U, 7999U})
        EXPECT_EQ(readText(BinaryRecordBuilder(version).begin("Objects").int32(1).end().finish()), "Objects: 1");
}

} // namespace
