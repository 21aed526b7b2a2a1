// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Independent work on several threads, and how many there may be.
#include "core/Parallel.h"

#include <algorithm>
#include <atomic>
#include <charconv>
#include <chrono>
#include <cstdlib>
#include <exception>
#include <mutex>
#include <string_view>
#include <system_error>
#include <thread>
#include <utility>
#include <vector>

#include <fbxsdk/extensions/Threads.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

int threadsOfMachine() { return static_cast<int>(std::max(1U, std::thread::hardware_concurrency())); }

int meantBy(int count) { return count == 0 ? threadsOfMachine() : std::max(count, 1); }

/// The number in the environment; 1 without a valid one.
int initialMaximum() {
    const char* const text = std::getenv("TARNELL_FBX_THREADS");
    const std::string_view digits(text ? text : "");
    int count = 1;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), count);
    return error == std::errc() && end == digits.data() + digits.size() ? meantBy(count) : 1;
}

std::atomic<int>& maximum() {
    static std::atomic<int> count{initialMaximum()};
    return count;
}

/// Threads that were started and have not ended yet, of all calls.
std::atomic<int> helpersAtWork{0};

/// A reservation of threads, for the lifetime of the object; fewer than requested, or none, when others are in use.
class HelperLeave {
public:
    explicit HelperLeave(std::size_t wanted) {
        int atWork = helpersAtWork.load();
        do {
            const int left = std::max(0, maximum().load() - 1 - atWork);
            mCount = static_cast<int>(std::min(wanted, static_cast<std::size_t>(left)));
        } while (mCount > 0 && !helpersAtWork.compare_exchange_weak(atWork, atWork + mCount));
    }
    HelperLeave(HelperLeave&& other) noexcept : mCount(std::exchange(other.mCount, 0)) {}
    HelperLeave(const HelperLeave&) = delete;
    HelperLeave& operator=(const HelperLeave&) = delete;
    ~HelperLeave() { helpersAtWork -= mCount; }

    [[nodiscard]] int count() const { return mCount; }

private:
    int mCount = 0;
};

class Crew {
public:
    Crew(std::size_t count, const std::function<void(std::size_t)>& work) : mCount(count), mWork(work) {}

    /// Takes numbers until none is left.
    void run() noexcept {
        for (std::size_t i = mNext++; i < mCount; i = mNext++) {
            try {
                mWork(i);
            } catch (...) {
                stop(std::current_exception());
            }
        }
    }

    void rethrow() const {
        if (mFailure)
            std::rethrow_exception(mFailure);
    }

private:
    void stop(std::exception_ptr failure) {
        const std::lock_guard lock(mMutex);
        mNext = mCount;
        if (!mFailure)
            mFailure = std::move(failure);
    }

    std::size_t mCount;
    const std::function<void(std::size_t)>& mWork;
    std::atomic<std::size_t> mNext{0};
    std::mutex mMutex;
    std::exception_ptr mFailure;
};

} // namespace

void forEachInParallel(std::size_t count, const std::function<void(std::size_t)>& work) {
    const HelperLeave leave(count > 1 ? count - 1 : 0);
    Crew crew(count, work);
    {
        std::vector<std::jthread> threads;
        try {
            for (int i = 0; i < leave.count(); ++i)
                threads.emplace_back([&crew] { crew.run(); });
        } catch (const std::exception&) { // no thread, or no memory for one: the others do the work
        }
        crew.run();
    }
    crew.rethrow();
}

WorkAhead::WorkAhead(std::vector<std::size_t> sizes, std::size_t mostReady, std::function<void(std::size_t)> work)
    : mWork(std::move(work)), mSizes(std::move(sizes)), mStates(mSizes.size(), State::open), mMostReady(mostReady) {
    startThreads();
}

WorkAhead::~WorkAhead() {
    const std::lock_guard lock(mMutex);
    mIsGivenUp = true;
    mChanged.notify_all(); // the threads, which are joined before the rest goes, come to their end
}

void WorkAhead::startThreads() {
    const std::lock_guard lock(mMutex); // they begin when it is known how many there are
    mThreads.reserve(mStates.size());
    try {
        while (mThreads.size() < mStates.size()) {
            HelperLeave leave(1);
            if (leave.count() == 0)
                break;
            mThreads.emplace_back([this, own = std::move(leave)] { workOn(); });
        }
    } catch (const std::exception&) { // no thread, or no memory for one: the others will do
    }
    mMostReady *= mThreads.empty() ? 0 : mThreads.size() + 1;
}

void WorkAhead::workOn() {
    constexpr auto kPatience = std::chrono::milliseconds(20);
    while (true) {
        while (const std::optional<std::size_t> piece = begin())
            work(*piece);
        std::unique_lock lock(mMutex);
        const auto canGoOn = [this] { return mIsGivenUp || mReady < mMostReady; };
        if (!hasOpen() || !mChanged.wait_for(lock, kPatience, canGoOn) || mIsGivenUp)
            return;
    }
}

