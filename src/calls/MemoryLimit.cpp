// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "MemoryLimit.h"

#include "TnFbxLimits.h"

#include <unistd.h>

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdio>
#include <limits>

namespace Tarnell::Fbx {

namespace {

std::atomic<std::uint64_t> chosenLimit{0}; // 0: the default

std::uint64_t halfOfTheMemory() {
    const long pages = sysconf(_SC_PHYS_PAGES);
    const long pageSize = sysconf(_SC_PAGESIZE);
    if (pages <= 0 || pageSize <= 0)
        return std::numeric_limits<std::uint64_t>::max();
    return static_cast<std::uint64_t>(pages) / 2 * static_cast<std::uint64_t>(pageSize);
}

} // namespace

std::uint64_t memoryLimit() {
    const std::uint64_t limit = chosenLimit.load(std::memory_order_relaxed);
    return limit != 0 ? limit : halfOfTheMemory();
}

void setMemoryLimit(std::uint64_t bytes) { chosenLimit.store(bytes, std::memory_order_relaxed); }

void detail::MemoryAccount::begin() {
    mNeeded = 0;
    mLimit = memoryLimit();
}

bool detail::MemoryAccount::take(std::uint64_t bytes) {
    constexpr std::uint64_t most = std::numeric_limits<std::uint64_t>::max();
    mNeeded = bytes > most - mNeeded ? most : mNeeded + bytes;
    return !exceeded();
}

std::string detail::MemoryAccount::describe(const char* what) const {
    return describeBytes(mNeeded) + " of " + what + " would be needed; the limit is " + describeBytes(mLimit);
}

std::string detail::describeBytes(std::uint64_t bytes) {
    if (bytes < 1024)
        return std::to_string(bytes) + " bytes";
    constexpr std::array<const char*, 6> units = {"KiB", "MiB", "GiB", "TiB", "PiB", "EiB"};
    double amount = static_cast<double>(bytes) / 1024.0;
    std::size_t unit = 0;
    while (amount >= 1024.0 && unit + 1 < units.size()) {
        amount /= 1024.0;
        ++unit;
    }
    std::array<char, 32> text{};
    std::snprintf(text.data(), text.size(), "%.1f ", amount);
    return text.data() + std::string(units[unit]);
}

} // namespace Tarnell::Fbx
