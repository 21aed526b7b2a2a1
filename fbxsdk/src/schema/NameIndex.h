// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The rows of a class by name: files name a class's properties again with each of its objects.
#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <string_view>

#include "schema/PropertyRow.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A hash table in place. Rows beyond `kMostRows` are not in it.
class RowIndex {
public:
    static constexpr std::size_t kMostRows = 192;

    explicit RowIndex(std::span<const PropertyRow> rows);

    /// -1 when there is none. Of several rows of one name the first.
    [[nodiscard]] int find(std::string_view name) const;

private:
    static constexpr std::size_t kSlots = 512;

    std::span<const PropertyRow> mRows;
    std::array<std::uint8_t, kSlots> mSlots{}; ///< 0: free; else 1 more than the row
    std::array<std::uint8_t, kMostRows> mLengths{};
};

} // namespace detail
FBXSDK_NAMESPACE_END
