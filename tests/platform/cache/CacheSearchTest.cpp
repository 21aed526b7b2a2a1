// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Where caches are looked for.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "cache/CacheSearch.h"

using fbxsdk::detail::cacheFileCandidates;
using testing::Contains;
using testing::Each;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

TEST(CacheSearch, LooksBesideTheFileFirstThenAtTheAbsolutePlace) {
    const auto places = cacheFileCandidates("/shots/a.fbx", "a_fpc\\ball.xml", "C:\\old\\a_fpc\\ball.xml");

    ASSERT_GE(places.size(), 2U);
    EXPECT_EQ(places[0], "/shots/a_fpc/ball.xml");
    EXPECT_EQ(places[1], "C:/old/a_fpc/ball.xml");
}

TEST(CacheSearch, LooksInTheFolderNamedAfterTheFileWhenItWasRenamed) {
    const auto places = cacheFileCandidates("/shots/renamed.fbx", "", "/gone/original_fpc/ball.xml");

    EXPECT_THAT(places, ElementsAre("/gone/original_fpc/ball.xml", "/shots/renamed_fpc/ball.xml",
                                    "/shots/original_fpc/ball.xml", "/shots/ball.xml"));
}

TEST(CacheSearch, DoesNotFollowRelativeNamesThatClimbOut) {
    const auto places = cacheFileCandidates("/shots/a.fbx", "..\\..\\etc\\ball.xml", "");

    EXPECT_THAT(places, Each(HasSubstr("/shots/")));
    EXPECT_THAT(places, Each(Not(HasSubstr(".."))));
}

TEST(CacheSearch, FindsNothingWithoutNames) { EXPECT_TRUE(cacheFileCandidates("/shots/a.fbx", "", "").empty()); }
