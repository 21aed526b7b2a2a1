// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Replacement of invalid UTF-8.
#include "Utf8.h"

#include <gtest/gtest.h>

using conformance::withoutInvalidUtf8;

TEST(WithoutInvalidUtf8, KeepsCharactersOfEveryLength) {
    EXPECT_EQ(withoutInvalidUtf8("a\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"), "a\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80");
}

TEST(WithoutInvalidUtf8, ReplacesEveryByteThatBelongsToNoCharacter) {
    EXPECT_EQ(withoutInvalidUtf8("a\xFF\x80z"), "a\xEF\xBF\xBD\xEF\xBF\xBDz");
}

TEST(WithoutInvalidUtf8, ReplacesSurrogatesAndOverlongForms) {
    EXPECT_EQ(withoutInvalidUtf8("\xC0\x80"), "\xEF\xBF\xBD\xEF\xBF\xBD");
    EXPECT_EQ(withoutInvalidUtf8("\xED\xA0\x80"), "\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD");
}

TEST(WithoutInvalidUtf8, ReplacesACharacterThatIsCutOff) {
    EXPECT_EQ(withoutInvalidUtf8("\xE2\x82"), "\xEF\xBF\xBD\xEF\xBF\xBD");
}
