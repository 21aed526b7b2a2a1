// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays that share their elements with copies, and whose equal last elements take no memory.
#include "TnFbxSharedArray.h"

#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace Tarnell::Fbx::detail {
namespace {

using testing::ElementsAre;

std::vector<int> elementsOf(const SharedArray<int>& array) {
    std::vector<int> elements;
    for (std::size_t i = 0; i < array.size(); ++i)
        elements.push_back(array[i]);
    return elements;
}

TEST(SharedArray, HasNoElementsAtFirst) {
    const SharedArray<int> array;
    EXPECT_EQ(array.size(), 0u);
    EXPECT_EQ(array.storedCount(), 0u);
    EXPECT_EQ(array.filler(), nullptr);
    EXPECT_EQ(array.identity(), nullptr);
}

TEST(SharedArray, StoresNoFilledElements) {
    SharedArray<int> array;
    array.fill(1000000, 7);
    EXPECT_EQ(array.size(), 1000000u);
    EXPECT_EQ(array.storedCount(), 0u);
    EXPECT_EQ(array[999999], 7);
    ASSERT_NE(array.filler(), nullptr);
    EXPECT_EQ(*array.filler(), 7);
}

TEST(SharedArray, FillsUpToACountAndKeepsTheElementsBefore) {
    SharedArray<int> array;
    array.own() = {1, 2};
    array.fill(4, 9);
    EXPECT_THAT(elementsOf(array), ElementsAre(1, 2, 9, 9));
    EXPECT_EQ(array.storedCount(), 2u);
    array.fill(3, 5); // it has more already
    EXPECT_THAT(elementsOf(array), ElementsAre(1, 2, 9, 9));
    array.fill(5, 5);
    EXPECT_THAT(elementsOf(array), ElementsAre(1, 2, 9, 9, 5));
}

TEST(SharedArray, StoresAllElementsForAChange) {
    SharedArray<int> array;
    array.fill(3, 4);
    array.own()[1] = 8;
    EXPECT_THAT(elementsOf(array), ElementsAre(4, 8, 4));
    EXPECT_EQ(array.storedCount(), 3u);
    array.own().pop_back();
    EXPECT_THAT(elementsOf(array), ElementsAre(4, 8)) << "what is removed does not come back";
}

TEST(SharedArray, CopiesShareFilledElementsUntilOneIsChanged) {
    SharedArray<int> array;
    array.own() = {1};
    array.fill(3, 2);
    SharedArray<int> copy = array;
    EXPECT_EQ(copy.identity(), array.identity());
    EXPECT_TRUE(copy.isShared());

    copy.fill(4, 6);
    EXPECT_NE(copy.identity(), array.identity());
    EXPECT_THAT(elementsOf(copy), ElementsAre(1, 2, 2, 6));
    EXPECT_THAT(elementsOf(array), ElementsAre(1, 2, 2));
    EXPECT_FALSE(array.isShared());
}

TEST(SharedArray, ReservesInAnArrayOfItsOwn) {
    SharedArray<int> array;
    array.fill(2, 3);
    SharedArray<int> copy = array;
    copy.reserve(10);
    EXPECT_NE(copy.identity(), array.identity());
    EXPECT_THAT(elementsOf(copy), ElementsAre(3, 3));
    EXPECT_GE(copy.own().capacity(), 10u);
}

TEST(SharedArray, IsEmptyAfterItWasCleared) {
    SharedArray<int> array;
    array.own() = {1};
    array.fill(3, 2);
    SharedArray<int> copy = array;
    array.clear();
    EXPECT_EQ(array.size(), 0u);
    EXPECT_THAT(elementsOf(copy), ElementsAre(1, 2, 2));
    copy.clear(); // not shared any more
    EXPECT_EQ(copy.size(), 0u);
    EXPECT_EQ(copy.filler(), nullptr);
}

} // namespace
} // namespace Tarnell::Fbx::detail
