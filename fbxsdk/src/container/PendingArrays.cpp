// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "container/PendingArrays.h"

#include <utility>

#include <fbxsdk/extensions/Threads.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// For each thread: what waits to be encoded or to be written.
constexpr std::size_t kMostPendingBytes = std::size_t{4} << 20;

} // namespace

std::size_t PendingArrays::workers() {
    if (!mQueue && extensions::maximumThreads() == 1)
        return 1;
    if (!mQueue)
        mQueue = std::make_unique<WorkQueue>(kMostPendingBytes);
    return mQueue->workers();
}

void PendingArrays::add(std::size_t size, Encode encode) {
    PendingArray& array = mArrays.emplace_back();
    mQueue->add(size, [&array, encode = std::move(encode)](std::size_t worker) {
        array.bytes = encode(worker);
        return array.bytes.size();
    });
}

bool PendingArrays::isFirstDue() {
    if (isEmpty())
        return false;
    while (!mQueue->isFirstDone()) {
        if (!mQueue->isFull())
            return false;
        if (!mQueue->workOnOne())
            return true;
    }
    return true;
}

PendingArray PendingArrays::takeFirst() {
    mQueue->takeFirst();
    PendingArray first = std::move(mArrays.front());
    mArrays.pop_front();
    return first;
}

} // namespace detail
FBXSDK_NAMESPACE_END
