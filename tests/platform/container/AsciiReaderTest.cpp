// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// ASCII files: the grammar and the deviations of real writers from it.
#include "container/AsciiReader.h"

#include <cmath>
#include <limits>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/RecordText.h"

using fbxsdk::FbxStatus;
using fbxsdk::detail::readRecords;
using fbxsdk::detail::Record;
using fbxsdk::detail::RecordTree;

namespace {

std::string asciiText(std::string_view records, std::string_view version = "7.5.0") {
    return readText("; FBX " + std::string(version) + " project file\n" + std::string(records));
}

/// A tree together with the bytes that it points into.
struct ReadFile {
    explicit ReadFile(std::string_view text) : bytes(text), tree(readRecords(bytes.span(), "test.fbx", status)) {}

    ExactBytes bytes;
    FbxStatus status;
    std::unique_ptr<RecordTree> tree;
};

std::vector<double> numbersOf(const Record& record) {
    std::vector<double> numbers(record.numberCount());
    EXPECT_TRUE(record.readNumbers(std::span(numbers)));
    return numbers;
}

std::vector<std::uint32_t> bitsOf(const Record& record) {
    std::vector<std::uint32_t> bits(record.numberCount());
    EXPECT_TRUE(record.readFloatBits(std::span(bits)));
    return bits;
}

TEST(AsciiReader, ReadsRecordsWithValuesAndBlocks) {
    EXPECT_EQ(
        asciiText("Objects:  {\n\tModel: 17, \"Model::Cube\", \"Mesh\" {\n\t\tShading: T\n\t}\n}\nTakes:  {\n}\n"),
        "Objects: { Model: 17, \"Model::Cube\", \"Mesh\" { Shading: 'T' } } Takes: { }");
}

TEST(AsciiReader, StatesTheVersionOfTheFirstComment) {
    for (const auto& [text, version] : {std::pair("; FBX 7.5.0 project file\n", 7500U),
                                        {"; FBX 6.1.0 project file", 6100U},
                                        {";FBX 7.7.0\n", 7700U},
                                        {"\xEF\xBB\xBF; FBX 5.8.0 project file\n", 5800U},
                                        {"; Made by hand\n\n;\n ; FBX 7.1.0\n; FBX 7.4.0\n", 7100U}}) {
        const ReadFile file(text);

        ASSERT_TRUE(file.tree) << file.status.GetErrorString();
        EXPECT_EQ(file.tree->version, version) << text;
        EXPECT_TRUE(file.tree->ascii);
        EXPECT_FALSE(file.tree->bigEndian);
    }
}

TEST(AsciiReader, LeavesTheVersionOpenWhenNoCommentStatesIt) {
    const ReadFile file("; Created by hand\nFBXHeaderExtension:  {\n\tFBXVersion: 6100\n}\n");

    ASSERT_TRUE(file.tree) << file.status.GetErrorString();
    EXPECT_EQ(file.tree->version, 0U);
    EXPECT_EQ(recordsText(file.tree->root), "FBXHeaderExtension: { FBXVersion: 6100 }");
}

TEST(AsciiReader, RefusesUnknownVersions) {
    for (const char* const version : {"8.0.0", "9.9.9", "2.0.0", "0.1.0"}) {
        const ReadFile file("\n; FBX " + std::string(version) + " project file\nObjects: {}\n");

        EXPECT_FALSE(file.tree);
        EXPECT_EQ(file.status.GetCode(), FbxStatus::eInvalidFileVersion);
        EXPECT_TRUE(std::string(file.status.GetErrorString()).starts_with("test.fbx: line 2: unsupported version "));
    }
}

TEST(AsciiReader, SkipsCommentsBetweenAnyTwoTokens) {
    EXPECT_EQ(asciiText("A;\"\n:;{\n1;}\n,;:\n2;\n{;}\nB:;\n};\n; the end"), "A: 1, 2 { B: }");
}

TEST(AsciiReader, KeepsSemicolonsInTexts) {
    EXPECT_EQ(asciiText("A: \"no ; comment\", \"{:,}\""), "A: \"no ; comment\", \"{:,}\"");
}

TEST(AsciiReader, TakesAnyLineEnds) { EXPECT_EQ(asciiText("A: 1\r\nB: 2\r\n{\r\n}\r\nC:\t3"), "A: 1 B: 2 { } C: 3"); }

TEST(AsciiReader, ContinuesAListBehindOrBeforeAComma) {
    EXPECT_EQ(asciiText("A: 1,2,\n3\n             ,4\n,\n5 B: 6"), "A: 1, 2, 3, 4, 5 B: 6");
}

TEST(AsciiReader, IgnoresCommasTooMany) {
    EXPECT_EQ(asciiText("A: , \"x\"\nB: 1,\nC: ,\nD: 1,,2 {\n,E: 3,\n},"), "A: \"x\" B: 1 C: D: 1, 2 { E: 3 }");
}

TEST(AsciiReader, LeavesRecordsWithoutValuesEmpty) {
    EXPECT_EQ(asciiText("Content: \nCameraIndexName: \nLast:"), "Content: CameraIndexName: Last:");
}

TEST(AsciiReader, TakesQuotedNamesAndBlanksBeforeTheColon) {
    EXPECT_EQ(
        asciiText("\"Transport Tool Settings\": {\n Pre-Extrapolation : 1\n\"a&quot;b\" : \"c\"\n}\nX: \"v\" \"N\": 1"),
        "Transport Tool Settings: { Pre-Extrapolation: 1 a\"b: \"c\" } X: \"v\" N: 1");
}

TEST(AsciiReader, EndsTheValuesAtTheNextName) {
    EXPECT_EQ(asciiText("A: T B: U, C: 1, \"x\", \"D\": 2 E: -1 3d: 4"), "A: 'T' B: 'U' C: 1, \"x\" D: 2 E: -1 3d: 4");
}

TEST(AsciiReader, DecodesTheThreeEntitiesAndNoOther) {
    EXPECT_EQ(asciiText("A: \"&quot;&lf;&cr;&amp;&&quot&;&\""), "A: \"\"\n\r&amp;&&quot&;&\"");
}

TEST(AsciiReader, KeepsTextsThatAreNotUtf8) {
    EXPECT_EQ(asciiText("A: \"\xFF\\n\n\", \"\""), "A: \"\xFF\\n\n\", \"\"");
}

TEST(AsciiReader, ReadsLongTexts) {
    const std::string text(100'000, 'x');

    EXPECT_EQ(asciiText("A: \"" + text + "\""), "A: \"" + text + "\"");
}

TEST(AsciiReader, ReadsWholeNumbersOf64Bits) {
    EXPECT_EQ(asciiText("A: 9223372036854775807,-9223372036854775808,+1,007,-1"),
              "A: 9223372036854775807, -9223372036854775808, 1, 7, -1");
}

TEST(AsciiReader, TurnsWholeNumbersBeyond64BitsIntoReals) {
    EXPECT_EQ(asciiText("A: 9223372036854775808,-9223372036854775809"),
              "A: 9223372036854775808.0, -9223372036854775808.0");
}

TEST(AsciiReader, ReadsRealsInEverySpelling) {
    EXPECT_EQ(asciiText("A: 0.5,.5,5.,+.5e+1,1e-008,1E+300,-0"), "A: 0.5, 0.5, 5.0, 5.0, 1e-08, 1e+300, -0.0");
}

TEST(AsciiReader, SaturatesRealsOutOfRange) {
    EXPECT_EQ(asciiText("A: 1e999,-1e999,1e-999,-1e-999,1e99999999999999999999"), "A: inf, -inf, 0.0, -0.0, inf");
}

TEST(AsciiReader, ReadsInfinitiesAndNaNsInEverySpelling) {
    EXPECT_EQ(asciiText("A: inf,-INF,Infinity,+INFINITY,1.#INF,-1.#INF,2.#INF3456"),
              "A: inf, -inf, inf, inf, inf, -inf, inf");
    EXPECT_EQ(asciiText("A: nan,NaN,nan(ind),nan(12345),1.#NAN,1.#IND,1.#QNAN,+0.#NAN0000,1.#SNAN"),
              "A: nan, nan, nan, nan, nan, nan, nan, nan, nan");
}

TEST(AsciiReader, RefusesMalformedNumbers) {
    for (const char* const number : {"1.#NOPE", "1.#INDIE", "1.#", ".#INF", "1#INF", "1.5.5", "1e", "1e+", "--1", "+-1",
                                     "-", "+", ".", "1x", "0x10", "-T", "12-3", "-infty", "1_000"}) {
        const std::string expected = "test.fbx: line 3: expected a number instead of '" + std::string(number) + "'";
        EXPECT_EQ(asciiText("A: 1,\n" + std::string(number)), expected);
        const std::string inArray =
            "test.fbx: line 2: expected a number or '}' instead of '" + std::string(number) + "'";
        EXPECT_EQ(asciiText("A: *2 { a: 1, " + std::string(number) + " }"), inArray);
    }
}

TEST(AsciiReader, KeepsBareWords) {
    EXPECT_EQ(asciiText("Key: 0,-1.5,U,s,0,0,n\nShading: Y\nType: Mesh\nNaming: nano"),
              "Key: 0, -1.5, 'U', 's', 0, 0, 'n' Shading: 'Y' Type: 'Mesh' Naming: 'nano'");
}

TEST(AsciiReader, RefusesAWordThatLostItsQuotes) {
    EXPECT_EQ(asciiText("Children: \"Model::Omni1\", Model"),
              "test.fbx: line 2: expected a quoted string instead of 'Model'");
    EXPECT_EQ(asciiText("P: \"a\", T"), "P: \"a\", 'T'");
}

TEST(AsciiReader, ReadsArraysAndCountsThemItself) {
    EXPECT_EQ(asciiText("A: *3 {\n\ta: 1,2.5,-3\n} \nB: *99 { a: 1 }"), "A: [1 2.5 -3] B: [1]");
    EXPECT_EQ(asciiText("A: *99999999999999999999999 { a: 1 }"), "A: [1]");
}

// "35,5" where 35.5 is meant.
TEST(AsciiReader, RefusesArraysThatHaveMoreThanTheirCount) {
    EXPECT_EQ(asciiText("A: 1\nB: *2 {\n a: 35,5,1,25\n}"),
              "test.fbx: line 4: the list of 'B' holds 4 numbers, but its count is 2");
    EXPECT_EQ(asciiText("C: *0 { a: 1 }"), "test.fbx: line 2: the list of 'C' holds 1 numbers, but its count is 0");
}

TEST(AsciiReader, ReadsLinesThatEndWithACarriageReturnAlone) {
    EXPECT_EQ(readText("; FBX 7.5.0 project file\r; another comment\rA: 1 ; one\rB: *2 { ; two\r a: 1,\r2\r}\rC: 3\r"),
              "A: 1 B: [1 2] C: 3");
    EXPECT_EQ(readText("; FBX 7.5.0 project file\rA: 1\rB: ,,1x\r"),
              "test.fbx: line 3: expected a number instead of '1x'");
}

TEST(AsciiReader, CountsLinesWithBothLineEndsOnce) {
    EXPECT_EQ(asciiText("A: 1\r\nB: 1x\r\n"), "test.fbx: line 3: expected a number instead of '1x'");
}

TEST(AsciiReader, AcceptsZerosAfterTheLastRecord) {
    EXPECT_EQ(asciiText("A: 1\nB: { C: 2 }\n" + std::string(5000, '\0')), "A: 1 B: { C: 2 }");
    EXPECT_EQ(asciiText("A: 1\nB: { C: 2 \n" + std::string(3, '\0')),
              "test.fbx: line 4: the file ends within the block of 'B' that starts in line 3");
}

TEST(AsciiReader, RefusesZerosAnywhereElse) {
    const std::string zeros(3, '\0');
    EXPECT_EQ(asciiText("A: 1\n" + zeros + "Objects: { }"), "test.fbx: line 3: unexpected zero byte");
    EXPECT_EQ(asciiText("A: 1\n" + zeros + "\nObjects: { }"), "test.fbx: line 3: unexpected zero byte");
    EXPECT_EQ(asciiText("A: 1\nObj" + zeros + "ects: { }"), "test.fbx: line 3: unexpected zero byte");
    EXPECT_EQ(asciiText("A: T" + zeros + "\n"), "test.fbx: line 2: unexpected zero byte");
    EXPECT_NE(asciiText("A: 1" + zeros + "2\n").find("line 2"), std::string::npos);
    EXPECT_NE(asciiText("A: *1 { a: 1" + zeros + "2 }\n").find("line 2"), std::string::npos);
    EXPECT_EQ(asciiText("A: \"x" + std::string(1, '\0') + "y\""), "A: \"x" + std::string(1, '\0') + "y\"");
}

TEST(AsciiReader, ReadsEmptyArrays) {
    EXPECT_EQ(asciiText("A: *0 {\n a: \n}\nB: *0 {\n}\nC: *0 {}\nD: *7 { a: ; nothing\n }"), "A: [] B: [] C: [] D: []");
}

TEST(AsciiReader, ReadsArraysWithCommentsAndLooseCommas) {
    EXPECT_EQ(asciiText("A: *6 {\na: , 1, ; one\n2, ; \"two\n\n\n3 ; }\n,4,\n5,,6 ; end\n}"), "A: [1 2 3 4 5 6]");
}

TEST(AsciiReader, ReadsWordsInArraysAsTheCodeOfTheirFirstLetter) {
    EXPECT_EQ(asciiText("A: *9 { a: 1,snan,infty,ind,nan()),nan(,Nan((,T,2 }"), "A: [1 115 105 105 110 110 78 84 2]");
}

TEST(AsciiReader, TakesAnArrayAsOneValueAmongOthers) {
    EXPECT_EQ(asciiText("A: 1, *2 { a: 3,4 }, \"x\" {\n B: *1 { a: 5 } C: 6 }"), "A: 1, [3 4], \"x\" { B: [5] C: 6 }");
}

TEST(AsciiReader, RefusesArraysThatAreNone) {
    EXPECT_EQ(asciiText("A: *"), "test.fbx: line 2: the file ends where a count and '{' is expected");
    EXPECT_EQ(asciiText("A: *x { a: 1 }"), "test.fbx: line 2: expected a count and '{' instead of '{'");
    EXPECT_EQ(asciiText("A: *1 a: 1"), "test.fbx: line 2: expected a count and '{' instead of 'a'");
    EXPECT_EQ(asciiText("A: *1 { b: 1 }"), "test.fbx: line 2: expected 'a:' instead of 'b'");
    EXPECT_EQ(asciiText("A: *1 { a 1 }"), "test.fbx: line 2: expected 'a:' instead of 'a'");
    EXPECT_EQ(asciiText("A: *1 { a: \"x\" }"), "test.fbx: line 2: expected a number or '}' instead of '\"'");
    EXPECT_EQ(asciiText("A: *1 { a: 1 a: 2 }"), "test.fbx: line 2: expected a number or '}' instead of 'a'");
    EXPECT_EQ(asciiText("A: *2 { a: 1,"), "test.fbx: line 2: the file ends where a number or '}' is expected");
    EXPECT_EQ(asciiText("A: *1 { a: *1 { a: 1 } }"), "test.fbx: line 2: expected a number or '}' instead of '*1'");
}

TEST(AsciiReader, TurnsALongListIntoAnArray) {
    const ReadFile file(
        "; FBX 6.1.0\nVertices: 0,1,2,3,4,5,6,7,8 ; comment\n   ,9,10,11,\n12,13,14,15.5,-16e0\nNext: 1\n");

    ASSERT_TRUE(file.tree) << file.status.GetErrorString();
    const Record& list = *file.tree->root.child("Vertices");
    ASSERT_EQ(list.values.size(), 1U);
    EXPECT_EQ(numbersOf(list), (std::vector<double>{0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15.5, -16}));
    EXPECT_EQ(file.tree->root.childValue("Next").toInteger(), 1);
}

TEST(AsciiReader, KeepsTheValuesOfATupleApart) {
    const ReadFile file("; FBX 6.1.0\nMatrix: 0,1,2,3,4,5,6,7,8,9,10,11,12,13,14,15.5\n");

    ASSERT_TRUE(file.tree);
    ASSERT_EQ(file.tree->root.child("Matrix")->values.size(), 16U);
    EXPECT_EQ(file.tree->root.child("Matrix")->value(15).toReal(), 15.5);
}

TEST(AsciiReader, EndsALongListWhereverAListMayEnd) {
    const std::string list = "1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1";
    const std::string array = "[1 1 1 1 1 1 1 1 1 1 1 1 1 1 1 1 1 1]";

    EXPECT_EQ(asciiText("A: " + list), "A: " + array);
    EXPECT_EQ(asciiText("A: " + list + ","), "A: " + array);
    EXPECT_EQ(asciiText("A: " + list + ", {B: 1}"), "A: " + array + " { B: 1 }");
    EXPECT_EQ(asciiText("A: {B: " + list + ",}"), "A: { B: " + array + " }");
    EXPECT_EQ(asciiText("A: " + list + ", B: 2"), "A: " + array + " B: 2");
    EXPECT_EQ(asciiText("A: " + list + " \"B\": 2"), "A: " + array + " B: 2");
    EXPECT_EQ(asciiText("A: " + list + ", 3d: 2"), "A: " + array + " 3d: 2");
    EXPECT_EQ(asciiText("A: " + list + " inf: 2"), "A: " + array + " inf: 2");
}

TEST(AsciiReader, KeepsTheValuesOfAMixedListApart) {
    EXPECT_EQ(asciiText("A: 1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,T,\"x\""),
              "A: 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 'T', \"x\"");
    EXPECT_EQ(asciiText("A: 1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,\n1x"),
              "test.fbx: line 3: expected a number instead of '1x'");
}

TEST(AsciiReader, ReadsBitPatternsOfFloatsFrom7200On) {
    const ReadFile file("; FBX 7.2.0\nKeyAttrDataFloat: *6 { a: 218434821,-1082130432,0.5,4294967295,inf,-0 }\n");

    ASSERT_TRUE(file.tree);
    const Record& record = *file.tree->root.firstChild;
    EXPECT_EQ(bitsOf(record),
              (std::vector<std::uint32_t>{0x0D050D05, 0xBF800000, 0x3F000000, 0xFFFFFFFF, 0x7F800000, 0}));
    const std::vector<double> numbers = numbersOf(record);
    EXPECT_EQ(numbers[1], -1.0);
    EXPECT_EQ(numbers[2], 0.5);
    EXPECT_TRUE(std::isnan(numbers[3]));
}

TEST(AsciiReader, ReadsFloatsAsWrittenBefore7200) {
    const ReadFile file("; FBX 7.1.0\nKeyAttrDataFloat: *3 { a: 4.099946e-31,1,-0.1 }\n");

    ASSERT_TRUE(file.tree);
    EXPECT_EQ(bitsOf(*file.tree->root.firstChild), (std::vector<std::uint32_t>{0x0D050D05, 0x3F800000, 0xBDCCCCCD}));
}

TEST(AsciiReader, ReadsBitPatternsInNoOtherRecord) {
    const ReadFile file("; FBX 7.5.0\nKeyValueFloat: *1 { a: 218434821 }\n");

    ASSERT_TRUE(file.tree);
    EXPECT_EQ(numbersOf(*file.tree->root.firstChild), std::vector<double>{218434821});
}

TEST(AsciiReader, LooksUpTheVersionForBitPatternsInTheHeaderRecord) {
    for (const auto& [version, bits] : {std::pair("7500", 0x40U), {"7100", 0x42800000U}}) {
        const ReadFile file("FBXHeaderExtension: { FBXVersion: " + std::string(version) +
                            " }\nKeyAttrDataFloat: *1 { a: 64 }\n");

        ASSERT_TRUE(file.tree);
        EXPECT_EQ(bitsOf(*file.tree->root.child("KeyAttrDataFloat")), std::vector<std::uint32_t>{bits});
    }
}

TEST(AsciiReader, PlacesRecordsByTheirLine) {
    const ReadFile file("; FBX 7.5.0\n\nA: 1,\n2\nB: {\n\n\"C\": \"x\ny\"\nD:\n}\n");

    ASSERT_TRUE(file.tree);
    const RecordTree& tree = *file.tree;
    EXPECT_EQ(tree.placeOf(*tree.root.child("A")), "line 3");
    EXPECT_EQ(tree.placeOf(*tree.root.child("B")), "line 5");
    EXPECT_EQ(tree.placeOf(*tree.root.child("B")->child("C")), "line 7");
    EXPECT_EQ(tree.placeOf(*tree.root.child("B")->child("D")), "line 9");
}

TEST(AsciiReader, RefusesWhatIsNoRecord) {
    EXPECT_EQ(asciiText("A: 1\n}"), "test.fbx: line 3: expected a name with a colon instead of '}'");
    EXPECT_EQ(asciiText("A: 1 2"), "test.fbx: line 2: expected a name with a colon instead of '2'");
    EXPECT_EQ(asciiText("A: 1\n{ B }"), "test.fbx: line 3: expected a name with a colon instead of 'B'");
    EXPECT_EQ(asciiText("A"), "test.fbx: line 2: expected a name with a colon instead of 'A'");
    EXPECT_EQ(asciiText(": 1"), "test.fbx: line 2: expected a name with a colon instead of ':'");
    EXPECT_EQ(asciiText("{}"), "test.fbx: line 2: expected a name with a colon instead of '{'");
    EXPECT_EQ(asciiText("A: 1, : 2"), "test.fbx: line 2: expected a value instead of ':'");
    EXPECT_EQ(asciiText("A: { } { }"), "test.fbx: line 2: expected a name with a colon instead of '{'");
}

TEST(AsciiReader, RefusesAFileThatEndsWithinAText) {
    EXPECT_EQ(asciiText("A: \"x\nB: 1\n"), "test.fbx: line 2: a string has no closing quote");
    EXPECT_EQ(asciiText("A: 1\n\"B"), "test.fbx: line 3: expected a name with a colon instead of '\"'");
}

TEST(AsciiReader, RefusesAFileThatEndsWithinABlock) {
    EXPECT_EQ(asciiText("A: {\nB: {\n C: 1\n}\n"),
              "test.fbx: line 6: the file ends within the block of 'A' that starts in line 2");
}

TEST(AsciiReader, ShortensLongWordsInItsSentences) {
    EXPECT_EQ(asciiText("A: 1" + std::string(1000, 'x')),
              "test.fbx: line 2: expected a number instead of '1" + std::string(39, 'x') + "'");
}

TEST(AsciiReader, ReadsAFileOfNothingButItsComment) { EXPECT_EQ(readText("; FBX 7.5.0"), ""); }

} // namespace
