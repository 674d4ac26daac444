// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/SensorTable.h"

#include "tools/output/PrintableText.h"
#include "tools/output/SensorCells.h"
#include "tools/output/Terminal.h"

#include <algorithm>
#include <bitset>

namespace Tools {

namespace {

// The least widths of names for which the limits, and then the readings, are left out.
constexpr std::size_t leastName = 16;
constexpr std::size_t leastNameBesideReadings = 12;

// Which columns a table has beside name, chip and state.
enum class Layout { everything, limitColumns, limitPairs, noLimits, noReadings };

using LimitSet = std::bitset<limitKinds.size()>;

LimitSet limitsOfAny(const Sensors& sensors)
{
    LimitSet set;
    for (const Sensor& sensor : sensors)
        for (std::size_t i = 0; i < set.size(); ++i)
            set[i] = set[i] || sensor.limits.at(i);
    return set;
}

// Returns the title of the column with the limits of one end, such as "HIGH/CRIT".
std::string pairTitle(std::size_t first, const LimitSet& set)
{
    return std::string(limitKinds.at(first).title) + "/CRIT" + (set[first + 2] ? "/FATAL" : "");
}

// Returns the limits of one end by increasing severity, such as "80/95" or "-/95", up to the last
// one that the sensor has.
std::string pairText(const Sensor& sensor, std::size_t first)
{
    std::string text;
    std::string skipped;
    for (std::size_t i = first; i < first + firstUpperLimit; ++i) {
        const auto& limit = sensor.limits.at(i);
        if (limit)
            text += skipped + limitText(limit);
        skipped = (limit ? "" : skipped + absent) + "/";
    }
    return text.empty() ? absent : text;
}

class SensorTableBuilder {
public:
    SensorTableBuilder(const Sensors& sensors, Grouping grouping, const TextStyle& style)
        : sensors_(sensors), isGrouped_(grouping == Grouping::byChip), style_(style),
          limits_(limitsOfAny(sensors))
    {
    }

    Table build(Layout layout) const
    {
        Table table(columns(layout));
        const std::string* chip = nullptr;
        for (const Sensor& sensor : sensors_) {
            if (isGrouped_ && (chip == nullptr || *chip != sensor.chip))
                table.addHeading(chipHeading(sensor, style_));
            chip = &sensor.chip;
            table.add(cells(sensor, layout));
        }
        return table;
    }

private:
    std::vector<Column> columns(Layout layout) const
    {
        using enum Column::Alignment;
        std::vector<Column> columns = {{isGrouped_ ? "  NAME" : "NAME"}};
        if (!isGrouped_)
            columns.push_back({"CHIP"});
        if (layout != Layout::noReadings)
            columns.insert(columns.end(), {{"READING", right}, {"", left, 1}});
        columns.push_back({"STATE"});
        if (layout == Layout::limitPairs)
            columns.insert(
                columns.end(), {{pairTitle(0, limits_)}, {pairTitle(firstUpperLimit, limits_)}});
        for (std::size_t i = 0; i < limits_.size() && layout < Layout::limitPairs; ++i)
            if (limits_[i])
                columns.push_back({limitKinds.at(i).title, right});
        if (layout == Layout::everything)
            columns.push_back({"DEVICE ID"});
        return columns;
    }

    std::vector<Cell> cells(const Sensor& sensor, Layout layout) const
    {
        std::vector<Cell> cells = {{(isGrouped_ ? "  " : "") + shown(sensor.label)}};
        if (!isGrouped_)
            cells.push_back({shown(sensor.chip)});
        if (layout != Layout::noReadings)
            cells.insert(cells.end(), {readingCell(sensor), unitCell(sensor, style_)});
        cells.push_back(stateCell(sensor));
        if (layout == Layout::limitPairs)
            cells.insert(cells.end(), {{pairText(sensor, 0)}, {pairText(sensor, firstUpperLimit)}});
        for (std::size_t i = 0; i < limits_.size() && layout < Layout::limitPairs; ++i)
            if (limits_[i])
                cells.push_back({limitText(sensor.limits.at(i))});
        if (layout == Layout::everything)
            cells.push_back({shown(sensor.deviceId), Emphasis::faint});
        return cells;
    }

    std::string shown(const std::string& text) const { return printable(text, style_.isUtf8); }

    const Sensors& sensors_;
    bool isGrouped_;
    const TextStyle& style_;
    LimitSet limits_;
};

} // namespace

std::string sensorTable(const Sensors& sensors, Grouping grouping, const TextStyle& style)
{
    const SensorTableBuilder builder(sensors, grouping, style);
    for (const auto& [layout, name] :
        {std::pair(Layout::everything, unlimited), {Layout::limitColumns, unlimited},
            {Layout::limitPairs, leastName}, {Layout::noLimits, leastNameBesideReadings}})
        if (const Table table = builder.build(layout); table.width(name) <= style.width)
            return table.toText(style);
    std::string text;
    for (const Line& line : builder.build(Layout::noReadings).lines(style))
        text += textOf(cutLine(line, style), style);
    return text;
}

} // namespace Tools
