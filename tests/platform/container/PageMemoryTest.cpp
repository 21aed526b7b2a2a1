// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Released pages are zero.
#include "container/PageMemory.h"

#include <algorithm>
#include <new>

#include <gtest/gtest.h>

namespace fbxsdk::detail {
namespace {

constexpr std::size_t kSize = std::size_t{1} << 20;

std::size_t countOf(std::span<const char> bytes, char value) {
    return static_cast<std::size_t>(std::count(bytes.begin(), bytes.end(), value));
}

TEST(PageMemory, HoldsZerosAtFirst) {
    const PageMemory memory(kSize);

    EXPECT_EQ(memory.bytes().size(), kSize);
    EXPECT_EQ(countOf(memory.bytes(), '\0'), kSize);
}

TEST(PageMemory, CanBeOfNoSize) { EXPECT_TRUE(PageMemory(0).bytes().empty()); }

TEST(PageMemory, ThrowsWhenThereIsNotAsMuch) { EXPECT_THROW(PageMemory(SIZE_MAX / 2), std::bad_alloc); }

TEST(PageMemory, LosesTheReleasedPagesAndNothingElse) {
    const PageMemory memory(kSize);
    std::fill(memory.bytes().begin(), memory.bytes().end(), 'x');
    constexpr std::size_t kFrom = 100;
    constexpr std::size_t kTo = kSize - 100;

    releasePages(memory.bytes().subspan(kFrom, kTo - kFrom));

    EXPECT_EQ(countOf(memory.bytes().first(kFrom), 'x'), kFrom);
    EXPECT_EQ(countOf(memory.bytes().last(kSize - kTo), 'x'), kSize - kTo);
    EXPECT_GT(countOf(memory.bytes(), '\0'), kSize / 2);
}

TEST(PageMemory, KeepsAPageOfWhichOnlyAPartIsReleased) {
    const PageMemory memory(kSize);
    std::fill(memory.bytes().begin(), memory.bytes().end(), 'x');

    releasePages(memory.bytes().subspan(1, 1000));
    releasePages(memory.bytes().first(0));

    EXPECT_EQ(countOf(memory.bytes(), 'x'), kSize);
}

} // namespace
} // namespace fbxsdk::detail
