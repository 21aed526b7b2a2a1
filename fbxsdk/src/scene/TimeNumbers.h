// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Consecutive numbers for the times at which transforms are evaluated.
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
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
        if (2 * mTicks.size() >= mPlaces.size() && mTicks.size() < kKept)
            grow();
        if (const std::uint64_t known = mPlaces[find(ticks)]; known != kFree)
            return known;
        if (mTicks.size() < kKept) {
            mTicks.push_back(ticks);
        } else {
            free(find(ticksOf(mNext)));
            ticksOf(mNext) = ticks;
        }
        mPlaces[find(ticks)] = mNext;
        return mNext++;
    }

    // A hash table without memory of its own for each time: most numbers of long clips are needed a few times only.

    /// Where the search for a time begins.
    [[nodiscard]] std::size_t homeOf(std::int64_t ticks) const {
        constexpr std::uint64_t kScatter = 0x9E3779B97F4A7C15; // 2⁶⁴ by the golden ratio
        return static_cast<std::size_t>((static_cast<std::uint64_t>(ticks) * kScatter) >> 32U) & (mPlaces.size() - 1);
    }

    /// The place of the time's number, or the free one where it belongs.
    [[nodiscard]] std::size_t find(std::int64_t ticks) {
        std::size_t place = homeOf(ticks);
        while (mPlaces[place] != kFree && ticksOf(mPlaces[place]) != ticks)
            place = next(place);
        return place;
    }

    [[nodiscard]] std::size_t next(std::size_t place) const { return (place + 1) & (mPlaces.size() - 1); }

    /// Frees a place; numbers after it move up where the search for them would end there.
    void free(std::size_t place) {
        for (std::size_t each = next(place); mPlaces[each] != kFree; each = next(each)) {
            const std::size_t fromHome = (each - homeOf(ticksOf(mPlaces[each]))) & (mPlaces.size() - 1);
            if (fromHome < ((each - place) & (mPlaces.size() - 1)))
                continue;
            mPlaces[place] = mPlaces[each];
            place = each;
        }
        mPlaces[place] = kFree;
    }

    void grow() {
        constexpr std::size_t kFirstPlaces = 16;
        mPlaces.assign(std::max(kFirstPlaces, 2 * mPlaces.size()), kFree);
        for (std::uint64_t number = 0; number < mNext; ++number) // all of them are kept so far
            mPlaces[find(ticksOf(number))] = number;
    }

    static constexpr std::uint64_t kFree = UINT64_MAX;

    std::vector<std::int64_t> mTicks;   ///< by number, modulo kKept
    std::vector<std::uint64_t> mPlaces; ///< numbers by the hash of their times; a power of two, half of them free
    std::uint64_t mNext = 0;
    std::uint64_t mLast = 0; ///< that was requested
};

} // namespace detail
FBXSDK_NAMESPACE_END
