// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Independent work on all cores.
#include "core/Parallel.h"

#include <algorithm>
#include <atomic>
#include <exception>
#include <mutex>
#include <system_error>
#include <thread>
#include <vector>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

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
        if (mFailure) {
            std::rethrow_exception(mFailure);
        }
    }

private:
    void stop(std::exception_ptr failure) {
        const std::lock_guard lock(mMutex);
        mNext = mCount;
        if (!mFailure) {
            mFailure = std::move(failure);
        }
    }

    std::size_t mCount;
    const std::function<void(std::size_t)>& mWork;
    std::atomic<std::size_t> mNext{0};
    std::mutex mMutex;
    std::exception_ptr mFailure;
};

} // namespace

void forEachInParallel(std::size_t count, const std::function<void(std::size_t)>& work) {
    const std::size_t helpers = std::min<std::size_t>(std::max(1U, std::thread::hardware_concurrency()), count);
    Crew crew(count, work);
    {
        std::vector<std::jthread> threads;
        try {
            for (std::size_t i = 1; i < helpers; ++i) {
                threads.emplace_back([&crew] { crew.run(); });
            }
        } catch (const std::exception&) { // no thread, or no memory for one: the others will do
        }
        crew.run();
    }
    crew.rethrow();
}

} // namespace detail
FBXSDK_NAMESPACE_END
