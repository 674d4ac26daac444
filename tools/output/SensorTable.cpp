// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/SensorTable.h"

#include "tools/cim/SensorView.h"
#include "tools/output/Table.h"
#include "tools/output/Utf8.h"

#include <array>

namespace Tools {

namespace {

using LimitProperties = std::array<const char*, 3>;

constexpr LimitProperties lowerLimits = {
    "LowerThresholdNonCritical", "LowerThresholdCritical", "LowerThresholdFatal"};
constexpr LimitProperties upperLimits = {
    "UpperThresholdNonCritical", "UpperThresholdCritical", "UpperThresholdFatal"};

// Returns the limits by increasing severity, such as "80/95" or "-/95", up to the last one that the
// sensor has.
std::string limitsOf(const SensorView& sensor, const LimitProperties& properties)
{
    std::string text;
    std::string skipped;
    for (const char* const property : properties) {
        const auto limit = sensor.roundedLimit(property);
        if (limit)
            text += skipped + *limit;
        skipped = (limit ? "" : skipped + absent) + "/";
    }
    return text.empty() ? absent : text;
}

Cell healthOf(const SensorView& sensor)
{
    switch (sensor.health()) {
    case Health::ok:
        return {"OK", Emphasis::good};
    case Health::warning:
        return {"Warning", Emphasis::warning};
    case Health::critical:
        return {"Critical", Emphasis::critical};
    case Health::unknown:
        break;
    }
    return {"Unknown", Emphasis::none};
}

Cell stateOf(const SensorView& sensor)
{
    const std::string state = printable(sensor.state());
    const Health health = sensor.health();
    if (health == Health::critical)
        return {state, Emphasis::critical};
    if (health == Health::warning)
        return {state, Emphasis::warning};
    return {state.empty() ? absent : state, Emphasis::none};
}

Cell readingOf(const SensorView& sensor)
{
    const auto reading = sensor.reading();
    return reading ? Cell{*reading} : Cell{absent, Emphasis::faint};
}

Cell unitOf(const SensorView& sensor)
{
    return {sensor.reading() ? std::string(sensor.unit()) : ""};
}

} // namespace

std::string sensorTable(
    const std::vector<const Host::Instance*>& sensors, std::size_t width, bool isColored)
{
    Table table({{"NAME"}, {"READING", Column::Alignment::right}, {"", Column::Alignment::left, 1},
        {"STATE"}, {"HEALTH"}, {"LOWER"}, {"UPPER"}});
    for (const Host::Instance* const instance : sensors) {
        const SensorView sensor(*instance);
        table.add({{printable(sensor.name())}, readingOf(sensor), unitOf(sensor), stateOf(sensor),
            healthOf(sensor), {limitsOf(sensor, lowerLimits)}, {limitsOf(sensor, upperLimits)}});
    }
    return table.toText(width, isColored);
}

} // namespace Tools
