// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A sensor as people see it.

#pragma once

#include "tools/sensors/SensorState.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace Host {
class Instance;
}

namespace Vorn::SensorProfileProvider {
class Sensor;
}

namespace Tools {

// A record of which the provider makes an instance.
using ProviderRecord = Vorn::SensorProfileProvider::Sensor;

// A reading or a limit: `value` times ten to the power of `modifier`. Readings and limits of a
// sensor have the same modifier and are rounded alike, so that no reading at a limit is shown below
// it.
struct Quantity {
    std::int64_t value;
    std::int32_t modifier;

    bool operator==(const Quantity&) const = default;

    double number() const;
    std::string text() const;    // in full, such as "12.096"
    std::string rounded() const; // to hundredths unless it is less than 1, such as "12.10"
};

struct LimitKind {
    const char* property; // of ZUMLO_NumericSensor
    const char* member;   // of a JSON document
    const char* title;    // of a column
    const char* words;
};

inline constexpr std::array<LimitKind, 6> limitKinds = {{
    {"LowerThresholdNonCritical", "lowWarning", "LOW", "Low warning"},
    {"LowerThresholdCritical", "lowCritical", "LOW CRIT", "Low critical"},
    {"LowerThresholdFatal", "lowFatal", "LOW FATAL", "Low fatal"},
    {"UpperThresholdNonCritical", "highWarning", "HIGH", "High warning"},
    {"UpperThresholdCritical", "highCritical", "HIGH CRIT", "High critical"},
    {"UpperThresholdFatal", "highFatal", "HIGH FATAL", "High fatal"},
}};
inline constexpr std::size_t firstUpperLimit = 3;

// Returns the DeviceID that the provider gives a node.
std::string deviceIdOf(const std::string& description, std::string_view path);

// Texts are as the provider spells them: not yet printable.
struct Sensor {
    Sensor() = default;
    // Interprets an instance of ZUMLO_NumericSensor.
    explicit Sensor(const Host::Instance& from);
    // Interprets a record as the instance that is made of it. Changes the record: its possible
    // states are longer at each further reading. REQUIRES: nobody has read them.
    explicit Sensor(ProviderRecord& record);

    // Sets the names that the provider gives a node.
    void setNames(const std::string& description, std::string_view itsPath);

    std::string label;
    std::string path;    // such as "/hwmon/coretemp-isa-0000/temp1"
    std::string chip;    // the folder of the path, without "/hwmon/"
    std::string feature; // the rest of the path
    std::string deviceId;
    std::string device;    // what the chip belongs to, such as a disk's model; often empty
    std::string_view kind; // one of sensorKinds, or empty
    std::string_view unit; // empty when unknown

    // Nothing when the sensor has none: when CurrentReading is missing or out of range, when
    // communication is lost (OperationalStatus 13), and when CurrentReading is 0 and the sensor is
    // out of contact (OperationalStatus 12), disabled or offline (EnabledState 3 or 6).
    std::optional<Quantity> reading;
    std::array<std::optional<Quantity>, limitKinds.size()> limits; // in the order of limitKinds

    SensorState state;
    std::vector<std::string_view> possibleStates; // words of states, from PossibleStates
    unsigned health = 0;                          // HealthState
    const Host::Instance* instance = nullptr;     // null when made of no instance

private:
    void identify(std::string_view elementName, std::string_view id);
    void setReading(std::optional<Quantity> currentReading, unsigned enabledState,
        std::span<const unsigned> operationalStatus);
};

inline constexpr std::array<const char*, 3> sensorKinds = {"temperature", "voltage", "fan"};

} // namespace Tools