bool WorkAhead::hasOpen() {
    while (mFirstOpen < mStates.size() && mStates[mFirstOpen] != State::open)
        ++mFirstOpen;
    return mFirstOpen < mStates.size();
}

std::optional<std::size_t> WorkAhead::begin() {
    const std::lock_guard lock(mMutex);
    if (mIsGivenUp || mReady >= mMostReady || !hasOpen())
        return std::nullopt;
    mStates[mFirstOpen] = State::begun;
    mReady += mSizes[mFirstOpen];
    return mFirstOpen;
}

void WorkAhead::work(std::size_t piece) {
    State state = State::done;
    try {
        mWork(piece);
    } catch (...) {
        state = State::failed;
    }
    const std::lock_guard lock(mMutex);
    mStates[piece] = state;
    mChanged.notify_all();
}

bool WorkAhead::take(std::size_t piece) {
    std::unique_lock lock(mMutex);
    while (mStates[piece] == State::begun) {
        lock.unlock();
        const std::optional<std::size_t> other = begin();
        if (other)
            work(*other);
        lock.lock();
        if (!other)
            mChanged.wait(lock, [&] { return mStates[piece] != State::begun; });
    }
    const State state = std::exchange(mStates[piece], State::taken);
    if (state == State::done || state == State::failed) {
        mReady -= mSizes[piece];
        mChanged.notify_all();
    }
    return state == State::done;
}

WorkQueue::WorkQueue(std::size_t mostSize) : mMostHeld(mostSize) {
    startThreads();
    mMostHeld *= workers();
}

WorkQueue::~WorkQueue() {
    const std::lock_guard lock(mMutex);
    mIsEnded = true;
    mAdded.notify_all(); // the threads are joined before the rest goes
}

void WorkQueue::startThreads() {
    const auto most = static_cast<std::size_t>(std::max(0, maximum().load() - 1));
    mThreads.reserve(most);
    try {
        while (mThreads.size() < most) {
            HelperLeave leave(1);
            if (leave.count() == 0)
                break;
            mThreads.emplace_back([this, worker = mThreads.size() + 1, own = std::move(leave)] { workOn(worker); });
        }
    } catch (const std::exception&) { // no thread, or no memory for one: the others do the work
    }
}

void WorkQueue::workOn(std::size_t worker) {
    std::unique_lock lock(mMutex);
    while (true) {
        mAdded.wait(lock, [this] { return mIsEnded || hasOpen(); });
        if (mIsEnded)
            return;
        workOnFirstOpen(worker, lock);
    }
}

void WorkQueue::workOnFirstOpen(std::size_t worker, std::unique_lock<std::mutex>& lock) {
    Piece& piece = mPieces[mFirstOpen++]; // stays in place: it is taken when it is done
    piece.state = State::begun;
    mHeld -= piece.size;
    lock.unlock();
    std::size_t size = 0;
    std::exception_ptr failure;
    try {
        size = piece.work(worker);
        piece.work = nullptr;
    } catch (...) {
        failure = std::current_exception();
    }
    lock.lock();
    piece.size = size;
    piece.failure = std::move(failure);
    piece.state = State::done;
    mHeld += size;
    mDone.notify_one();
}

void WorkQueue::add(std::size_t size, Work work) {
    const std::lock_guard lock(mMutex);
    mPieces.push_back({size, std::move(work)});
    mHeld += size;
    mAdded.notify_one();
}

bool WorkQueue::isFull() {
    const std::lock_guard lock(mMutex);
    return mHeld > mMostHeld;
}

bool WorkQueue::isFirstDone() {
    const std::lock_guard lock(mMutex);
    return !mPieces.empty() && mPieces.front().state == State::done;
}

bool WorkQueue::workOnOne() {
    std::unique_lock lock(mMutex);
    if (!hasOpen())
        return false;
    workOnFirstOpen(0, lock);
    return true;
}

void WorkQueue::takeFirst() {
    std::unique_lock lock(mMutex);
    const auto isDone = [this] { return mPieces.front().state == State::done; };
    while (!isDone() && hasOpen())
        workOnFirstOpen(0, lock);
    mDone.wait(lock, isDone);
    const std::exception_ptr failure = mPieces.front().failure;
    mHeld -= mPieces.front().size;
    mPieces.pop_front();
    --mFirstOpen;
    lock.unlock();
    if (failure)
        std::rethrow_exception(failure);
}

} // namespace detail

int extensions::maximumThreads() { return detail::maximum(); }

void extensions::setMaximumThreads(int count) { detail::maximum() = detail::meantBy(count); }

FBXSDK_NAMESPACE_END
