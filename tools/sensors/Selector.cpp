// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Selector.h"

#include "tools/sensors/LetterCase.h"

#include <algorithm>
#include <array>
#include <set>
#include <string_view>
#include <tuple>
#include <utility>

namespace Tools {

namespace {

constexpr std::size_t suggestions = 3;

bool isPattern(std::string_view text)
{
    return text.find_first_of("*?[") != std::string_view::npos;
}

// Returns the least number of insertions, deletions and replacements of a character, and of swaps
// of two, that turn the text into some part of the name (Sellers' algorithm).
std::size_t distanceFrom(std::string_view text, std::string_view name)
{
    const auto isSame = [&](std::size_t i, std::size_t j) { return text[i] == name[j]; };
    std::vector<std::size_t> last(name.size() + 1, 0);
    std::vector<std::size_t> lastButOne;
    for (std::size_t i = 0; i < text.size(); ++i) {
        std::vector<std::size_t> row = {i + 1};
        for (std::size_t j = 0; j < name.size(); ++j) {
            const std::size_t replaced = last[j] + (isSame(i, j) ? 0 : 1);
            row.push_back(std::min({replaced, last[j + 1] + 1, row[j] + 1}));
            if (i > 0 && j > 0 && isSame(i, j - 1) && isSame(i - 1, j))
                row.back() = std::min(row.back(), lastButOne[j - 1] + 1);
        }
        lastButOne = std::exchange(last, std::move(row));
    }
    return *std::min_element(last.begin(), last.end());
}

// Returns whether the text ends with a bus of libsensors, which may have a number or a pattern for
// one: "nct6798-isa", "jc42-i2c-0".
bool endsWithBus(std::string_view text)
{
    std::size_t dash = text.rfind('-');
    if (dash != std::string_view::npos &&
        text.find_first_not_of("0123456789*?", dash + 1) == std::string_view::npos) {
        text = text.substr(0, dash);
        dash = text.rfind('-');
    }
    constexpr std::array<std::string_view, 9> buses = {
        "i2c", "isa", "pci", "spi", "virtual", "acpi", "hid", "mdio", "scsi"};
    return dash != std::string_view::npos &&
           std::find(buses.begin(), buses.end(), text.substr(dash + 1)) != buses.end();
}

// Returns the name of a chip with its address as a number without leading zeros, as libsensors
// compares them: hexadecimal after the bus, with or without 0x. Returns other names unchanged.
std::string withPlainAddress(const std::string& chip)
{
    const std::size_t dash = chip.rfind('-');
    if (dash == std::string::npos || !endsWithBus(std::string_view(chip).substr(0, dash)))
        return chip;
    std::string_view digits = std::string_view(chip).substr(dash + 1);
    if (digits.starts_with("0x") || digits.starts_with("0X"))
        digits.remove_prefix(2);
    if (digits.empty() ||
        digits.find_first_not_of("0123456789abcdefABCDEF") != std::string_view::npos)
        return chip;
    const std::size_t zeros = std::min(digits.find_first_not_of('0'), digits.size() - 1);
    return chip.substr(0, dash + 1).append(digits.substr(zeros));
}

// REQUIRES: the selector is in lower case.
bool isMatch(const std::string& selector, const std::string& name)
{
    const std::string lower = toLowerCase(name);
    return lower == selector || (isPattern(selector) && matchesPattern(selector, lower));
}

// Returns the first chips, and how many others there are; an empty text when there are none.
std::string chipsOf(const Sensors& sensors)
{
    std::set<std::string> chips;
    std::string text;
    for (const Sensor& sensor : sensors)
        if (chips.insert(sensor.chip).second && chips.size() <= suggestions)
            text.append(text.empty() ? "\"" : ", \"").append(sensor.chip).append("\"");
    if (chips.size() > suggestions)
        text.append(" and ").append(std::to_string(chips.size() - suggestions)).append(" more");
    return text;
}

} // namespace

bool selects(const std::string& selector, const Sensor& sensor)
{
    const std::string lower = toLowerCase(selector);
    const std::array<std::string, 7> names = {sensor.chip, sensor.label, sensor.feature,
        sensor.path, sensor.deviceId, sensor.chip + "/" + sensor.label,
        sensor.chip + "/" + sensor.feature};
    return isMatch(withPlainAddress(lower), withPlainAddress(sensor.chip)) ||
           std::any_of(names.begin(), names.end(),
               [&](const std::string& name) { return isMatch(lower, name); });
}

bool isOfKind(const std::vector<std::string>& kinds, const Sensor& sensor)
{
    return kinds.empty() || std::find(kinds.begin(), kinds.end(), sensor.kind) != kinds.end();
}

bool SensorFilter::accepts(const Sensor& sensor) const
{
    return isOfKind(kinds, sensor) && (!onlyProblems || isProblem(sensor.state.urgency));
}

std::string nothingMatches(const std::string& selector, const Sensors& sensors)
{
    std::set<std::tuple<std::size_t, std::size_t, std::string>> nearest; // by distance and length
    const std::string lower = toLowerCase(selector);
    for (const Sensor& sensor : sensors)
        for (const std::string& name : {sensor.chip, sensor.label, sensor.path}) {
            const std::size_t distance = distanceFrom(lower, toLowerCase(name));
            if (!selector.empty() && distance <= selector.size() / 3)
                nearest.emplace(distance, name.size(), name);
            if (nearest.size() > suggestions)
                nearest.erase(std::prev(nearest.end()));
        }
    std::string text = "no sensor matches \"" + selector + "\"";
    if (nearest.empty() && !sensors.empty())
        text += "; there are the chips " + chipsOf(sensors);
    const char* separator = "; what comes nearest: ";
    for (const auto& [distance, size, name] : nearest) {
        text.append(separator).append("\"").append(name).append("\"");
        separator = ", ";
    }
    return text;
}

} // namespace Tools
