// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Consecutive numbers for the times at which transforms are evaluated.
#pragma once

#include <cstdint>
#include <unordered_map>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Assigns every time a number, in the order of first use, and remembers the latest ones. A time that was dropped gets
/// a new number.
///
/// Caches by time are indexed by these numbers: nodes are evaluated at the same times one after another, in any order,
/// and the numbers are consecutive all the same.
class TimeNumbers {
public:
    static constexpr std::size_t kKept = std::size_t{1} << 15U;

    [[nodiscard]] std::uint64_t numberOf(std::int64_t ticks) {
        if (mLast + 1 < mNext && ticksOf(mLast + 1) == ticks)
            return ++mLast;
        if (mLast < mNext && ticksOf(mLast) == ticks)
            return mLast;
        return mLast = lookUp(ticks);
    }
    /// The number that was given last.
    [[nodiscard]] std::uint64_t newest() const { return mNext - 1; }

private:
    [[nodiscard]] std::int64_t& ticksOf(std::uint64_t number) { return mTicks[number % kKept]; }

    std::uint64_t lookUp(std::int64_t ticks) {
        if (const auto known = mNumbers.find(ticks); known != mNumbers.end())
            return known->second;
        if (mTicks.size() < kKept) {
            mTicks.push_back(ticks);
        } else {
            mNumbers.erase(ticksOf(mNext));
            ticksOf(mNext) = ticks;
        }
        mNumbers.emplace(ticks, mNext);
        return mNext++;
    }

    std::vector<std::int64_t> mTicks; ///< by number, modulo kKept
    std::unordered_map<std::int64_t, std::uint64_t> mNumbers;
    std::uint64_t mNext = 0;
    std::uint64_t mLast = 0; ///< that was requested
};

} // namespace detail
FBXSDK_NAMESPACE_END
