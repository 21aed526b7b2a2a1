// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Memory by realloc: large arrays grow without being copied, and new items take no memory until they are written.
#include <fbxsdk/FbxPlainArray.h>

#include <climits>
#include <cstdlib>
#include <cstring>
#include <new>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

constexpr int kSmallestCapacity = 8;

std::byte* itemAt(void* items, int index, std::size_t itemSize) {
    return static_cast<std::byte*>(items) + static_cast<std::size_t>(index) * itemSize;
}

/// Grows by half, so that appending items one by one takes constant time each.
int grownCapacity(int capacity, int needed) {
    const int grown = capacity > INT_MAX / 3 * 2 ? INT_MAX : capacity + capacity / 2;
    return std::max({grown, needed, kSmallestCapacity});
}

} // namespace

ItemSource::~ItemSource() = default;

PlainStorage::PlainStorage() = default;
PlainStorage::~PlainStorage() { std::free(mItems); }

void PlainStorage::setSource(std::unique_ptr<ItemSource> pSource) {
    clearItems();
    mSource = std::move(pSource);
}

bool PlainStorage::reach(int pIndex) const {
    if (isPending())
        open();
    if (mSource)
        mSource->moveWindow(pIndex);
    return mSource != nullptr;
}

void PlainStorage::open() const {
    if (mSource->show())
        mCount = mSource->count();
    else
        readSource();
}

void PlainStorage::readSource() const {
    const int count = mSource->count();
    allocate(count, mSource->itemSize());
    const bool sound = mSource->read(mItems);
    mSource.reset(); // not before all of them are read: a file may have been changed
    mCount = sound ? count : 0;
}

void PlainStorage::clearItems() {
    mSource.reset();
    mCount = 0;
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
