// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A table whose columns are as wide as their widest cell.

#pragma once

#include "tools/output/Emphasis.h"
#include "tools/output/TextStyle.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Tools {

// The text of a missing value.
inline constexpr const char* absent = "-";

struct Cell {
    std::string text; // printable
    Emphasis emphasis = Emphasis::none;
};

// The cells of a line with their padding.
using Line = std::vector<Cell>;

struct Column {
    enum class Alignment { left, right };

    std::string title;
    Alignment alignment = Alignment::left;
    std::size_t gap = 2; // number of blanks before the column
};

class Table {
public:
    explicit Table(std::vector<Column> columns);

    // REQUIRES: as many cells as there are columns.
    void add(std::vector<Cell> cells);
    // Adds a line whose cells ignore the columns.
    void addHeading(std::vector<Cell> cells) { rows_.push_back({std::move(cells), true}); }

    // Returns the width of the lines whose first column has that minimal width at most.
    std::size_t width(std::size_t minimumOfFirst) const;

    // Returns a line of titles and the rows, without trailing blanks. Shortens the first column,
    // down to a few characters, and headings to keep lines within the width.
    std::vector<Line> lines(const TextStyle& style) const;

    // Returns the lines, each with a line feed.
    std::string toText(const TextStyle& style) const;

private:
    struct Row {
        std::vector<Cell> cells;
        bool isHeading;
    };

    template <typename Visitor>
    void visitLines(const TextStyle& style, const Visitor& visit) const;
    Line lineOf(const std::vector<Cell>& cells, const std::vector<std::size_t>& widths,
        const TextStyle& style) const;

    std::vector<Column> columns_;
    std::vector<std::size_t> widths_; // of the widest cell of each column
    std::vector<Row> rows_;
};

// Returns the line as text, with a line feed.
std::string textOf(const Line& line, const TextStyle& style);

// Returns the beginning of the line that fits the width.
Line cutLine(const Line& line, const TextStyle& style);

} // namespace Tools
