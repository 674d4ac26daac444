// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Table.h"

#include "tools/output/PrintableText.h"

#include <algorithm>
#include <utility>

namespace Tools {

namespace {

constexpr std::size_t leastFirstColumn = 12;

void append(std::string& text, const Line& line, const TextStyle& style)
{
    for (const Cell& cell : line)
        if (style.isColored)
            text += emphasized(cell.text, cell.emphasis, true);
        else
            text += cell.text;
    text += '\n';
}

} // namespace

Table::Table(std::vector<Column> columns) : columns_(std::move(columns))
{
    widths_.reserve(columns_.size());
    for (const Column& column : columns_)
        widths_.push_back(displayWidth(column.title));
}

void Table::add(std::vector<Cell> cells)
{
    for (std::size_t i = 0; i < cells.size(); ++i)
        widths_[i] = std::max(widths_[i], displayWidth(cells[i].text));
    rows_.push_back({std::move(cells), false});
}

std::size_t Table::width(std::size_t minimumOfFirst) const
{
    std::size_t sum = std::min(widths_[0], minimumOfFirst);
    for (std::size_t i = 1; i < widths_.size(); ++i)
        sum += columns_[i].gap + widths_[i];
    return sum;
}

template <typename Visitor>
void Table::visitLines(const TextStyle& style, const Visitor& visit) const
{
    std::vector<std::size_t> widths = widths_;
    const std::size_t others = width(0);
    const std::size_t room = style.width > others ? style.width - others : 0;
    widths[0] = std::min(widths[0], std::max(room, leastFirstColumn));

    std::vector<Cell> titles;
    for (const Column& column : columns_)
        titles.push_back({column.title, Emphasis::heading});
    visit(lineOf(titles, widths, style));
    for (const Row& row : rows_)
        visit(row.isHeading ? cutLine(row.cells, style) : lineOf(row.cells, widths, style));
}

std::vector<Line> Table::lines(const TextStyle& style) const
{
    std::vector<Line> lines;
    visitLines(style, [&](Line line) { lines.push_back(std::move(line)); });
    return lines;
}

std::string Table::toText(const TextStyle& style) const
{
    std::string text;
    visitLines(style, [&](const Line& line) { append(text, line, style); });
    return text;
}

Line Table::lineOf(const std::vector<Cell>& cells, const std::vector<std::size_t>& widths,
    const TextStyle& style) const
{
    Line line;
    line.reserve(2 * cells.size());
    std::size_t blanks = 0; // to be written before the next text
    for (std::size_t i = 0; i < cells.size(); ++i) {
        std::string shown =
            i == 0 ? cutToWidth(cells[i].text, widths[i], style.isUtf8) : cells[i].text;
        const std::size_t padding = widths[i] - displayWidth(shown);
        const bool isRight = columns_[i].alignment == Column::Alignment::right;
        blanks += (i == 0 ? 0 : columns_[i].gap) + (isRight ? padding : 0);
        if (!shown.empty()) {
            if (blanks > 0)
                line.push_back({std::string(blanks, ' ')});
            line.push_back({std::move(shown), cells[i].emphasis});
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
    append(text, line, style);
    return text;
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
