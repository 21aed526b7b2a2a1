// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Pages from the system and back.
#include "container/PageMemory.h"

#include <algorithm>
#include <cstdint>
#include <new>

#include <sys/mman.h>
#include <unistd.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

void releasePages(std::span<const char> bytes) {
    static const auto kPageSize = static_cast<std::uintptr_t>(::sysconf(_SC_PAGESIZE));
    const auto address = reinterpret_cast<std::uintptr_t>(bytes.data());
    const std::uintptr_t first = (address + kPageSize - 1) / kPageSize * kPageSize;
    const std::uintptr_t end = (address + bytes.size()) / kPageSize * kPageSize;
    if (first < end) {
        // The interface knows no constant memory. A refusal leaves the pages where they are.
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
