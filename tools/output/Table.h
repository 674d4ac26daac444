// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Rows of cells in columns as wide as their widest cell, for people at a terminal.

#pragma once

#include "tools/output/Emphasis.h"

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

namespace Tools {

// What stands where there is nothing to show.
inline constexpr const char* absent = "-";

struct Cell {
    std::string text; // printable
    Emphasis emphasis = Emphasis::none;
};

struct Column {
    enum class Alignment { left, right };

    std::string title;
    Alignment alignment = Alignment::left;
    std::size_t gap = 2; // blanks before it
};

class Table {
public:
    explicit Table(std::vector<Column> columns) : columns_(std::move(columns)) {}

    // REQUIRES: as many cells as there are columns.
    void add(std::vector<Cell> cells) { rows_.push_back(std::move(cells)); }

    // Title line and rows, each ended by a line feed and without blanks at its end. Where the
    // lines would be wider than the width, the first column gives way, down to a few
    // characters; the other columns are never cut.
    std::string toText(std::size_t width, bool isColored) const;

private:
    std::vector<std::size_t> columnWidths(std::size_t width) const;
    void appendLine(std::string& text, const std::vector<Cell>& cells,
        const std::vector<std::size_t>& widths, bool isColored) const;

    std::vector<Column> columns_;
    std::vector<std::vector<Cell>> rows_;
};

} // namespace Tools
