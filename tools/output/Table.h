// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A table whose columns are as wide as their widest cell.

#pragma once

#include "tools/output/Emphasis.h"

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

namespace Tools {

// The text of a missing value.
inline constexpr const char* absent = "-";

struct Cell {
    std::string text; // printable
    Emphasis emphasis = Emphasis::none;
};

struct Column {
    enum class Alignment { left, right };

    std::string title;
    Alignment alignment = Alignment::left;
    std::size_t gap = 2; // number of blanks before the column
};

class Table {
public:
    explicit Table(std::vector<Column> columns) : columns_(std::move(columns)) {}

    // REQUIRES: as many cells as there are columns.
    void add(std::vector<Cell> cells) { rows_.push_back(std::move(cells)); }

    // Returns a line of titles and the rows, each with a line feed and without trailing blanks.
    // Shortens the first column, down to a few characters, to keep lines within the width.
    std::string toText(std::size_t width, bool isColored) const;

private:
    std::vector<std::size_t> columnWidths(std::size_t width) const;
    void appendLine(std::string& text, const std::vector<Cell>& cells,
        const std::vector<std::size_t>& widths, bool isColored) const;

    std::vector<Column> columns_;
    std::vector<std::vector<Cell>> rows_;
};

} // namespace Tools
