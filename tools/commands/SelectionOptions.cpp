// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/commands/SelectionOptions.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <set>
#include <utility>

namespace Tools {

void SelectionOptions::addTo(CLI::App& parser)
{
    parser
        .add_option(
            "SELECTOR", selectors_, "Chip, label, path or DeviceID of sensors, or a pattern")
        ->type_name("");
    addKind(parser);
}

void SelectionOptions::addKind(CLI::App& parser)
{
    const std::set<std::string> choices(sensorKinds.begin(), sensorKinds.end());
    parser.add_option("--kind", filter_.kinds, "Only this kind: temperature, voltage or fan")
        ->type_name("KIND")
        ->allow_extra_args(false)
        ->transform(CLI::IsMember(choices, CLI::ignore_case).description(""));
}

void SelectionOptions::addProblems(CLI::App& parser)
{
    parser.add_flag(
        "--problems", filter_.onlyProblems, "Only sensors that warn, are critical or lost");
}

SelectionOptions SelectionOptions::withoutSelectors() const
{
    SelectionOptions others = *this;
    others.selectors_.clear();
    return others;
}

bool SelectionOptions::isSelected(const Sensor& sensor) const
{
    const auto isMatch = [&](const std::string& each) { return selects(each, sensor); };
    return isOfKind(filter_.kinds, sensor) &&
           (selectors_.empty() || std::any_of(selectors_.begin(), selectors_.end(), isMatch));
}

SelectionOptions::Selected SelectionOptions::select(Sensors all) const
{
    Selected selected;
    for (const std::string& selector : selectors_)
        if (std::none_of(all.begin(), all.end(),
                [&](const Sensor& sensor) { return selects(selector, sensor); }))
            selected.complaints.push_back(nothingMatches(selector, all));
    std::erase_if(all, [&](const Sensor& sensor) { return !isSelected(sensor); });
    selected.sensors = std::move(all);
    const bool isOfSomeKind = !selected.sensors.empty();
    std::erase_if(selected.sensors, [&](const Sensor& sensor) { return !filter_.accepts(sensor); });
    if (selected.sensors.empty() && selected.complaints.empty())
        selected.complaints.emplace_back(
            isOfSomeKind ? "none of the sensors has a problem" : "no sensor is of that kind");
    return selected;
}

} // namespace Tools
