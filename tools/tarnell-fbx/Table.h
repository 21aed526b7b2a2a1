// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
#pragma once

#include <ostream>
#include <string>
#include <vector>

#include "Terminal.h"

namespace tool {

/// Text tables: columns as wide as their widest cell, numbers right-aligned.
class Table {
public:
    enum class Align { left, right };
    struct Column {
        std::string title;
        Align align = Align::left;
        Ink ink = Ink::plain;
    };

    explicit Table(std::vector<Column> columns) : mColumns(std::move(columns)) {}

    /// One cell per column, without control characters.
    void addRow(std::vector<std::string> cells) { mRows.push_back(std::move(cells)); }
    [[nodiscard]] bool empty() const { return mRows.empty(); }
    /// Prints titles and rows indented by that many blanks; the last column is truncated at the end of the line.
    void print(std::ostream& out, const Terminal& terminal, std::size_t indent) const;

private:
    [[nodiscard]] std::vector<std::size_t> widths() const;

    std::vector<Column> mColumns;
    std::vector<std::vector<std::string>> mRows;
};

} // namespace tool
