// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Arrays that are inflated, let go, and inflated again.
#include "geometry/StoredBytes.h"

#include <algorithm>

#include "container/NumberDecoding.h"
#include "container/ZlibStream.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

InflatedBytes::InflatedBytes(std::shared_ptr<const MappedFile> file, const StoredArray& array)
    : mFile(std::move(file)), mStream(array.bytes),
      mMemory(static_cast<std::size_t>(array.count) * elementSize(array.element)) {
    inflate();
}

void InflatedBytes::inflate() {
    mSound = inflateExactly(mStream, mMemory.bytes());
    mFile->release(mStream);
    if (!mSound)
        std::fill(mMemory.bytes().begin(), mMemory.bytes().end(), '\0');
}

void InflatedBytes::release(std::span<const char> part) {
    if (mStays || part.empty())
        return;
    releasePages(part);
    mIncomplete = true;
}

void InflatedBytes::restore() {
    if (!mIncomplete)
        return;
    mIncomplete = false;
    mStays = true;
    inflate();
}

} // namespace detail
FBXSDK_NAMESPACE_END
