// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Versions, generations and time units.
#include "DocumentFromText.h"

#include "document/FileTicks.h"

namespace fbxsdk::detail {
namespace {

/// A tree as the binary reader creates it, without any record but those that the test adds.
std::unique_ptr<RecordTree> binaryTree(std::uint32_t version) {
    auto tree = std::make_unique<RecordTree>();
    tree->version = version;
    tree->fileName = "binary.fbx";
    return tree;
}

void addHeader(RecordTree& tree, std::int64_t version) {
    Record& header = tree.newRecord("FBXHeaderExtension");
    Record& line = tree.newRecord("FBXVersion");
    const std::span<Value> values = tree.newValues(1);
    values[0] = Value::ofInteger(version);
    line.values = values;
    header.firstChild = &line;
    header.nextSibling = tree.root.firstChild;
    tree.root.firstChild = &header;
}

TEST(ReadDocument, ReadsAFileFromDisk) {
    FbxStatus status;
    const auto document = readDocument(TARNELL_TEST_DATA "/document/two_nulls_7400_ascii.fbx", status);
    ASSERT_NE(document, nullptr) << status.GetErrorString();
    EXPECT_EQ(document->version, 7400U);
    EXPECT_EQ(sourceNames(*document, 0, "Model"), Names{"upper"});
    EXPECT_EQ(sourceNames(*document, idOf(*document, "Model", "upper"), "Model"), Names{"lower"});
}

TEST(ReadDocument, FailsForAFileThatIsNotThere) {
    FbxStatus status;
    EXPECT_EQ(readDocument(TARNELL_TEST_DATA "/document/not_there.fbx", status), nullptr);
    EXPECT_TRUE(status.Error());
    EXPECT_NE(std::string(status.GetErrorString()).find("not_there.fbx"), std::string::npos);
}

TEST(ReadDocument, TheCommentOverrulesTheVersionRecord) {
    const auto document = documentOf("7.3.0", "FBXHeaderExtension: { FBXVersion: 7700 }");
    EXPECT_EQ(document->version, 7300U);
}

TEST(ReadDocument, TakesTheVersionRecordWhenThereIsNoComment) {
    const auto document = tryDocument("FBXHeaderExtension: { FBXVersion: 6100 }\nObjects: { }");
    ASSERT_NE(document, nullptr);
    EXPECT_EQ(document->version, 6100U);
}

TEST(ReadDocument, GuessesTheGenerationOfAFileWithoutAnyVersion) {
    const auto numbered = tryDocument(R"(FBXHeaderExtension: { }
        Objects: { Model: 4, "Model::a", "Null" { } })");
    ASSERT_NE(numbered, nullptr);
    EXPECT_EQ(numbered->version, 7000U);
    EXPECT_NE(numbered->find(4), nullptr);

    const auto named = tryDocument(R"(FBXHeaderExtension: { }
        Objects: { Model: "Model::a", "Null" { } })");
    ASSERT_NE(named, nullptr);
    EXPECT_EQ(named->version, 6100U);
    EXPECT_NE(objectNamed(*named, "Model", "a"), nullptr);

    const auto old = tryDocument("FBXHeaderExtension: { }\nModel: \"Model::a\" { }");
    ASSERT_NE(old, nullptr);
    EXPECT_EQ(old->version, 5000U);
    EXPECT_NE(objectNamed(*old, "Model", "a"), nullptr);
}

TEST(ReadDocument, RefusesVersionsOutsideTheSupportedRange) {
    for (const char* version : {"2.0.0", "8.0.0", "9.9.9"}) {
        FbxStatus status;
        EXPECT_EQ(tryDocument(std::string("; FBX ") + version + " project file\nObjects: { }", &status), nullptr);
        EXPECT_EQ(status.GetCode(), FbxStatus::eInvalidFileVersion);
    }
}

TEST(ReadDocument, NamesFileAndVersionWhenItRefuses) {
    FbxStatus status;
    EXPECT_EQ(tryDocument("FBXHeaderExtension: { FBXVersion: 8000 }", &status), nullptr);
    EXPECT_STREQ(status.GetErrorString(),
                 "test.fbx: file version 8000 is not supported; supported versions are 3000 to 7999");
}

TEST(ReadDocument, TakesTheDocumentsVersionFromAnOldBinary) {
    FbxStatus status;
    auto tree = binaryTree(3000);
    addHeader(*tree, 5800);
    const auto document = readDocument(std::move(tree), status);
    ASSERT_NE(document, nullptr);
    EXPECT_EQ(document->version, 5800U);
}

TEST(ReadDocument, AnOldBinaryWithoutVersionRecordIsOfVersion3000) {
    FbxStatus status;
    const auto document = readDocument(binaryTree(3000), status);
    ASSERT_NE(document, nullptr);
    EXPECT_EQ(document->version, 3000U);
}

TEST(ReadDocument, ABinaryHeaderOverrulesTheVersionRecord) {
    FbxStatus status;
    auto tree = binaryTree(7400);
    addHeader(*tree, 7700);
    const auto document = readDocument(std::move(tree), status);
    ASSERT_NE(document, nullptr);
    EXPECT_EQ(document->version, 7400U);
}

TEST(ReadDocument, RefusesAnAbsurdVersionRecord) {
    FbxStatus status;
    auto tree = binaryTree(3000);
    addHeader(*tree, 123456789012);
    const auto document = readDocument(std::move(tree), status); // not a version at all, so none is stated
    ASSERT_NE(document, nullptr);
    EXPECT_EQ(document->version, 3000U);
}

TEST(ReadDocument, ReadsByTheObjectsWhenAllOfThemContradictTheVersion) {
    const auto named = documentOf("7.4.0", R"(Objects: { Model: "Model::a", "Null" { } })");
    EXPECT_NE(objectNamed(*named, "Model", "a"), nullptr);
    const auto numbered = documentOf("6.1.0", R"(Objects: { Model: 3, "Model::a", "Null" { } })");
    EXPECT_NE(numbered->find(3), nullptr);
}

std::string withTimeUnit(int headerVersion, const std::string& definition) {
    return "FBXHeaderExtension: { FBXHeaderVersion: " + std::to_string(headerVersion) + "\nOtherFlags: { " +
           definition +
           R"( } }
        GlobalSettings: { Properties70: { P: "TimeSpanStop", "KTime", "Time", "",141120000
                                          P: "UnitScaleFactor", "double", "Number", "",141120000 } }
        Objects: { AnimationStack: 1, "AnimStack::t", "" { }
                   AnimationCurve: 2, "AnimCurve::", "" { KeyTime: *2 { a: 0,282240000 }
                       KeyValueFloat: *2 { a: 0,1 } } }
        Takes: { Take: "t" { LocalTime: -141120000,70560000 } })";
}

TEST(ReadDocument, ConvertsAllTimesOfTheShortUnit) {
    const auto document = documentOf("7.7.0", withTimeUnit(1004, "TCDefinition: 64"));
    EXPECT_EQ(settingNamed(*document, "TimeSpanStop")->values[0].toInteger(), kTicksPerSecond);
    EXPECT_EQ(document->takes.at(0).localStart, -kTicksPerSecond);
    EXPECT_EQ(document->takes.at(0).localStop, kTicksPerSecond / 2);
    EXPECT_EQ(document->find(1)->property("LocalStop")->values[0].toInteger(), kTicksPerSecond / 2);
    EXPECT_EQ(readCurve(*document, *document->find(2)).times, (std::vector<std::int64_t>{0, 2 * kTicksPerSecond}));
}

TEST(ReadDocument, ConvertsNothingButTimes) {
    const auto document = documentOf("7.7.0", withTimeUnit(1004, "TCDefinition: 64"));
    EXPECT_EQ(numbersOf(settingNamed(*document, "UnitScaleFactor")), (Numbers{141120000}));
}

TEST(ReadDocument, KeepsTheUsualUnitForDefinition127OldHeadersAndNoDefinition) {
    for (const auto& text :
         {withTimeUnit(1004, "TCDefinition: 127"), withTimeUnit(1003, "TCDefinition: 64"), withTimeUnit(1004, "")}) {
        const auto document = documentOf("7.7.0", text);
        EXPECT_EQ(document->fileTicksPerSecond, kTicksPerSecond);
        EXPECT_EQ(document->takes.at(0).localStop, 70560000);
    }
}

TEST(FileTicks, RoundsToTheNearestTick) {
    EXPECT_EQ(rescaledTicks(1, kShortTicksPerSecond), 327); // 327.28…
    EXPECT_EQ(rescaledTicks(2, kShortTicksPerSecond), 655); // 654.57…
    EXPECT_EQ(rescaledTicks(-1, kShortTicksPerSecond), -327);
    EXPECT_EQ(rescaledTicks(-2, kShortTicksPerSecond), -655);
    EXPECT_EQ(rescaledTicks(0, kShortTicksPerSecond), 0);
}

TEST(FileTicks, SaturatesInsteadOfOverflowing) {
    EXPECT_EQ(rescaledTicks(INT64_MAX, kShortTicksPerSecond), INT64_MAX);
    EXPECT_EQ(rescaledTicks(INT64_MIN, kShortTicksPerSecond), INT64_MIN);
}

} // namespace
} // namespace fbxsdk::detail
