// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ValueMaps.h"

#include <algorithm>
#include <array>
#include <span>

namespace Tools {

namespace {

using Texts = std::span<const std::string_view>;

// The index of each text is its code.
constexpr std::array<std::string_view, 17> sensorTypes = {"Unknown", "Other", "Temperature",
    "Voltage", "Current", "Tachometer", "Counter", "Switch", "Lock", "Humidity", "Smoke Detection",
    "Presence", "Air Flow", "Power Consumption", "Power Production", "Pressure", "Intrusion"};

constexpr std::array<std::string_view, 67> baseUnits = {"Unknown", "Other", "Degrees C",
    "Degrees F", "Degrees K", "Volts", "Amps", "Watts", "Joules", "Coulombs", "VA", "Nits",
    "Lumens", "Lux", "Candelas", "kPa", "PSI", "Newtons", "CFM", "RPM", "Hertz", "Seconds",
    "Minutes", "Hours", "Days", "Weeks", "Mils", "Inches", "Feet", "Cubic Inches", "Cubic Feet",
    "Meters", "Cubic Centimeters", "Cubic Meters", "Liters", "Fluid Ounces", "Radians",
    "Steradians", "Revolutions", "Cycles", "Gravities", "Ounces", "Pounds", "Foot-Pounds",
    "Ounce-Inches", "Gauss", "Gilberts", "Henries", "Farads", "Ohms", "Siemens", "Moles",
    "Becquerels", "PPM (parts/million)", "Decibels", "DbA", "DbC", "Grays", "Sieverts",
    "Color Temperature Degrees K", "Bits", "Bytes", "Words (data)", "DoubleWords", "QuadWords",
    "Percentage", "Pascals"};

constexpr std::array<std::string_view, 10> rateUnits = {"None", "Per MicroSecond",
    "Per MilliSecond", "Per Second", "Per Minute", "Per Hour", "Per Day", "Per Week", "Per Month",
    "Per Year"};

constexpr std::array<std::string_view, 6> thresholds = {"LowerThresholdNonCritical",
    "UpperThresholdNonCritical", "LowerThresholdCritical", "UpperThresholdCritical",
    "LowerThresholdFatal", "UpperThresholdFatal"};

constexpr std::array<std::string_view, 11> enabledStates = {"Unknown", "Other", "Enabled",
    "Disabled", "Shutting Down", "Not Applicable", "Enabled but Offline", "In Test", "Deferred",
    "Quiesce", "Starting"};

constexpr std::array<std::string_view, 13> requestedStates = {"Unknown", "", "Enabled", "Disabled",
    "Shut Down", "No Change", "Offline", "Test", "Deferred", "Quiesce", "Reboot", "Reset",
    "Not Applicable"};

constexpr std::array<std::string_view, 31> healthStates = {"Unknown", "", "", "", "", "OK", "", "",
    "", "", "Degraded/Warning", "", "", "", "", "Minor failure", "", "", "", "", "Major failure",
    "", "", "", "", "Critical failure", "", "", "", "", "Non-recoverable error"};

constexpr std::array<std::string_view, 20> operationalStatuses = {"Unknown", "Other", "OK",
    "Degraded", "Stressed", "Predictive Failure", "Error", "Non-Recoverable Error", "Starting",
    "Stopping", "Stopped", "In Service", "No Contact", "Lost Communication", "Aborted", "Dormant",
    "Supporting Entity in Error", "Completed", "Power Mode", "Relocating"};

constexpr std::array<std::string_view, 3> dedicated = {"Not Dedicated", "Unknown", "Other"};

struct ValueMap {
    std::string_view property;
    Texts texts;
};

constexpr std::array<ValueMap, 10> valueMaps = {{
    {"SensorType", sensorTypes},
    {"BaseUnits", baseUnits},
    {"RateUnits", rateUnits},
    {"SupportedThresholds", thresholds},
    {"SettableThresholds", thresholds},
    {"EnabledState", enabledStates},
    {"RequestedState", requestedStates},
    {"HealthState", healthStates},
    {"OperationalStatus", operationalStatuses},
    {"Dedicated", dedicated},
}};

} // namespace

std::string_view meaningOf(std::string_view property, std::uint64_t code)
{
    const auto map = std::find_if(valueMaps.begin(), valueMaps.end(),
        [&](const ValueMap& candidate) { return candidate.property == property; });
    if (map == valueMaps.end() || code >= map->texts.size())
        return {};
    return map->texts[static_cast<std::size_t>(code)];
}

} // namespace Tools
