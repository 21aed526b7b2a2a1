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

void releasePages(std::span<const char> bytes) {
    static const auto kPageSize = static_cast<std::uintptr_t>(::sysconf(_SC_PAGESIZE));
    const auto address = reinterpret_cast<std::uintptr_t>(bytes.data());
    const std::uintptr_t first = (address + kPageSize - 1) / kPageSize * kPageSize;
    const std::uintptr_t end = (address + bytes.size()) / kPageSize * kPageSize;
    if (first < end) {
        // The interface takes no constant memory. If the call is refused the pages stay.
        ::madvise(const_cast<char*>(bytes.data() + (first - address)), end - first, MADV_DONTNEED);
    }
}

void preferLargePages(std::span<char> bytes) {
    constexpr std::uintptr_t kLargePage = std::uintptr_t{1} << 21;
    const auto address = reinterpret_cast<std::uintptr_t>(bytes.data());
    const std::uintptr_t first = (address + kLargePage - 1) / kLargePage * kLargePage;
    const std::uintptr_t end = (address + bytes.size()) / kLargePage * kLargePage;
    if (first < end) {
        ::madvise(bytes.data() + (first - address), end - first, MADV_HUGEPAGE);
    }
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
    if (memory == MAP_FAILED) {
        throw std::bad_alloc();
    }
    mBytes = {static_cast<char*>(memory), size};
}

PageMemory::~PageMemory() { ::munmap(mBytes.data(), std::max<std::size_t>(mBytes.size(), 1)); }

} // namespace detail
FBXSDK_NAMESPACE_END
