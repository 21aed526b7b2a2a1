// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// A canvas of Braille characters: U+2800 and a bit for each dot.
#include "Plot.h"

#include <algorithm>
#include <cmath>
#include <optional>

namespace tool {
namespace {

constexpr std::size_t kAcross = 2, kDown = 4;

/// The bit of each dot, in columns from the top.
constexpr unsigned kDots[kAcross][kDown] = {{0x01, 0x02, 0x04, 0x40}, {0x08, 0x10, 0x20, 0x80}};

class Canvas {
public:
    Canvas(std::size_t columns, std::size_t rows) : mColumns(columns), mCells(columns * rows) {}

    void set(std::size_t x, std::size_t y) {
        mCells[y / kDown * mColumns + x / kAcross] |= kDots[x % kAcross][y % kDown];
    }
    [[nodiscard]] std::vector<std::string> lines() const {
        std::vector<std::string> lines;
        for (std::size_t start = 0; start < mCells.size(); start += mColumns) {
            std::string line;
            for (std::size_t i = start; i < start + mColumns; ++i) {
                line += '\xE2';
                line += static_cast<char>(0xA0U | mCells[i] >> 6U);
                line += static_cast<char>(0x80U | (mCells[i] & 0x3FU));
            }
            lines.push_back(line);
        }
        return lines;
    }

private:
    std::size_t mColumns;
    std::vector<unsigned> mCells;
};

struct Range {
    double low = INFINITY, high = -INFINITY;
};

Range rangeOf(const std::vector<double>& values) {
    Range range;
    for (const double value : values)
        if (std::isfinite(value))
            range = {std::min(range.low, value), std::max(range.high, value)};
    return range;
}

} // namespace

std::vector<std::string> brailleLines(const std::vector<double>& values, std::size_t columns, std::size_t rows) {
    Canvas canvas(columns, rows);
    const Range range = rangeOf(values);
    const double lowest = static_cast<double>(rows * kDown - 1);
    // Halves, so that the span of the largest numbers does not overflow.
    const double span = range.high / 2 - range.low / 2;
    std::optional<std::size_t> before;
    for (std::size_t x = 0; x < columns * kAcross && !values.empty(); ++x) {
        const double value = values[x * (values.size() - 1) / std::max<std::size_t>(columns * kAcross - 1, 1)];
        if (!std::isfinite(value)) {
            before.reset();
            continue;
        }
        const double part = span > 0.0 ? (range.high / 2 - value / 2) / span : 0.5;
        const auto y = static_cast<std::size_t>(std::lround(part * lowest));
        const std::size_t from = before.value_or(y);
        // Up to the height of the last dot, so that steep curves have no gaps.
        for (std::size_t each = std::min(from, y); each <= std::max(from, y); ++each)
            canvas.set(x, each);
        before = y;
    }
    return canvas.lines();
}

} // namespace tool
