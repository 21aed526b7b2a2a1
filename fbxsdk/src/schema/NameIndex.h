// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The rows of a table by name: files repeat the names of properties and types with each object.
#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

#include <fbxsdk/FbxArch.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// A name, and what a look-up compares first: its length and both ends, for a literal computed by the compiler.
class NameKey {
public:
    explicit constexpr NameKey(std::string_view name)
        : text(name), first(word(name.substr(0, kEnd))),
          last(word(name.substr(name.size() > kEnd ? name.size() - kEnd : 0))) {}
    template <std::size_t size>
    consteval NameKey(const char (&literal)[size]) : NameKey(std::string_view(literal, size - 1)) {}

    [[nodiscard]] bool matches(const NameKey& other) const {
        return first == other.first && last == other.last && text.size() == other.text.size() &&
               (text.size() <= 2 * kEnd || text == other.text);
    }
    [[nodiscard]] std::size_t hash() const {
        constexpr std::uint64_t kFactor = 0x9E3779B97F4A7C15;
        return static_cast<std::size_t>(((first * kFactor ^ last) * kFactor + text.size() * kFactor) >> 32U);
    }

    std::string_view text;

private:
    static constexpr std::size_t kEnd = sizeof(std::uint64_t);

    /// Up to eight characters, the first one lowest.
    static constexpr std::uint64_t word(std::string_view end) {
        std::uint64_t bits = 0;
        if (end.size() == kEnd) { // of a fixed length: a single load
            for (std::size_t i = 0; i < kEnd; ++i)
                bits |= std::uint64_t{static_cast<unsigned char>(end[i])} << 8 * i;
            return bits;
        }
        for (std::size_t i = 0; i < end.size(); ++i)
            bits |= std::uint64_t{static_cast<unsigned char>(end[i])} << 8 * i;
        return bits;
    }

    std::uint64_t first, last;
};

/// A hash table in place. Rows beyond `kMostRows` are not in it.
class NameIndex {
public:
    static constexpr std::size_t kMostRows = 192;

    template <class Row, class NameOf>
    NameIndex(std::span<const Row> rows, const NameOf& nameOf) {
        mNames.reserve(std::min(rows.size(), kMostRows));
        for (const Row& row : rows.first(std::min(rows.size(), kMostRows)))
            add(NameKey(std::string_view(nameOf(row))));
    }

    /// -1 when there is none. Of several rows of one name the first.
    [[nodiscard]] int find(const NameKey& name) const;

private:
    static constexpr std::size_t kSlots = 512;

    void add(const NameKey& name);

    std::array<std::uint8_t, kSlots> mSlots{}; ///< 0: free; else 1 more than the row
    std::vector<NameKey> mNames;               ///< of the rows
};

} // namespace detail
FBXSDK_NAMESPACE_END
