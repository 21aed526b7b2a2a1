// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The growing array.
#include <string>

#include <gtest/gtest.h>

#include <fbxsdk/FbxArray.h>

namespace {

using namespace fbxsdk;

TEST(FbxArray, AddsAndFinds) {
    FbxArray<std::string> array;
    EXPECT_EQ(array.Add("a"), 0);
    EXPECT_EQ(array.Add("b"), 1);
    EXPECT_EQ(array.AddUnique("a"), 0);
    EXPECT_EQ(array.GetCount(), 2);
    EXPECT_EQ(array.Find("b"), 1);
    EXPECT_EQ(array.Find("a", 1), -1);
    EXPECT_EQ(array.Find("a", 5), -1);
    EXPECT_EQ(array[1], "b");
    EXPECT_EQ(array.GetLast(), "b");
}

TEST(FbxArray, InsertsAndRemoves) {
    FbxArray<int> array(10);
    EXPECT_EQ(array.GetCount(), 0);
    EXPECT_EQ(array.InsertAt(5, 3), 0);
    EXPECT_EQ(array.InsertAt(0, 1), 0);
    EXPECT_EQ(array.InsertAt(1, 2), 1);
    EXPECT_EQ(array.InsertAt(-1, 9), -1);
    EXPECT_EQ(array.RemoveAt(1), 2);
    EXPECT_EQ(array.RemoveLast(), 3);
    EXPECT_EQ(array.GetFirst(), 1);
    array.Clear();
    EXPECT_EQ(array.Size(), 0);
}

TEST(FbxArray, ReturnsItsElements) {
    FbxArray<int> array;
    array.Resize(3);
    array.SetAt(1, 5);
    array.GetArray()[2] = 7;
    int sum = 0;
    for (const int item : array)
        sum += item;
    EXPECT_EQ(sum, 12);
    EXPECT_EQ(array.GetAt(0), 0);
    array.Resize(-1);
    EXPECT_EQ(array.GetCount(), 0);
}

} // namespace
