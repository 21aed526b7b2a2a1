// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Numbers for the times that evaluation is asked for.
#pragma once

#include <cstdint>
#include <unordered_map>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// Gives every time a number, in the order in which they are asked for first, and remembers the latest ones. A time
/// that was forgotten gets a new number.
///
/// Whoever keeps something by time can keep it by number instead, in a list: node after node is asked for the same
/// times, forwards, backwards or in no order at all, and the numbers go up by one each time all the same.
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
    std::uint64_t mLast = 0; ///< that was asked for
};

} // namespace detail
FBXSDK_NAMESPACE_END
