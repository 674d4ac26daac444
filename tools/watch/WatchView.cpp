// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/WatchView.h"

#include "tools/output/PrintableText.h"
#include "tools/output/SensorCells.h"
#include "tools/output/Terminal.h"
#include "tools/sensors/NaturalOrder.h"
#include "tools/watch/Sparkline.h"

#include <algorithm>
#include <array>

namespace Tools {

namespace {

constexpr std::size_t keptChanges = 100;
constexpr std::size_t leastNameWidth = 16;
constexpr std::size_t leastSparkline = 8;
constexpr const char* help = "q quit  s sort  p problems only  arrows, PgUp, PgDn, Home scroll";

std::string clockTime(std::time_t time)
{
    std::tm local{};
    ::localtime_r(&time, &local);
    std::array<char, 16> text{};
    std::strftime(text.data(), text.size(), "%H:%M:%S", &local);
    return text.data();
}

const char* wordsFor(Order order)
{
    constexpr std::array words = {"by chip", "by state", "by name"};
    return words.at(static_cast<std::size_t>(order));
}

} // namespace

void WatchView::add(const std::vector<Change>& changes)
{
    log_.insert(log_.end(), changes.begin(), changes.end());
    while (log_.size() > keptChanges)
        log_.pop_front();
}

void WatchView::toggleProblems()
{
    onlyProblems_ = !onlyProblems_;
    firstLine_ = 0;
}

void WatchView::nextOrder()
{
    order_ =
        order_ == Order::byName ? Order::byChip : static_cast<Order>(static_cast<int>(order_) + 1);
    firstLine_ = 0;
}

void WatchView::scroll(int lines)
{
    firstLine_ = std::max(firstLine_ + lines, 0);
}

std::vector<const WatchedSensor*> WatchView::shown(const History& history) const
{
    std::vector<const WatchedSensor*> sensors = history.sensors();
    if (onlyProblems_)
        std::erase_if(sensors,
            [](const WatchedSensor* each) { return !isProblem(each->sensor.state.urgency); });
    if (order_ != Order::byChip)
        std::stable_sort(sensors.begin(), sensors.end(),
            [&](const WatchedSensor* first, const WatchedSensor* second) {
                if (order_ == Order::byUrgency)
                    return first->sensor.state.urgency > second->sensor.state.urgency;
                return compareNaturally(first->sensor.label, second->sensor.label) < 0;
            });
    return sensors;
}

Table WatchView::table(
    const std::vector<const WatchedSensor*>& sensors, const TextStyle& style) const
{
    using enum Column::Alignment;
    const bool isGrouped = order_ == Order::byChip;
    const auto build = [&](bool hasRange, std::size_t sparklineWidth) {
        std::vector<Column> columns = {
            {isGrouped ? "  NAME" : "NAME"}, {"READING", right}, {"", left, 1}, {"STATE"}};
        if (hasRange)
            columns.insert(columns.end(), {{"MIN", right}, {"MAX", right}});
        if (sparklineWidth > 0)
            columns.push_back({""});
        Table table(columns);
        const std::string* chip = nullptr;
        for (const WatchedSensor* const each : sensors) {
            const Sensor& sensor = each->sensor;
            if (isGrouped && (chip == nullptr || *chip != sensor.chip))
                table.addHeading(chipHeading(sensor, style));
            chip = &sensor.chip;
            const std::string name =
                isGrouped ? "  " + sensor.label : sensor.label + " (" + sensor.chip + ")";
            std::vector<Cell> cells = {{printable(name, style.isUtf8)}, readingCell(sensor),
                unitCell(sensor, style), stateCell(sensor)};
            if (hasRange)
                cells.insert(cells.end(), {{limitText(each->minimum)}, {limitText(each->maximum)}});
            if (sparklineWidth > 0)
                cells.push_back({sparkline(*each, sparklineWidth, style.isUtf8)});
            table.add(cells);
        }
        return table;
    };
    const std::size_t used = build(true, 0).width(unlimited);
    if (used + 2 + leastSparkline <= style.width)
        return build(true, style.width - used - 2);
    Table narrow = build(true, leastSparkline);
    return narrow.width(leastNameWidth) <= style.width ? narrow : build(false, 0);
}

Line WatchView::title(const std::string& interval) const
{
    return {{"sensorctl watch", Emphasis::heading},
        {"  " + clockTime(std::time(nullptr)) + "  every " + interval + " s  " + wordsFor(order_) +
            (onlyProblems_ ? ", problems only" : "")}};
}

std::vector<Line> WatchView::lines(
    const History& history, const std::string& interval, std::size_t height, TextStyle style)
{
    Sensors all;
    for (const WatchedSensor* const each : history.sensors())
        all.push_back(each->sensor);
    std::vector<Line> lines = {title(interval)};
    if (failure_.empty())
        lines.push_back({{summaryOf(all)}});
    else
        lines.push_back({{printable(failure_, style.isUtf8), Emphasis::critical}});

    const std::size_t logged = std::min(log_.size(), height / 4);
    const std::size_t fixed = lines.size() + 1 + logged + 1; // with the titles and the help
    const std::size_t room = height > fixed ? height - fixed : 0;
    const std::vector<Line> rows = table(shown(history), style).lines(style);
    const int last = static_cast<int>(rows.size()) - 1 - static_cast<int>(room);
    firstLine_ = std::clamp(firstLine_, 0, std::max(last, 0));
    lines.push_back(rows.front());
    for (std::size_t i = 0; i < room; ++i) {
        const std::size_t row = 1 + static_cast<std::size_t>(firstLine_) + i;
        lines.push_back(row < rows.size() ? rows[row] : Line{});
    }
    for (auto change = log_.end() - static_cast<std::ptrdiff_t>(logged); change != log_.end();
         ++change)
        lines.push_back({{clockTime(change->time) + " ", Emphasis::faint},
            {printable(change->text, style.isUtf8), emphasisOf(change->urgency)}});
    lines.push_back({{help, Emphasis::faint}});
    return lines;
}

} // namespace Tools
