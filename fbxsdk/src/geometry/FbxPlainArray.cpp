// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Memory by realloc: large arrays grow without being copied, and new items cost nothing until they are written.
#include <fbxsdk/FbxPlainArray.h>

#include <climits>
#include <cstdlib>
#include <cstring>
#include <new>

#include "geometry/StoredBytes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr int kSmallestCapacity = 8;

/// How many items are kept at hand while they are read in order: an eighth, of long arrays less, but enough that asking
/// the system costs nothing beside them.
int windowSize(int count, std::size_t itemBytes) {
    constexpr std::size_t kMostBytes = std::size_t{1} << 18;
    return std::min(count / 8 + 2, static_cast<int>(kMostBytes / itemBytes));
}

std::byte* itemAt(void* items, int index, std::size_t itemSize) {
    return static_cast<std::byte*>(items) + static_cast<std::size_t>(index) * itemSize;
}

/// Half as much again, so that adding items one by one costs a constant each.
int grownCapacity(int capacity, int needed) {
    const int grown = capacity > INT_MAX / 3 * 2 ? INT_MAX : capacity + capacity / 2;
    return std::max({grown, needed, kSmallestCapacity});
}

} // namespace

StoredItems::StoredItems(std::unique_ptr<StoredBytes> pSource, int pCount, std::size_t pItemBytes)
    : mSource(std::move(pSource)), mItemBytes(pItemBytes), mCount(pCount) {}

StoredItems::~StoredItems() { releaseUpTo(mCount); }

/// Releases the items up to an index, those before the window for the second time: they may share a page with others.
void StoredItems::releaseUpTo(int pEnd) {
    constexpr std::size_t kLargestPage = std::size_t{1} << 16;
    const std::size_t start = static_cast<std::size_t>(mWindowStart) * mItemBytes;
    const std::size_t from = start - std::min(start, kLargestPage);
    mSource->release(mSource->bytes().subspan(from, static_cast<std::size_t>(pEnd) * mItemBytes - from));
}

// An index a little behind the window moves it along, so that half of it lies on either side of the index. The first
// index starts over. With any other one there is no order, and everything stays at hand from then on.
//
// The last item is in the window only when it has been asked for: then most of the others are released with it.
void StoredItems::moveWindow(int pIndex) {
    const int size = windowSize(mCount, mItemBytes);
    const int end = mWindowStart + mWindowSize;
    int start = 0;
    if (pIndex >= end && pIndex - end < size / 2) {
        start = std::max(mWindowStart, pIndex - size / 2);
        releaseUpTo(start);
    } else {
        mSource->restore();
    }
    const int last = mCount - 1;
    const bool ordered = start > 0 || pIndex < size;
    const int count = !ordered || pIndex == last ? mCount - start : std::min(size, last - start);
    mWindowSize = 0; // should the source fail
    mWindow = mSource->look(mSource->bytes().subspan(static_cast<std::size_t>(start) * mItemBytes,
                                                     static_cast<std::size_t>(count) * mItemBytes));
    mWindowStart = start;
    mWindowSize = count;
}

PlainStorage::PlainStorage() = default;
PlainStorage::~PlainStorage() { std::free(mItems); }

void PlainStorage::store(std::unique_ptr<StoredItems> pItems, int pCount) {
    mStored = std::move(pItems);
    mCount = pCount;
}

void* PlainStorage::roomForStored(std::size_t pItemSize) const {
    allocate(mCount, pItemSize); // where there is no memory, the items are still in the file
    return mItems;
}

void PlainStorage::leaveFile() const { mStored.reset(); }

void PlainStorage::forgetStored() {
    if (mStored) {
        mStored.reset();
        mCount = 0;
    }
}

void PlainStorage::reserveItems(int pCapacity, std::size_t pItemSize) { allocate(pCapacity, pItemSize); }

void PlainStorage::allocate(int pCapacity, std::size_t pItemSize) const {
    if (pCapacity <= mCapacity)
        return;
    void* grown = std::realloc(mItems, static_cast<std::size_t>(pCapacity) * pItemSize);
    if (!grown)
        throw std::bad_alloc();
    mItems = grown;
    mCapacity = pCapacity;
}

void PlainStorage::resizeItems(int pCount, std::size_t pItemSize) {
    reserveItems(pCount, pItemSize);
    mCount = std::max(pCount, 0);
}

void* PlainStorage::openSlot(int pIndex, std::size_t pItemSize) {
    if (mCount == INT_MAX)
        throw std::bad_alloc();
    if (mCount == mCapacity)
        reserveItems(grownCapacity(mCapacity, mCount + 1), pItemSize);
    std::byte* slot = itemAt(mItems, pIndex, pItemSize);
    std::memmove(slot + pItemSize, slot, static_cast<std::size_t>(mCount - pIndex) * pItemSize);
    ++mCount;
    return slot;
}

void PlainStorage::closeSlots(int pIndex, int pCount, std::size_t pItemSize) {
    const int first = std::clamp(pIndex, 0, mCount);
    const int count = std::clamp(pCount, 0, mCount - first);
    if (count == 0)
        return;
    std::memmove(itemAt(mItems, first, pItemSize), itemAt(mItems, first + count, pItemSize),
                 static_cast<std::size_t>(mCount - first - count) * pItemSize);
    mCount -= count;
}

} // namespace detail
FBXSDK_NAMESPACE_END
