// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "geometry/StoredItems.h"

#include <algorithm>

#include "container/PageMemory.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// How many items the window has while they are read in order: an eighth, of long arrays less, but enough that system
/// calls take little time in comparison.
int windowSize(int count, std::size_t itemBytes) {
    constexpr std::size_t kMostBytes = std::size_t{1} << 18;
    return std::min(count / 8 + 2, static_cast<int>(kMostBytes / itemBytes));
}

/// Up to this size, an array is released when its last item is read: every release interrupts the other threads.
constexpr std::size_t kReleasedAtOnce = std::size_t{1} << 20;
static_assert(kReleasedAtOnce <= kLargePage); // a release includes what lies that far before the window

} // namespace

StoredWindow::~StoredWindow() {
    if (mBytes)
        releaseUpTo(mCount);
}

/// Releases the items up to an index, those before the window for the second time: they may share a page with others.
void StoredWindow::releaseUpTo(int end) {
    const std::size_t start = static_cast<std::size_t>(mWindowStart) * mItemBytes;
    const std::size_t from = start - std::min(start, kLargePage);
    mBytes->release(mBytes->bytes().subspan(from, static_cast<std::size_t>(end) * mItemBytes - from));
}

// An index shortly after the window moves it, so that half of it lies on either side of the index. The first
// index starts over. With any other one the order is lost, and everything stays in memory from then on.
//
// The last item is in the window only when it has been read: then most of the others are released with it.
void StoredWindow::moveWindow(int index) {
    const int size = windowSize(mCount, mItemBytes);
    const int end = mWindowStart + mWindowSize;
    int start = 0;
    if (index >= end && index - end < size / 2) {
        start = std::max(mWindowStart, index - size / 2);
        if (index == mCount - 1 || mBytes->bytes().size() > kReleasedAtOnce)
            releaseUpTo(start);
    } else {
        mBytes->restore();
    }
    const int last = mCount - 1;
    const bool ordered = start > 0 || index < size;
    const int count = !ordered || index == last ? mCount - start : std::min(size, last - start);
    mWindowSize = 0; // in case the source fails
    mWindow = mBytes->look(mBytes->bytes().subspan(static_cast<std::size_t>(start) * mItemBytes,
                                                   static_cast<std::size_t>(count) * mItemBytes));
    mWindowStart = start;
    mWindowSize = count;
}

} // namespace detail
FBXSDK_NAMESPACE_END
