// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/SensorCells.h"

#include "tools/cim/Units.h"
#include "tools/output/PrintableText.h"

namespace Tools {

Emphasis emphasisOf(Urgency urgency)
{
    switch (urgency) {
    case Urgency::normal:
        return Emphasis::good;
    case Urgency::warning:
    case Urgency::lost:
        return Emphasis::warning;
    case Urgency::critical:
        return Emphasis::critical;
    case Urgency::inactive:
    case Urgency::unknown:
        break;
    }
    return Emphasis::none;
}

Cell stateCell(const Sensor& sensor)
{
    return {std::string(sensor.state.word), emphasisOf(sensor.state.urgency)};
}

Cell readingCell(const Sensor& sensor)
{
    return sensor.reading ? Cell{sensor.reading->rounded()} : Cell{absent, Emphasis::faint};
}

Cell unitCell(const Sensor& sensor, const TextStyle& style)
{
    return {sensor.reading ? printable(sensor.unit, style.isUtf8) : ""};
}

Line chipHeading(const Sensor& sensor, const TextStyle& style)
{
    Line line = {{printable(sensor.chip, style.isUtf8), Emphasis::heading}};
    if (!sensor.device.empty())
        line.push_back({"   (" + printable(sensor.device, style.isUtf8) + ")", Emphasis::faint});
    return line;
}

std::string limitText(const std::optional<Quantity>& limit)
{
    return limit ? withoutTrailingZeros(limit->rounded()) : absent;
}

std::string textWithUnit(const std::optional<Quantity>& quantity, const Sensor& sensor)
{
    if (!quantity)
        return absent;
    return quantity->text() + (sensor.unit.empty() ? "" : " " + std::string(sensor.unit));
}

} // namespace Tools
