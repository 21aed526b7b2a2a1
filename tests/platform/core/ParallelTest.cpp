// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Independent work on several threads, and how many there may be.
#include "core/Parallel.h"

#include <algorithm>
#include <atomic>
#include <chrono>
#include <mutex>
#include <new>
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

TEST_F(Parallel, StartsNoThreadByDefault) {
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

TEST_F(Parallel, DoesWorkAheadOnOtherThreads) {
    std::vector<std::thread::id> threads(2);
    WorkAhead work({1, 1}, 1, [&](std::size_t i) { threads[i] = std::this_thread::get_id(); });
    std::this_thread::sleep_for(std::chrono::milliseconds(20));
    EXPECT_NE(work.take(0) ? threads[0] : std::thread::id(), std::this_thread::get_id());
}

TEST_F(Parallel, DoesEveryPieceAheadOrLeavesItToTheCaller) {
    for (int round = 0; round < 200; ++round) {
        std::vector<int> done(20, 0);
        WorkAhead work(std::vector<std::size_t>(done.size(), 1), 1, [&](std::size_t i) { ++done[i]; });
        for (std::size_t i = done.size(); i-- > 0;)
            done[i] += work.take(i) ? 0 : 1;
        ASSERT_EQ(done, std::vector<int>(20, 1));
    }
}

TEST_F(Parallel, HasNoMoreReadyThanThereAreThreads) {
    std::atomic<int> done{0};
    {
        WorkAhead work(std::vector<std::size_t>(100, 1), 1, [&](std::size_t) { ++done; });
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        EXPECT_LE(done, 3);
    }
    EXPECT_LE(done, 3) << "nor does anybody begin with more when the work is given up";
}

TEST_F(Parallel, GoesOnAheadWhenWhatIsReadyIsTaken) {
    for (int round = 0; round < 20; ++round) {
        int done = 0;
        {
            WorkAhead work({5, 1, 1, 7, 1, 1, 9, 2}, 2, [&](std::size_t) {});
            for (std::size_t i = 0; i < 8; ++i) {
                std::this_thread::sleep_for(std::chrono::milliseconds(1));
                done += work.take(i) ? 1 : 0;
            }
        }
        if (done == 8)
            return;
    }
    FAIL() << "threads end before all is done";
}

TEST_F(Parallel, EndsWhenResultsAreNotTaken) {
    WorkAhead work(std::vector<std::size_t>(100, 1), 1, [](std::size_t) {});
    std::size_t most = 1;
    for (int i = 0; i < 1000 && most == 1; ++i)
        most = threadsAtWork().size();
    EXPECT_GT(most, 1U);
    for (std::size_t i = 0; i < 100; ++i)
        static_cast<void>(work.take(i));
}

TEST_F(Parallel, LeavesPiecesThatFailToTheCaller) {
    std::atomic<bool> failed{false};
    WorkAhead work({1}, 1, [&](std::size_t) {
        failed = true;
        throw std::bad_alloc();
    });
    while (!failed)
        std::this_thread::yield();
    EXPECT_FALSE(work.take(0));
}

TEST_F(Parallel, DoesNothingAheadOnOneThread) {
    extensions::setMaximumThreads(1);
    WorkAhead work({1, 1, 1}, 1, [](std::size_t) { FAIL(); });
    for (std::size_t i = 0; i < 3; ++i)
        EXPECT_FALSE(work.take(i));
}

TEST_F(Parallel, GivesThreadsBackThatHaveNothingMoreToDoAhead) {
    std::atomic<int> done{0};
    WorkAhead idle({1, 1}, 1, [&](std::size_t) { ++done; });
    while (done < 2)
        std::this_thread::yield();
    std::size_t most = 1;
    for (int i = 0; i < 1000 && most == 1; ++i)
        most = threadsAtWork().size();
    EXPECT_GT(most, 1U);
}

TEST_F(Parallel, TakesWhatIsQueuedInItsOrder) {
    std::vector<std::size_t> squares(1000), taken;
    WorkQueue queue(10);
    const auto take = [&] {
        queue.takeFirst();
        taken.push_back(squares[taken.size()]);
    };
    for (std::size_t i = 0; i < squares.size(); ++i) {
        while (queue.isFirstDone())
            take();
        queue.add(1, [&squares, i](std::size_t) {
            squares[i] = i * i;
            return std::size_t{1};
        });
        if (queue.isFull() && !queue.workOnOne())
            take();
    }
    while (taken.size() < squares.size())
        take();

    for (std::size_t i = 0; i < squares.size(); ++i)
        ASSERT_EQ(taken[i], i * i);
    EXPECT_FALSE(queue.isFirstDone());
    EXPECT_FALSE(queue.workOnOne());
}

TEST_F(Parallel, IsFullOfWhatWaitsAndOfResults) {
    extensions::setMaximumThreads(1);
    WorkQueue queue(10);
    const auto work = [](std::size_t worker) {
        EXPECT_EQ(worker, 0U);
        return std::size_t{20};
    };
    queue.add(8, work);
    EXPECT_FALSE(queue.isFull());
    queue.add(8, work);
    EXPECT_TRUE(queue.isFull());
    EXPECT_TRUE(queue.workOnOne());
    EXPECT_TRUE(queue.isFull()) << "the result is larger";
    queue.takeFirst();
    EXPECT_FALSE(queue.isFull());
}

TEST_F(Parallel, RethrowsWhatQueuedWorkThrowsWhenItIsTaken) {
    WorkQueue queue(10);
    queue.add(
        1, [](std::size_t) { return std::size_t{0}; });
    queue.add(
        1, [](std::size_t) -> std::size_t { throw std::bad_alloc(); });
    queue.add(1, [](std::size_t) { return std::size_t{0}; });

    queue.takeFirst();
    EXPECT_THROW(queue.takeFirst(), std::bad_alloc);
    queue.takeFirst();
}

TEST_F(Parallel, DropsQueuedWorkThatIsGivenUp) {
    std::atomic<int> begun{0}, done{0};
    {
        WorkQueue queue(10);
        for (int i = 0; i < 100; ++i) {
            queue.add(
                1,
                [&](std::size_t) {
                    ++begun;
                    std::this_thread::sleep_for(std::chrono::milliseconds(1));
                    ++done;
                    return std::size_t{0};
                });
        }
    }
    EXPECT_EQ(begun, done);
    EXPECT_LT(done, 100);
}

} // namespace
} // namespace fbxsdk::detail
