// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays that are read, released, and read again.
#include "geometry/StoredBytes.h"

#include <algorithm>
#include <cstring>
#include <functional>

#include "container/NumberDecoding.h"
#include "container/ZlibStream.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// The offset of a place in the bytes; their size for any other.
std::size_t distanceInto(std::span<const char> bytes, const char* place) {
    const std::less<const char*> before; // also for pointers into different objects
    const bool within = !before(place, bytes.data()) && before(place, bytes.data() + bytes.size());
    return within ? static_cast<std::size_t>(place - bytes.data()) : bytes.size();
}

} // namespace

const char* FileWindow::look(std::span<const char> part) {
    if (mSize < part.size()) {
        mSize = 0;
        mLast = {};
        mMemory = std::make_unique_for_overwrite<char[]>(part.size());
        mSize = part.size();
    }
    // Windows overlap, since items are accessed only roughly in order.
    const std::size_t kept = mLast.size() - std::min(mLast.size(), distanceInto(mLast, part.data()));
    const std::size_t size = std::min(kept, part.size());
    std::memmove(mMemory.get(), mMemory.get() + (mLast.size() - kept), size);
    mLast = {}; // in case the file fails
    mFile->read(part.subspan(size), mMemory.get() + size);
    mLast = part;
    return mMemory.get();
}

InflatedBytes::InflatedBytes(std::shared_ptr<const FileBytes> file, const StoredArray& array)
    : mFile(std::move(file)), mArray(array),
      mMemory(static_cast<std::size_t>(array.count) * elementSize(array.element)) {
    preferLargePages(mMemory.bytes());
    inflate();
}

void InflatedBytes::inflate() {
    std::unique_ptr<char[]> memory;
    mSound = inflateExactly(payloadOf(mArray, memory), mMemory.bytes());
    if (!mSound)
        std::fill(mMemory.bytes().begin(), mMemory.bytes().end(), '\0');
}

void InflatedBytes::release(std::span<const char> part) {
    if (mStays || part.empty())
        return;
    const bool hasLargePages = mMemory.bytes().size() >= 2 * kLargePage; // one at least, wherever it begins
    (hasLargePages ? releaseLargePages : releasePages)(part);
    mIncomplete = true;
}

void InflatedBytes::restore() {
    if (!mIncomplete)
        return;
    inflate();
    mIncomplete = false;
    mStays = true;
}

} // namespace detail
FBXSDK_NAMESPACE_END
