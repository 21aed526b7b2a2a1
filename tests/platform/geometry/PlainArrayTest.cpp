// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Growing, shrinking and moving plain items.
#include <fbxsdk/FbxPlainArray.h>

#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using fbxsdk::detail::PlainArray;
using testing::ElementsAre;

namespace {

std::vector<int> itemsOf(const PlainArray<int>& array) { return {array.begin(), array.end()}; }

PlainArray<int>& filled(PlainArray<int>& array, int count) {
    for (int i = 0; i < count; ++i)
        array.add(i);
    return array;
}

} // namespace

TEST(PlainArray, IsEmptyAtFirst) {
    const PlainArray<int> array;

    EXPECT_EQ(array.count(), 0);
    EXPECT_EQ(array.data(), nullptr);
    EXPECT_FALSE(array.contains(0));
}

TEST(PlainArray, KeepsItemsWhileItGrows) {
    PlainArray<int> array;

    filled(array, 100000);

    ASSERT_EQ(array.count(), 100000);
    for (int i = 0; i < 100000; ++i)
        ASSERT_EQ(array[i], i);
}

TEST(PlainArray, FillsOnlyNewItems) {
    PlainArray<int> array;
    filled(array, 2);

    array.resize(4, 7);

    EXPECT_THAT(itemsOf(array), ElementsAre(0, 1, 7, 7));
}

TEST(PlainArray, DropsItemsFromTheEnd) {
    PlainArray<int> array;
    filled(array, 4);

    array.resize(2, 7);

    EXPECT_THAT(itemsOf(array), ElementsAre(0, 1));
}

TEST(PlainArray, TakesANegativeCountForNone) {
    PlainArray<int> array;
    filled(array, 4);

    array.resize(-1, 7);

    EXPECT_EQ(array.count(), 0);
}

TEST(PlainArray, InsertsBeforeAnItem) {
    PlainArray<int> array;
    filled(array, 3);

    array.insert(1, 9);
    array.insert(0, 8);

    EXPECT_THAT(itemsOf(array), ElementsAre(8, 0, 9, 1, 2));
}

TEST(PlainArray, TakesOneOfItsOwnItemsAsNewItem) {
    PlainArray<int> array;
    array.add(5);

    for (int i = 0; i < 100; ++i) {
        array.insert(0, array[array.count() - 1]);
        array.add(array[0]);
    }
    array.resize(300, array[0]);

    for (const int item : array)
        ASSERT_EQ(item, 5);
}

TEST(PlainArray, RemovesARunOfItems) {
    PlainArray<int> array;
    filled(array, 6);

    array.remove(1, 3);

    EXPECT_THAT(itemsOf(array), ElementsAre(0, 4, 5));
}

TEST(PlainArray, RemovesNoMoreThanThereIs) {
    PlainArray<int> array;
    filled(array, 4);

    array.remove(2, 100);
    array.remove(7, 1);
    array.remove(0, -1);

    EXPECT_THAT(itemsOf(array), ElementsAre(0, 1));
}
