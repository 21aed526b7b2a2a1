// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Independent work on several threads, and how many there may be.
#include "core/Parallel.h"

#include <algorithm>
#include <atomic>
#include <mutex>
#include <numeric>
#include <set>
#include <stdexcept>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include <fbxsdk/extensions/Threads.h>

namespace fbxsdk::detail {
namespace {

struct Parallel : testing::Test {
    Parallel() { extensions::setMaximumThreads(3); }
    ~Parallel() override { extensions::setMaximumThreads(1); }
};

/// The threads that did a thousand short pieces of work.
std::set<std::thread::id> threadsAtWork() {
    std::mutex mutex;
    std::set<std::thread::id> threads;
    forEachInParallel(1000, [&](std::size_t) {
        {
            const std::lock_guard lock(mutex);
            threads.insert(std::this_thread::get_id());
        }
        std::this_thread::yield();
    });
    return threads;
}

TEST_F(Parallel, StartsNoThreadUnlessToldTo) {
    extensions::setMaximumThreads(1);
    EXPECT_EQ(threadsAtWork(), std::set<std::thread::id>{std::this_thread::get_id()});
    extensions::setMaximumThreads(-5);
    EXPECT_EQ(extensions::maximumThreads(), 1);
    EXPECT_EQ(threadsAtWork(), std::set<std::thread::id>{std::this_thread::get_id()});
}

TEST_F(Parallel, TakesZeroForAllThatTheMachineHas) {
    extensions::setMaximumThreads(0);
    EXPECT_EQ(extensions::maximumThreads(), static_cast<int>(std::max(1U, std::thread::hardware_concurrency())));
}

TEST_F(Parallel, SharesThreadsBetweenCalls) {
    std::atomic<int> atWork{0}, most{0};
    const auto piece = [&](std::size_t) {
        const int now = ++atWork;
        for (int seen = most; seen < now && !most.compare_exchange_weak(seen, now);) {
        }
        std::this_thread::yield();
        --atWork;
    };
    std::vector<std::jthread> calls;
    for (int i = 0; i < 4; ++i)
        calls.emplace_back([&] { forEachInParallel(500, piece); });
    calls.clear();
    EXPECT_LE(most, 4 + 2) << "two threads beyond those of the callers";
}

TEST_F(Parallel, DoesEachPieceOnce) {
    for (const std::size_t count : {0U, 1U, 2U, 1000U}) {
        std::vector<int> done(count, 0);
        forEachInParallel(count, [&](std::size_t i) { ++done[i]; });
        EXPECT_EQ(std::accumulate(done.begin(), done.end(), 0), static_cast<int>(count));
        EXPECT_EQ(std::vector<int>(count, 1), done);
    }
}

TEST_F(Parallel, ThrowsWhatAPieceThrowsWhenAllHaveStopped) {
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

TEST_F(Parallel, CanBeUsedWithinItself) {
    std::atomic<int> done{0};
    forEachInParallel(5, [&](std::size_t) { forEachInParallel(7, [&](std::size_t) { ++done; }); });
    EXPECT_EQ(done, 35);
}

} // namespace
} // namespace fbxsdk::detail
