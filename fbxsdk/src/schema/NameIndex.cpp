// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "object/RowIndex.h"

#include <algorithm>
#include <cstring>
#include <limits>

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// From the length and both ends of a name: in the middle they are alike.
std::size_t hashOf(std::string_view name) {
    constexpr std::uint64_t kFactor = 0x9E3779B97F4A7C15;
    std::uint64_t first = 0, last = 0;
    const std::size_t size = std::min(name.size(), sizeof first);
    if (size != 0) {
        std::memcpy(&first, name.data(), size);
        std::memcpy(&last, name.data() + name.size() - size, size);
    }
    return static_cast<std::size_t>(((first * kFactor ^ last) * kFactor + name.size() * kFactor) >> 32U);
}

} // namespace

RowIndex::RowIndex(std::span<const PropertyRow> rows) : mRows(rows.first(std::min(rows.size(), kMostRows))) {
    for (std::size_t row = 0; row < mRows.size(); ++row) {
        const std::string_view name = mRows[row].name;
        if (name.size() > std::numeric_limits<std::uint8_t>::max() || find(name) >= 0)
            continue;
        std::size_t slot = hashOf(name) % kSlots;
        while (mSlots[slot] != 0)
            slot = (slot + 1) % kSlots;
        mLengths[row] = static_cast<std::uint8_t>(name.size());
        mSlots[slot] = static_cast<std::uint8_t>(row + 1);
    }
}

int RowIndex::find(std::string_view name) const {
    for (std::size_t slot = hashOf(name) % kSlots; mSlots[slot] != 0; slot = (slot + 1) % kSlots) {
        const auto row = static_cast<std::size_t>(mSlots[slot] - 1);
        if (mLengths[row] == name.size() && std::memcmp(mRows[row].name, name.data(), name.size()) == 0)
            return static_cast<int>(row);
    }
    return -1;
}

} // namespace detail
FBXSDK_NAMESPACE_END
