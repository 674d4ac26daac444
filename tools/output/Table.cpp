// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Table.h"

#include "tools/output/Utf8.h"

#include <algorithm>

namespace Tools {

namespace {

constexpr std::size_t leastFirstColumn = 12;

} // namespace

std::string Table::toText(std::size_t width, bool isColored) const
{
    const std::vector<std::size_t> widths = columnWidths(width);
    std::vector<Cell> titles;
    for (const Column& column : columns_)
        titles.push_back({column.title, Emphasis::heading});
    std::string text;
    appendLine(text, titles, widths, isColored);
    for (const std::vector<Cell>& row : rows_)
        appendLine(text, row, widths, isColored);
    return text;
}

std::vector<std::size_t> Table::columnWidths(std::size_t width) const
{
    std::vector<std::size_t> widths;
    for (const Column& column : columns_)
        widths.push_back(displayWidth(column.title));
    for (const std::vector<Cell>& row : rows_)
        for (std::size_t i = 0; i < row.size(); ++i)
            widths[i] = std::max(widths[i], displayWidth(row[i].text));

    std::size_t others = 0;
    for (std::size_t i = 1; i < widths.size(); ++i)
        others += columns_[i].gap + widths[i];
    const std::size_t room = width > others ? width - others : 0;
    widths[0] = std::min(widths[0], std::max(room, leastFirstColumn));
    return widths;
}

void Table::appendLine(std::string& text, const std::vector<Cell>& cells,
    const std::vector<std::size_t>& widths, bool isColored) const
{
    std::size_t blanks = 0; // to be written before the next text
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const std::string shown = i == 0 ? cutToWidth(cells[i].text, widths[i]) : cells[i].text;
        const std::size_t padding = widths[i] - displayWidth(shown);
        const bool isRight = columns_[i].alignment == Column::Alignment::right;
        blanks += (i == 0 ? 0 : columns_[i].gap) + (isRight ? padding : 0);
        if (!shown.empty()) {
            text.append(blanks, ' ');
            text += emphasized(shown, cells[i].emphasis, isColored);
            blanks = 0;
        }
        if (!isRight)
            blanks += padding;
    }
    text += '\n';
}

} // namespace Tools
