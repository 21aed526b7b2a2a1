// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Allocation and release of pages.
#include "container/PageMemory.h"

#include <algorithm>
#include <cstdint>
#include <new>

#include <sys/mman.h>
#include <unistd.h>

#if defined(__SANITIZE_ADDRESS__)
#define TARNELL_ADDRESS_SANITIZER
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define TARNELL_ADDRESS_SANITIZER
#endif
#endif
#ifdef TARNELL_ADDRESS_SANITIZER
#include <sanitizer/asan_interface.h>
#endif

FBXSDK_NAMESPACE_BEGIN
namespace detail {

namespace {

/// The whole pages of that size within the bytes.
std::span<char> wholePages(std::span<const char> bytes, std::uintptr_t pageSize) {
    const auto address = reinterpret_cast<std::uintptr_t>(bytes.data());
    const std::uintptr_t first = (address + pageSize - 1) / pageSize * pageSize;
    const std::uintptr_t end = (address + bytes.size()) / pageSize * pageSize;
    // The interface takes no constant memory.
    return first < end ? std::span(const_cast<char*>(bytes.data() + (first - address)), end - first)
                       : std::span<char>();
}

void release(std::span<char> pages) {
    if (!pages.empty()) // if the call is refused the pages stay
        ::madvise(pages.data(), pages.size(), MADV_DONTNEED);
}

} // namespace

void releasePages(std::span<const char> bytes) {
    static const auto kPageSize = static_cast<std::uintptr_t>(::sysconf(_SC_PAGESIZE));
    release(wholePages(bytes, kPageSize));
}

void releaseLargePages(std::span<const char> bytes) { release(wholePages(bytes, kLargePage)); }

void preferLargePages(std::span<char> bytes) {
    const std::span<char> pages = wholePages(bytes, kLargePage);
    if (!pages.empty())
        ::madvise(pages.data(), pages.size(), MADV_HUGEPAGE);
}

#ifdef TARNELL_ADDRESS_SANITIZER
void forbid(std::span<const char> bytes) { __asan_poison_memory_region(bytes.data(), bytes.size()); }
void allow(std::span<const char> bytes) { __asan_unpoison_memory_region(bytes.data(), bytes.size()); }
#else
void forbid(std::span<const char>) {}
void allow(std::span<const char>) {}
#endif

PageMemory::PageMemory(std::size_t size) {
    void* const memory =
        ::mmap(nullptr, std::max<std::size_t>(size, 1), PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (memory == MAP_FAILED)
        throw std::bad_alloc();
    mBytes = {static_cast<char*>(memory), size};
}

PageMemory::~PageMemory() { ::munmap(mBytes.data(), std::max<std::size_t>(mBytes.size(), 1)); }

} // namespace detail
FBXSDK_NAMESPACE_END
