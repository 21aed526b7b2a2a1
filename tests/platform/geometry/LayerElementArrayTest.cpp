// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays of layer elements as hosts use them.
#include "GeometryFixture.h"

using namespace fbxsdk;
using testing::ElementsAre;

namespace {

void fill(FbxLayerElementArrayTemplate<int>& array, std::initializer_list<int> items) {
    for (const int item : items)
        array.Add(item);
}

} // namespace

TEST(FbxLayerElementArray, GivesTheNewIndexWhenAnItemIsAdded) {
    FbxLayerElementArrayTemplate<int> array;

    EXPECT_EQ(array.Add(5), 0);
    EXPECT_EQ(array.Add(6), 1);
    EXPECT_EQ(array.GetCount(), 2);
}

TEST(FbxLayerElementArray, GrowsWithItemsThatAreAllZero) {
    FbxLayerElementArrayTemplate<FbxVector4> vectors;
    FbxLayerElementArrayTemplate<FbxColor> colors;
    FbxLayerElementArrayTemplate<FbxVector2> coordinates;

    EXPECT_TRUE(vectors.SetCount(1));
    EXPECT_TRUE(colors.SetCount(1));
    EXPECT_TRUE(coordinates.SetCount(1));

    EXPECT_EQ(vectors.GetAt(0), FbxVector4(0, 0, 0, 0));
    EXPECT_EQ(colors.GetAt(0), FbxColor(0, 0, 0, 0));
    EXPECT_EQ(coordinates.GetAt(0), FbxVector2(0, 0));
}

TEST(FbxLayerElementArray, KeepsItemsWhenTheCountGrowsOrShrinks) {
    FbxLayerElementArrayTemplate<int> array;
    fill(array, {1, 2, 3});

    array.SetCount(4);
    EXPECT_THAT(itemsOf(array), ElementsAre(1, 2, 3, 0));

    array.SetCount(1);
    EXPECT_THAT(itemsOf(array), ElementsAre(1));

    array.SetCount(-5);
    EXPECT_EQ(array.GetCount(), 0);
}

TEST(FbxLayerElementArray, ReadsZeroOutOfRange) {
    FbxLayerElementArrayTemplate<FbxColor> array;
    array.Add(FbxColor(1, 1, 1, 1));

    EXPECT_EQ(array.GetAt(1), FbxColor(0, 0, 0, 0));
    EXPECT_EQ(array.GetAt(-1), FbxColor(0, 0, 0, 0));
}

TEST(FbxLayerElementArray, WritesNowhereOutOfRange) {
    FbxLayerElementArrayTemplate<int> array;
    fill(array, {1, 2});

    array.SetAt(2, 9);
    array.SetAt(-1, 9);
    array.SetAt(1, 8);

    EXPECT_THAT(itemsOf(array), ElementsAre(1, 8));
}

TEST(FbxLayerElementArray, InsertsAtOrBehindTheEnd) {
    FbxLayerElementArrayTemplate<int> array;
    fill(array, {1, 2});

    EXPECT_EQ(array.InsertAt(0, 0), 0);
    EXPECT_EQ(array.InsertAt(99, 3), 3);
    EXPECT_EQ(array.InsertAt(-1, 7), -1);

    EXPECT_THAT(itemsOf(array), ElementsAre(0, 1, 2, 3));
}

TEST(FbxLayerElementArray, GivesWhatItRemoves) {
    FbxLayerElementArrayTemplate<int> array;
    fill(array, {4, 5, 6, 5});

    EXPECT_EQ(array.RemoveAt(0), 4);
    EXPECT_EQ(array.RemoveLast(), 5);
    EXPECT_EQ(array.RemoveAt(9), 0);
    EXPECT_TRUE(array.RemoveIt(6));
    EXPECT_FALSE(array.RemoveIt(6));

    EXPECT_THAT(itemsOf(array), ElementsAre(5));
}

TEST(FbxLayerElementArray, FindsTheFirstEqualItem) {
    FbxLayerElementArrayTemplate<int> array;
    fill(array, {4, 5, 5});

    EXPECT_EQ(array.Find(5), 1);
    EXPECT_EQ(array.Find(9), -1);
}

TEST(FbxLayerElementArray, AddsSeveralZerosAtOnce) {
    FbxLayerElementArrayTemplate<int> array;
    fill(array, {4});

    EXPECT_EQ(array.AddMultiple(2), 1);
    EXPECT_EQ(array.AddMultiple(-3), 3);

    EXPECT_THAT(itemsOf(array), ElementsAre(4, 0, 0));
}

TEST(FbxLayerElementArray, LendsItsItemsAsOneRun) {
    FbxLayerElementArrayTemplate<int> array;
    int* none = nullptr;
    none = array.GetLocked(none);
    EXPECT_EQ(none, nullptr);
    fill(array, {4, 5});

    int* items = nullptr;
    items = array.GetLocked(items, FbxLayerElementArray::eReadLock);
    ASSERT_NE(items, nullptr);
    EXPECT_EQ(items[1], 5);
    items[0] = 3;
    array.Release(&items);

    EXPECT_EQ(items, nullptr);
    EXPECT_EQ(array.GetAt(0), 3);
}

TEST(FbxLayerElementArray, CopiesItsItems) {
    FbxLayerElementArrayTemplate<int> array;
    fill(array, {4, 5});
    FbxArray<int> copy;
    copy.Add(1);

    array.CopyTo(copy);

    ASSERT_EQ(copy.GetCount(), 2);
    EXPECT_EQ(copy[0], 4);
    EXPECT_EQ(copy[1], 5);
}

TEST(FbxLayerElementArray, CountsThroughItsBase) {
    FbxLayerElementArrayTemplate<bool> array;
    array.Add(true);
    const FbxLayerElementArray& base = array;

    EXPECT_EQ(base.GetCount(), 1);
}
