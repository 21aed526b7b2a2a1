// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Replaces the system's functions, which are called under their internal names.
#include "FailingMalloc.h"

#include <atomic>
#include <cerrno>
#include <cstddef>
#include <limits>

// NOLINTBEGIN(bugprone-reserved-identifier): the names of the C library
extern "C" {
void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* memory, std::size_t size);
}
// NOLINTEND(bugprone-reserved-identifier)

namespace {

constexpr long kNever = std::numeric_limits<long>::max();

std::atomic<long> gCount{0}, gFirst{kNever}, gEnd{0};

bool fails() {
    const long number = gCount.fetch_add(1, std::memory_order_relaxed);
    if (number < gFirst.load(std::memory_order_relaxed) || number >= gEnd.load(std::memory_order_relaxed))
        return false;
    errno = ENOMEM;
    return true;
}

} // namespace

extern "C" {
void* malloc(std::size_t size) { return fails() ? nullptr : __libc_malloc(size); }
void* calloc(std::size_t count, std::size_t size) { return fails() ? nullptr : __libc_calloc(count, size); }
void* realloc(void* memory, std::size_t size) { return fails() ? nullptr : __libc_realloc(memory, size); }
}

long faults::countAllocations() { return gCount.exchange(0); }

void faults::failAllocation(long number, bool andAllBehind) {
    gCount = 0;
    gEnd = andAllBehind ? kNever : number + 1;
    gFirst = number;
}

void faults::failNoAllocation() {
    gFirst = kNever;
    gEnd = 0;
}
