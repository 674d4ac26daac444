// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Selector.h"

#include "host/broker/Names.h"

#include <fnmatch.h>

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

// Returns the least number of insertions, deletions and replacements of a character that turn the
// text into some part of the name, without regard to letter case (Sellers' algorithm).
std::size_t distanceFrom(std::string_view text, std::string_view name)
{
    std::vector<std::size_t> row(name.size() + 1, 0);
    for (std::size_t i = 0; i < text.size(); ++i) {
        std::size_t diagonal = std::exchange(row[0], i + 1);
        for (std::size_t j = 0; j < name.size(); ++j) {
            const bool isSame = Host::foldCase(text[i]) == Host::foldCase(name[j]);
            const std::size_t replaced = diagonal + (isSame ? 0 : 1);
            diagonal = row[j + 1];
            row[j + 1] = std::min({replaced, diagonal + 1, row[j] + 1});
        }
    }
    return *std::min_element(row.begin(), row.end());
}

} // namespace

bool selects(const std::string& selector, const Sensor& sensor)
{
    const std::array<std::string, 7> names = {sensor.chip, sensor.label, sensor.feature,
        sensor.path, sensor.deviceId, sensor.chip + "/" + sensor.label,
        sensor.chip + "/" + sensor.feature};
    return std::any_of(names.begin(), names.end(), [&](const std::string& name) {
        return Host::equalNames(name, selector) ||
               (isPattern(selector) &&
                   ::fnmatch(selector.c_str(), name.c_str(), FNM_CASEFOLD | FNM_NOESCAPE) == 0);
    });
}

bool isOfKind(const std::vector<std::string>& kinds, const Sensor& sensor)
{
    return kinds.empty() || std::find(kinds.begin(), kinds.end(), sensor.kind) != kinds.end();
}

std::string nothingMatches(const std::string& selector, const Sensors& sensors)
{
    std::set<std::tuple<std::size_t, std::size_t, std::string>> nearest; // by distance and length
    for (const Sensor& sensor : sensors)
        for (const std::string& name : {sensor.chip, sensor.label, sensor.path}) {
            const std::size_t distance = distanceFrom(selector, name);
            if (distance < selector.size() && 2 * distance <= selector.size())
                nearest.emplace(distance, name.size(), name);
            if (nearest.size() > suggestions)
                nearest.erase(std::prev(nearest.end()));
        }
    std::string text = "no sensor matches \"" + selector + "\"";
    const char* separator = "; what comes nearest: ";
    for (const auto& [distance, size, name] : nearest) {
        text.append(separator).append("\"").append(name).append("\"");
        separator = ", ";
    }
    return text;
}

} // namespace Tools
