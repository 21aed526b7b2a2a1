// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The owned string.
#include <cstring>
#include <string>

#include <gtest/gtest.h>

#include <fbxsdk/FbxString.h>

namespace {

using namespace fbxsdk;

TEST(FbxString, IsEmptyAtFirstAndForNull) {
    const char* const null = nullptr;
    EXPECT_TRUE(FbxString().IsEmpty());
    EXPECT_TRUE(FbxString(null).IsEmpty());
    EXPECT_TRUE(FbxString(null, 5).IsEmpty());
    EXPECT_STREQ(FbxString().Buffer(), "");
    FbxString text("a");
    text = null;
    EXPECT_EQ(text.GetLen(), 0U);
    text += null;
    EXPECT_TRUE(text.IsEmpty());
}

TEST(FbxString, IsMadeOfTextCharactersAndNumbers) {
    EXPECT_STREQ(FbxString("abcdef", 3).Buffer(), "abc");
    EXPECT_STREQ(FbxString("ab", 10).Buffer(), "ab");
    EXPECT_STREQ(FbxString('x', 3).Buffer(), "xxx");
    EXPECT_STREQ(FbxString(-42).Buffer(), "-42");
    EXPECT_STREQ(FbxString(0.1F).Buffer(), "0.1");
    EXPECT_STREQ(FbxString(0.1).Buffer(), "0.1");
}

TEST(FbxString, FindsTheFirstOccurrenceAtOrAfterTheStart) {
    const FbxString text("FBX ascii (*.fbx)");
    EXPECT_EQ(text.Find("ascii"), 4);
    EXPECT_EQ(text.Find("ASCII"), -1);
    EXPECT_EQ(text.Find("ascii", 4), 4);
    EXPECT_EQ(text.Find("ascii", 5), -1);
    EXPECT_EQ(text.Find('b'), 14);
    EXPECT_EQ(text.Find('B'), 1);
    EXPECT_EQ(text.Find('B', 2), -1);
    EXPECT_EQ(text.Find("x", 1000), -1);
    EXPECT_EQ(text.ReverseFind('x'), 15);
    EXPECT_EQ(text.ReverseFind('q'), -1);
}

TEST(FbxString, ComparesBytesOnBothSides) {
    const FbxString a("a");
    EXPECT_TRUE(a == "a");
    EXPECT_TRUE("a" == a);
    EXPECT_TRUE(a == FbxString("a"));
    EXPECT_TRUE(a != "b");
    EXPECT_TRUE(a < "b");
    EXPECT_TRUE("b" > a);
    EXPECT_TRUE(a > FbxString("A"));
    EXPECT_TRUE(a == std::string("a").c_str());
    EXPECT_EQ(a.Compare("a"), 0);
    EXPECT_LT(a.Compare("b"), 0);
    EXPECT_EQ(FbxString("Ball").CompareNoCase("bALL"), 0);
    EXPECT_NE(FbxString("Ball").CompareNoCase("bull"), 0);
    EXPECT_TRUE(FbxString() == static_cast<const char*>(nullptr));
}

TEST(FbxString, Joins) {
    FbxString text = FbxString("a") + "b" + FbxString("c") + 'd';
    text = "_" + text;
    text += text;
    EXPECT_STREQ(text, "_abcd_abcd");
    text += '!';
    EXPECT_EQ(text.GetLen(), 11U);
}

TEST(FbxString, CanBeAssignedAPartOfItself) {
    FbxString text("folder/file");
    text = text.Buffer() + 7;
    EXPECT_STREQ(text, "file");
}

TEST(FbxString, GivesPartsWithinItsBounds) {
    const FbxString text("abcdef");
    EXPECT_STREQ(text.Left(2), "ab");
    EXPECT_STREQ(text.Left(99), "abcdef");
    EXPECT_STREQ(text.Mid(2), "cdef");
    EXPECT_STREQ(text.Mid(2, 3), "cde");
    EXPECT_STREQ(text.Mid(99), "");
    EXPECT_STREQ(text.Right(2), "ef");
    EXPECT_STREQ(text.Right(99), "abcdef");
}

TEST(FbxString, ChangesTheCaseOfAsciiLettersOnly) {
    EXPECT_STREQ(FbxString("Straße_\xC3\x84").Upper(), "STRAßE_\xC3\x84");
    EXPECT_STREQ(FbxString("Az_\xC3\x84").Lower(), "az_\xC3\x84");
}

TEST(FbxString, CanBeWrittenInPlace) {
    FbxString text("abc");
    text[1] = 'X';
    text.Buffer()[0] = 'Y';
    EXPECT_STREQ(text, "YXc");
    EXPECT_EQ(text[2], 'c');
}

} // namespace
