// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/watch/Sparkline.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace Tools {

std::string sparkline(
    const std::deque<std::optional<double>>& readings, std::size_t width, bool isUtf8)
{
    constexpr std::array blocks = {"▁", "▂", "▃", "▄", "▅", "▆", "▇", "█"};
    constexpr std::array characters = {"_", ".", "-", "~", "+", "*", "%", "#"};
    const auto begin =
        readings.end() - static_cast<std::ptrdiff_t>(std::min(width, readings.size()));
    std::optional<double> least;
    std::optional<double> greatest;
    for (auto each = begin; each != readings.end(); ++each)
        if (*each) {
            least = least ? std::min(*least, **each) : **each;
            greatest = greatest ? std::max(*greatest, **each) : **each;
        }
    std::string text;
    for (auto each = begin; each != readings.end(); ++each) {
        const double range = least ? *greatest - *least : 0;
        const double share = *each && range > 0 ? (**each - *least) / range : 0;
        const auto level = static_cast<std::size_t>(std::lround(share * (blocks.size() - 1)));
        text += !*each ? " " : isUtf8 ? blocks.at(level) : characters.at(level);
    }
    return text;
}

} // namespace Tools
