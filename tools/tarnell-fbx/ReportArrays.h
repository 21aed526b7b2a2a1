// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <ostream>
#include <string>
#include <vector>

namespace tool {

/// The large numeric data of a report: typed arrays, one after the other, which its page holds as one text.
class ReportArrays {
public:
    /// The offset of an array in bytes; a multiple of four, as browsers require for arrays of floats.
    template <class Number>
    std::size_t add(const std::vector<Number>& numbers) {
        const std::size_t at = mBytes.size();
        mBytes.resize(at + (numbers.size() * sizeof(Number) + 3) / 4 * 4);
        if (!numbers.empty())
            std::memcpy(mBytes.data() + at, numbers.data(), numbers.size() * sizeof(Number));
        return at;
    }

    [[nodiscard]] std::size_t size() const { return mBytes.size(); }

    /// Base64 of all of it; the numbers are little-endian.
    void write(std::ostream& out) const;

private:
    std::vector<std::uint8_t> mBytes;
};

} // namespace tool
