// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Independent work on all cores.
#include "core/Parallel.h"

#include <atomic>
#include <numeric>
#include <stdexcept>
#include <vector>

#include <gtest/gtest.h>

namespace fbxsdk::detail {
namespace {

TEST(Parallel, DoesEachPieceOnce) {
    for (const std::size_t count : {0U, 1U, 2U, 1000U}) {
        std::vector<int> done(count, 0);
        forEachInParallel(count, [&](std::size_t i) { ++done[i]; });
        EXPECT_EQ(std::accumulate(done.begin(), done.end(), 0), static_cast<int>(count));
        EXPECT_EQ(std::vector<int>(count, 1), done);
    }
}

TEST(Parallel, ThrowsWhatAPieceThrowsWhenAllHaveStopped) {
    std::atomic<int> running{0};
    const auto work = [&](std::size_t i) {
        ++running;
        if (i == 3) {
            --running;
            throw std::runtime_error("the fourth");
        }
        --running;
    };

    try {
        forEachInParallel(1000, work);
        FAIL();
    } catch (const std::runtime_error& error) {
        EXPECT_STREQ(error.what(), "the fourth");
    }
    EXPECT_EQ(running, 0);
}

TEST(Parallel, CanBeUsedWithinItself) {
    std::atomic<int> done{0};
    forEachInParallel(5, [&](std::size_t) { forEachInParallel(7, [&](std::size_t) { ++done; }); });
    EXPECT_EQ(done, 35);
}

} // namespace
} // namespace fbxsdk::detail
