// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#include "Table.h"

#include <algorithm>

#include "Utf8.h"

namespace tool {

std::vector<std::size_t> Table::widths() const {
    std::vector<std::size_t> widths;
    for (std::size_t i = 0; i < mColumns.size(); ++i) {
        std::size_t width = displayWidth(mColumns[i].title);
        for (const auto& row : mRows)
            width = std::max(width, displayWidth(row[i]));
        widths.push_back(width);
    }
    return widths;
}

void Table::print(std::ostream& out, const Terminal& terminal, std::size_t indent) const {
    const std::vector<std::size_t> width = widths();
    const auto printRow = [&](const std::vector<std::string>& cells, bool isTitle) {
        std::size_t taken = indent;
        std::string line(indent, ' '), blanks;
        for (std::size_t i = 0; i < cells.size(); ++i) {
            const std::string text = i + 1 == cells.size() ? terminal.fit(cells[i], taken) : cells[i];
            const std::string padding(width[i] - std::min(width[i], displayWidth(text)), ' ');
            const bool toTheRight = mColumns[i].align == Align::right;
            // Blanks are written only when something follows them.
            line += text.empty() ? "" : blanks + (toTheRight ? padding : "");
            if (!text.empty())
                blanks.clear();
            if (text.empty() || !toTheRight)
                blanks += padding;
            line += terminal.paint(isTitle ? Ink::faint : mColumns[i].ink, text);
            blanks += "  ";
            taken += width[i] + 2;
        }
        out << line << '\n';
    };
    std::vector<std::string> titles;
    for (const Column& column : mColumns)
        titles.push_back(column.title);
    printRow(titles, /*isTitle=*/true);
    for (const auto& row : mRows)
        printRow(row, /*isTitle=*/false);
}

} // namespace tool
