// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/SensorKind.h"

#include "platform/instrumentation/Thousandths.h"

#include <algorithm>
#include <cmath>

namespace Ipmi {

using Vorn::NodeLexicon::NodeType;

namespace {

// Codes of the standard: sensor types (IPMI 2.0, table 42-3), units (section 43.17) and rates.
enum SensorType : std::uint8_t { temperature = 1, voltage = 2, fan = 4 };
enum Unit : std::uint8_t {
    degreesC = 1,
    degreesF = 2,
    kelvins = 3,
    volts = 4,
    revolutionsPerMinute = 18,
    hertz = 19,
    revolutions = 41,
    cycles = 42,
};
enum Rate : std::uint8_t { noRate = 0, perSecond = 3, perMinute = 4, perHour = 5 };

std::optional<SensorKind> temperatureIn(const SensorUnits& units)
{
    if (units.rate != noRate)
        return std::nullopt;
    switch (units.base) {
    case degreesC:
        return SensorKind{NodeType::Temperature};
    case degreesF:
        return SensorKind{NodeType::Temperature, -32, 5, 9};
    case kelvins:
        return SensorKind{NodeType::Temperature, -273.15};
    default:
        return std::nullopt;
    }
}

std::optional<SensorKind> voltageIn(const SensorUnits& units)
{
    if (units.base != volts || units.rate != noRate)
        return std::nullopt;
    return SensorKind{NodeType::Voltage};
}

std::optional<SensorKind> fanIn(const SensorUnits& units)
{
    const bool isCount = units.base == revolutions || units.base == cycles;
    if ((units.base == revolutionsPerMinute && units.rate == noRate) ||
        ((isCount || units.base == revolutionsPerMinute) && units.rate == perMinute))
        return SensorKind{NodeType::Tachometer};
    if ((units.base == hertz && units.rate == noRate) || (isCount && units.rate == perSecond))
        return SensorKind{NodeType::Tachometer, 0, 60};
    if (isCount && units.rate == perHour)
        return SensorKind{NodeType::Tachometer, 0, 1, 60};
    return std::nullopt;
}

} // namespace

double SensorKind::inBaseUnit(double value) const
{
    const double converted = (value + offset) * numerator / denominator;
    const double thousandths = std::round(converted * 1000);
    const double tolerance = 1e-9 * std::max(1.0, std::fabs(thousandths)); // of the arithmetic here
    return std::fabs(converted * 1000 - thousandths) < tolerance
               ? Vorn::keepingThousandths(thousandths / 1000)
               : converted;
}

unsigned SensorKind::baseUnits() const
{
    constexpr unsigned cimDegreesC = 2;
    constexpr unsigned cimVolts = 5;
    constexpr unsigned cimRevolutionsPerMinute = 19;
    if (type == NodeType::Tachometer)
        return cimRevolutionsPerMinute;
    return type == NodeType::Voltage ? cimVolts : cimDegreesC;
}

std::optional<SensorKind> kindOf(const SensorRecord& sensor)
{
    if (sensor.format == AnalogFormat::none || isReserved(sensor.linearization) ||
        sensor.units.isModified)
        return std::nullopt;
    switch (sensor.sensorType) {
    case temperature:
        return temperatureIn(sensor.units);
    case voltage:
        return voltageIn(sensor.units);
    case fan:
        return fanIn(sensor.units);
    default:
        return std::nullopt;
    }
}

} // namespace Ipmi
