// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/check/Range.h"

#include <charconv>
#include <cmath>
#include <stdexcept>

namespace Tools {

namespace {

double numberOf(std::string_view text, std::string_view range)
{
    double number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc{} || end != text.data() + text.size() || !std::isfinite(number))
        throw std::invalid_argument("\"" + std::string(range) + "\" is no range such as 10:80");
    return number;
}

} // namespace

bool Range::raisesAlert(double reading) const
{
    const bool isOutside = (low && reading < *low) || (high && reading > *high);
    return isOutside != isInverted;
}

Range readRange(std::string_view text)
{
    Range range;
    range.text = text;
    std::string_view rest = text;
    if (rest.starts_with('@')) {
        range.isInverted = true;
        rest.remove_prefix(1);
    }
    const auto colon = rest.find(':');
    if (colon == std::string_view::npos) {
        range.low = 0;
        range.high = numberOf(rest, text);
        return range;
    }
    const std::string_view low = rest.substr(0, colon);
    const std::string_view high = rest.substr(colon + 1);
    if (low != "~")
        range.low = numberOf(low, text);
    if (!high.empty())
        range.high = numberOf(high, text);
    if (range.low && range.high && *range.low > *range.high)
        throw std::invalid_argument("\"" + range.text + "\" begins above its end");
    return range;
}

} // namespace Tools
