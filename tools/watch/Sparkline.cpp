// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/Sparkline.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <vector>

namespace Tools {

namespace {

// The readings of a bar. The sum is exact, so that bars of the same mean are equal.
struct Bar {
    std::int64_t sum = 0;
    std::int64_t count = 0;

    double mean() const { return static_cast<double>(sum) / static_cast<double>(count); }
};

std::vector<Bar> barsOf(const WatchedSensor& watched, std::size_t width)
{
    const std::size_t readingsPerBar = (WatchedSensor::keptReadings + width - 1) / width;
    std::vector<Bar> bars;
    std::size_t number = watched.droppedReadings;
    for (const auto& reading : watched.readings) {
        if (bars.empty() || number % readingsPerBar == 0)
            bars.emplace_back();
        ++number;
        if (!reading)
            continue;
        bars.back().sum += *reading;
        ++bars.back().count;
    }
    if (bars.size() > width) // the first one has lost readings
        bars.erase(bars.begin());
    return bars;
}

} // namespace

std::string sparkline(const WatchedSensor& watched, std::size_t width, bool isUtf8)
{
    constexpr std::array blocks = {"▁", "▂", "▃", "▄", "▅", "▆", "▇", "█"};
    constexpr std::array characters = {"_", ".", "-", "~", "+", "*", "%", "#"};
    const std::vector<Bar> bars = barsOf(watched, width);
    std::optional<double> least;
    std::optional<double> greatest;
    for (const Bar& bar : bars)
        if (bar.count > 0) {
            least = std::min(least.value_or(bar.mean()), bar.mean());
            greatest = std::max(greatest.value_or(bar.mean()), bar.mean());
        }
    std::string text;
    for (const Bar& bar : bars) {
        if (bar.count == 0) {
            text += ' ';
            continue;
        }
        const double range = *greatest - *least;
        const double share = range > 0 ? (bar.mean() - *least) / range : 0;
        const auto level = static_cast<std::size_t>(std::lround(share * (blocks.size() - 1)));
        text += isUtf8 ? blocks.at(level) : characters.at(level);
    }
    return text;
}

} // namespace Tools
