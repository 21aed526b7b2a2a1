// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Counting allocations: the program's own malloc and related functions, which the shared libraries call as well,
// replace those of the C library. Counting instructions: requests to valgrind, which do nothing outside of it.
#include "Measurement.h"

#include <atomic>
#include <cerrno>
#include <cstddef>
#include <fstream>
#include <string>

#if __has_include(<valgrind/callgrind.h>)
#include <valgrind/callgrind.h>
#else
#define CALLGRIND_START_INSTRUMENTATION
#define CALLGRIND_STOP_INSTRUMENTATION
#endif

// The C library's own, under the names that it keeps for this.
extern "C" {
void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* memory, std::size_t size);
void* __libc_memalign(std::size_t alignment, std::size_t size);
void __libc_free(void* memory);
}

namespace {

std::atomic<std::uint64_t> allocations{0};

void count() { allocations.fetch_add(1, std::memory_order_relaxed); }

} // namespace

extern "C" {
void* malloc(std::size_t size) {
    count();
    return __libc_malloc(size);
}
void* calloc(std::size_t number, std::size_t size) {
    count();
    return __libc_calloc(number, size);
}
void* realloc(void* memory, std::size_t size) {
    count();
    return __libc_realloc(memory, size);
}
void* memalign(std::size_t alignment, std::size_t size) {
    count();
    return __libc_memalign(alignment, size);
}
void* aligned_alloc(std::size_t alignment, std::size_t size) { return memalign(alignment, size); }
int posix_memalign(void** memory, std::size_t alignment, std::size_t size) {
    *memory = memalign(alignment, size);
    return *memory != nullptr ? 0 : ENOMEM;
}
void free(void* memory) { __libc_free(memory); }
}

namespace bench {

std::uint64_t allocationCount() { return allocations.load(std::memory_order_relaxed); }

long long peakKilobytes() {
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);)
        if (line.rfind("VmHWM:", 0) == 0)
            return std::stoll(line.substr(6));
    return 0;
}

CountedInstructions::CountedInstructions() { CALLGRIND_START_INSTRUMENTATION; }

CountedInstructions::~CountedInstructions() { CALLGRIND_STOP_INSTRUMENTATION; }

} // namespace bench
