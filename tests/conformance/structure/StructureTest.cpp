// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The comparison itself: what it reports, and what it accepts.
#include "Structure.h"

#include "Explanations.h"

#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>

#include <unistd.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using conformance::deviations;
using conformance::Explanations;
using conformance::Structure;
using testing::ElementsAre;
using testing::IsEmpty;

Structure structureOf(std::initializer_list<std::string_view> files) {
    Structure structure;
    int number = 0;
    for (const std::string_view text : files) {
        fbxsdk::FbxStatus status;
        const std::string file = "; FBX 6.1.0 project file\n" + std::string(text);
        const auto tree = fbxsdk::detail::readRecords(std::span(file.data(), file.size()), "text", status);
        EXPECT_TRUE(tree) << status.GetErrorString();
        if (tree)
            structure.add("file" + std::to_string(number++), *tree);
    }
    return structure;
}

std::vector<std::string> between(std::string_view ours, std::string_view theirs) {
    return deviations(structureOf({ours}), structureOf({theirs, theirs}));
}

TEST(Structure, FindsNothingBetweenEqualFiles) {
    constexpr std::string_view kFile = "Takes: { Current: \"a\" \n Take: \"a\" { FileName: \"b\" } }";
    EXPECT_THAT(between(kFile, kFile), IsEmpty());
}

TEST(Structure, ReportsARecordThatTheOthersDoNotWrite) {
    EXPECT_THAT(between("A: { B: 1\n C: 2 }", "A: { B: 1 }"), ElementsAre("nowhere else: A/C"));
}

TEST(Structure, SeesARecordThatIsMissing) {
    EXPECT_THAT(between("A: { B: 1 }", "A: { B: 1\n C: 2 }"), ElementsAre("never written: A/C"));
}

TEST(Structure, SeesARecordThatIsMissingOnce) {
    EXPECT_THAT(between("A: { B: 1 }\nA: { B: 2\n C: 2 }", "A: { B: 1\n C: 2 }"),
                ElementsAre("not always written: A/C"));
}

TEST(Structure, DoesNotMissWhatOneFileOfTheirsHasNot) {
    EXPECT_THAT(deviations(structureOf({"A: { B: 1 }"}), structureOf({"A: { B: 1\n C: 2 }", "A: { B: 1 }"})),
                IsEmpty());
}

TEST(Structure, SeesAnotherOrder) {
    EXPECT_THAT(between("A: { C: 1\n B: 2 }", "A: { B: 1\n C: 2 }"), ElementsAre("out of order: A: 'C' before 'B'"));
}

TEST(Structure, SeesATextInPlaceOfANumber) {
    EXPECT_THAT(between("A: { B: \"1\" }", "A: { B: 1 }"), ElementsAre("stored otherwise: A/B as 'S', not 'n'"));
}

TEST(Structure, SeesTheNumberOfValues) {
    EXPECT_THAT(between("A: { B: 1,2,3 }", "A: { B: 1,2 }"), ElementsAre("stored otherwise: A/B as 'nnn', not 'nn'"));
}

TEST(Structure, TakesListsOfDifferentLengthsForEqual) {
    EXPECT_THAT(between("A: { B: 1,2,3,4,5,6,7\n B: 1 }", "A: { B: 1,2\n B: 1,2,3,4,5,6,7,8 }"), IsEmpty());
}

TEST(Structure, SeesInAListWhatDoesNotFollowElsewhere) {
    EXPECT_THAT(between("A: { B: 1,2,L,1,2,L\n B: 1,L,L }", "A: { B: 1,2,L\n B: 1,2,L,1,2,L }"),
                ElementsAre("stored otherwise: A/B as 'CC', not 'Cn'"));
}

TEST(Structure, KeepsClassesOfObjectsApart) {
    EXPECT_THAT(
        between("Objects: { Model: \"Model::a\", \"Null\" { V: 1 }\n Model: \"Model::b\", \"Mesh\" { V: 1 } }",
                "Objects: { Model: \"Model::a\", \"Null\" { V: 1 }\n Model: \"Model::b\", \"Mesh\" { V: \"x\" } }"),
        ElementsAre("stored otherwise: Objects/Model Mesh/V as 'n', not 'S'"));
}

TEST(Structure, SeesATypeThatAPropertyStates) {
    EXPECT_THAT(between("A: { Property: \"p\", \"double\", \"\",1 }", "A: { Property: \"p\", \"Number\", \"\",1 }"),
                ElementsAre("stored otherwise: A/Property p as 'double,SSSn', not 'Number,SSSn'"));
}

TEST(Structure, LooksAtNoPropertyOfAUser) {
    EXPECT_THAT(between("A: { Property: \"p\", \"double\", \"U\",1 }", "A: { }"), IsEmpty());
}

class ExplanationsFile : public testing::Test {
protected:
    ExplanationsFile() : mPath(std::filesystem::temp_directory_path() / ("explained" + std::to_string(getpid()))) {}
    ~ExplanationsFile() override { std::filesystem::remove(mPath); }
    Explanations read(const std::string& text, const std::string& form = "X:ascii") const {
        std::ofstream(mPath) << text;
        return {mPath, form};
    }

private:
    std::filesystem::path mPath;
};

TEST_F(ExplanationsFile, ExplainsWhatAPatternSays) {
    Explanations table = read(R"([{"reason": "r", "forms": ["X:ascii"], "deviations": ["a: * b", "c"]}])");
    EXPECT_TRUE(table.explain("a: anything at all b"));
    EXPECT_FALSE(table.explain("a: anything at all b."));
    EXPECT_FALSE(table.explain("cc"));
    EXPECT_THAT(table.unused(), ElementsAre("c"));
}

TEST_F(ExplanationsFile, HoldsForTheFormsThatAreNamedOnly) {
    Explanations table = read(R"([{"reason": "r", "forms": ["X:ascii"], "deviations": ["a"]}])", "X:binary");
    EXPECT_FALSE(table.explain("a"));
    EXPECT_THAT(table.unused(), IsEmpty());
}

TEST_F(ExplanationsFile, IsRefusedWithoutAReason) {
    EXPECT_THROW(read(R"([{"reason": "", "forms": [], "deviations": []}])"), std::runtime_error);
}

} // namespace
