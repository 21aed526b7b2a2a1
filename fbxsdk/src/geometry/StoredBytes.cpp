// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays that are read, let go, and read again.
#include "geometry/StoredBytes.h"

#include <algorithm>

#include "container/NumberDecoding.h"
#include "container/ZlibStream.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

LoadedBytes::LoadedBytes(std::shared_ptr<const FileBytes> file, const StoredArray& array)
    : mFile(std::move(file)), mArray(array),
      mMemory(static_cast<std::size_t>(array.count) * elementSize(array.element)) {
    load();
}

void LoadedBytes::load() {
    if (mArray.compressed) {
        std::unique_ptr<char[]> memory;
        mSound = inflateExactly(payloadOf(mArray, memory), mMemory.bytes());
    } else {
        mFile->read(mArray.bytes, mMemory.bytes().data());
        mSound = true;
    }
    if (!mSound)
        std::fill(mMemory.bytes().begin(), mMemory.bytes().end(), '\0');
}

void LoadedBytes::release(std::span<const char> part) {
    if (mStays || part.empty())
        return;
    releasePages(part);
    mIncomplete = true;
}

void LoadedBytes::restore() {
    if (!mIncomplete)
        return;
    load();
    mIncomplete = false;
    mStays = true;
}

} // namespace detail
FBXSDK_NAMESPACE_END
