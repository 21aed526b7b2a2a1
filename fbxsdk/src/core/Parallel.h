// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Independent work on several threads.
#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <exception>
#include <functional>
#include <mutex>
#include <optional>
#include <thread>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Calls `work` with each number below the count, on this thread and on as many others as `maximumThreads()` allows.
/// Returns when all calls have; rethrows what the first of them to fail threw, and starts no further ones then. Where
/// no thread can be created, this one does all the work.
void forEachInParallel(std::size_t count, const std::function<void(std::size_t)>& work);

/// Pieces of work that other threads do before their results are requested, in order, on as many threads as
/// `maximumThreads()` leaves. The threads end when no piece is left, or when no result is taken for some time. The
/// owner is one thread, never one that does the work.
class WorkAhead {
public:
    /// No piece is started while the total size of those that are ready and not taken is `mostReady` times the number
    /// of threads. Throws std::bad_alloc; exceptions of the work mark the piece as failed.
    WorkAhead(std::vector<std::size_t> sizes, std::size_t mostReady, std::function<void(std::size_t)> work);
    WorkAhead(const WorkAhead&) = delete;
    WorkAhead& operator=(const WorkAhead&) = delete;
    /// Waits for pieces in progress.
    ~WorkAhead();

    /// Whether the piece was done; to be called once for each. Waits for a piece in progress, and does others
    /// meanwhile. A piece that was not started, or that failed, is left to the caller.
    [[nodiscard]] bool take(std::size_t piece);

private:
    enum class State { open, begun, done, failed, taken };

    void startThreads();
    void workOn();
    [[nodiscard]] bool hasOpen();
    [[nodiscard]] std::optional<std::size_t> begin();
    void work(std::size_t piece);

    std::function<void(std::size_t)> mWork;
    std::mutex mMutex;
    std::condition_variable mChanged;
    std::vector<std::size_t> mSizes;
    std::vector<State> mStates;
    std::size_t mFirstOpen = 0; ///< or one before it
    std::size_t mReady = 0;     ///< size of the pieces that were started and are not taken yet
    std::size_t mMostReady;
    bool mIsGivenUp = false;
    std::vector<std::jthread> mThreads;
};

/// Pieces of work that are added one by one: other threads do them, as many as `maximumThreads()` leaves, and the owner
/// takes them in the order in which they were added. The owner is one thread.
class WorkQueue {
public:
    /// Does a piece and returns the size of its result. The worker is below `workers()`; each does one piece at a time.
    using Work = std::function<std::size_t(std::size_t worker)>;

    /// Full when the pieces that wait, and the results that are not taken, exceed that size for each thread. Throws
    /// std::bad_alloc.
    explicit WorkQueue(std::size_t mostSize);
    WorkQueue(const WorkQueue&) = delete;
    WorkQueue& operator=(const WorkQueue&) = delete;
    /// Waits for pieces in progress. Those that were not started are dropped.
    ~WorkQueue();

    /// The other threads and the owner, which is number 0.
    [[nodiscard]] std::size_t workers() const { return mThreads.size() + 1; }

    void add(std::size_t size, Work work);
    [[nodiscard]] bool isFull();
    /// Whether the first piece can be taken without waiting.
    [[nodiscard]] bool isFirstDone();
    /// Does a piece that waits. False when there is none.
    bool workOnOne();
    /// Removes the first piece. Waits for it, and does others meanwhile; rethrows what it threw.
    void takeFirst();

private:
    enum class State { open, begun, done };
    struct Piece {
        std::size_t size; ///< until it is done, of the piece, then of the result
        Work work;
        State state = State::open;
        std::exception_ptr failure{};
    };

    void startThreads();
    void workOn(std::size_t worker);
    void workOnFirstOpen(std::size_t worker, std::unique_lock<std::mutex>& lock);
    [[nodiscard]] bool hasOpen() const { return mFirstOpen < mPieces.size(); }

    std::mutex mMutex;
    std::condition_variable mAdded, mDone;
    std::deque<Piece> mPieces;  ///< those that are not taken
    std::size_t mFirstOpen = 0; ///< those before it are begun or done
    std::size_t mHeld = 0;      ///< size of those that are open or done
    std::size_t mMostHeld;
    bool mIsEnded = false;
    std::vector<std::jthread> mThreads;
};

} // namespace detail
FBXSDK_NAMESPACE_END
