// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Table.h"

#include "tools/output/Utf8.h"

#include <algorithm>

namespace Tools {

namespace {

constexpr std::size_t leastFirstColumn = 12;

} // namespace

std::size_t Table::width(std::size_t minimumOfFirst) const
{
    const std::vector<std::size_t> widths = columnWidths();
    std::size_t sum = std::min(widths[0], minimumOfFirst);
    for (std::size_t i = 1; i < widths.size(); ++i)
        sum += columns_[i].gap + widths[i];
    return sum;
}

std::vector<Line> Table::lines(const TextStyle& style) const
{
    std::vector<std::size_t> widths = columnWidths();
    const std::size_t others = width(0);
    const std::size_t room = style.width > others ? style.width - others : 0;
    widths[0] = std::min(widths[0], std::max(room, leastFirstColumn));

    std::vector<Cell> titles;
    for (const Column& column : columns_)
        titles.push_back({column.title, Emphasis::heading});
    std::vector<Line> lines = {lineOf(titles, widths, style)};
    for (const Row& row : rows_)
        lines.push_back(
            row.isHeading ? cutLine(row.cells, style) : lineOf(row.cells, widths, style));
    return lines;
}

std::string Table::toText(const TextStyle& style) const
{
    std::string text;
    for (const Line& line : lines(style))
        text += textOf(line, style);
    return text;
}

std::vector<std::size_t> Table::columnWidths() const
{
    std::vector<std::size_t> widths;
    for (const Column& column : columns_)
        widths.push_back(displayWidth(column.title));
    for (const Row& row : rows_)
        for (std::size_t i = 0; i < row.cells.size() && !row.isHeading; ++i)
            widths[i] = std::max(widths[i], displayWidth(row.cells[i].text));
    return widths;
}

Line Table::lineOf(const std::vector<Cell>& cells, const std::vector<std::size_t>& widths,
    const TextStyle& style) const
{
    Line line;
    std::size_t blanks = 0; // to be written before the next text
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const std::string shown =
            i == 0 ? cutToWidth(cells[i].text, widths[i], style.isUtf8) : cells[i].text;
        const std::size_t padding = widths[i] - displayWidth(shown);
        const bool isRight = columns_[i].alignment == Column::Alignment::right;
        blanks += (i == 0 ? 0 : columns_[i].gap) + (isRight ? padding : 0);
        if (!shown.empty()) {
            if (blanks > 0)
                line.push_back({std::string(blanks, ' ')});
            line.push_back({shown, cells[i].emphasis});
            blanks = 0;
        }
        if (!isRight)
            blanks += padding;
    }
    return line;
}

std::string textOf(const Line& line, const TextStyle& style)
{
    std::string text;
    for (const Cell& cell : line)
        text += emphasized(cell.text, cell.emphasis, style.isColored);
    return text + '\n';
}

Line cutLine(const Line& line, const TextStyle& style)
{
    Line cut;
    std::size_t room = style.width;
    for (const Cell& cell : line) {
        if (room == 0)
            break;
        cut.push_back({cutToWidth(cell.text, room, style.isUtf8), cell.emphasis});
        room -= displayWidth(cut.back().text);
    }
    return cut;
}

} // namespace Tools
