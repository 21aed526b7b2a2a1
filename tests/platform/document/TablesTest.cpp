// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Property names, comparison of records, and the limit of warnings.
#include "DocumentFromText.h"

#include "document/DocumentBuilder.h"
#include "document/PropertyNames.h"
#include "document/SameRecords.h"
#include "schema/PropertyTypes.h"

namespace fbxsdk::detail {
namespace {

TEST(PropertyNames, KnowsTheModelsProperties) {
    EXPECT_TRUE(isModelProperty("AxisLen"));
    EXPECT_TRUE(isModelProperty("Lcl Rotation"));
    EXPECT_TRUE(isModelProperty("Visibility Inheritance"));
    EXPECT_FALSE(isModelProperty("Color"));
    EXPECT_FALSE(isModelProperty("lcl rotation"));
    EXPECT_FALSE(isModelProperty(""));
}

TEST(PropertyNames, RenamesByClassOnly) {
    EXPECT_EQ(modernPropertyName("Light", "HotSpot"), "InnerAngle");
    EXPECT_EQ(modernPropertyName("FbxLight", "ConeAngle"), "OuterAngle");
    EXPECT_EQ(modernPropertyName("Camera", "HotSpot"), "HotSpot");
    EXPECT_EQ(modernPropertyName("Camera", "KeepRatio"), "BackPlateKeepRatio");
    EXPECT_EQ(modernPropertyName("Light", "Color"), "Color");
}

TEST(PropertyNames, GivesOldTypesTheirSubType) {
    EXPECT_EQ(subTypeOf("double"), "Number");
    EXPECT_EQ(subTypeOf("Vector3D"), "Vector");
    EXPECT_EQ(subTypeOf("KTime"), "Time");
    EXPECT_EQ(subTypeOf("Number"), "");
}

TEST(PropertyNames, StripsTheAttributesFlag) {
    RecordTree tree;
    EXPECT_EQ(attributeFlags(tree, "N"), "");
    EXPECT_EQ(attributeFlags(tree, "A+N"), "A+");
    EXPECT_EQ(attributeFlags(tree, "A+L4NM1"), "A+L4M1");
    EXPECT_EQ(attributeFlags(tree, "AU"), "AU");
}

bool same(const std::string& first, const std::string& second) {
    FbxStatus status;
    const std::string text = "; FBX 7.5.0 project file\na: { " + first + " }\nb: { " + second + " }";
    const auto tree = readRecords(std::span(text.data(), text.size()), "test.fbx", status);
    EXPECT_NE(tree, nullptr) << status.GetErrorString();
    return tree && sameRecords(*tree->root.child("a"), *tree->root.child("b"));
}

TEST(SameRecords, ComparesValuesAndBlocks) {
    EXPECT_TRUE(same("", ""));
    EXPECT_TRUE(same("x: 1, \"t\" { y: 2.5 }", "x: 1, \"t\" { y: 2.5 }"));
    EXPECT_FALSE(same("x: 1", "x: 2"));
    EXPECT_FALSE(same("x: 1", "y: 1"));
    EXPECT_FALSE(same("x: \"1\"", "x: 1"));
    EXPECT_FALSE(same("x: 1, 2", "x: 1"));
    EXPECT_FALSE(same("x: { y: 1 }", "x: { }"));
    EXPECT_FALSE(same("x: { }", "x: { y: 1 }"));
    EXPECT_FALSE(same("x: { y: 1\nz: 1 }", "x: { z: 1\ny: 1 }"));
}

TEST(SameRecords, ComparesArrays) {
    EXPECT_TRUE(same("x: *3 { a: 1,2,3 }", "x: *3 { a: 1,2,3 }"));
    EXPECT_FALSE(same("x: *3 { a: 1,2,3 }", "x: *3 { a: 1,2,4 }"));
    EXPECT_FALSE(same("x: *3 { a: 1,2,3 }", "x: *2 { a: 1,2 }"));
}

TEST(SameRecords, NotANumberEqualsItself) { EXPECT_TRUE(same("x: nan", "x: nan")); }

TEST(Warnings, AreBounded) {
    DocumentBuilder builder(std::make_unique<RecordTree>(), 7500);
    for (int i = 0; i < 1000; ++i)
        builder.warn("a sentence");
    ASSERT_EQ(builder.document().warnings.size(), 101U);
    EXPECT_EQ(builder.document().warnings.back(), "900 more warnings are not listed");
}

TEST(Warnings, QuoteLongNamesInPart) {
    EXPECT_EQ(quotedName("ab"), "\"ab\"");
    EXPECT_LT(quotedName(std::string(100000, 'x')).size(), 120U);
}

} // namespace
} // namespace fbxsdk::detail
