// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensor data record of an analog sensor (IPMI 2.0, section 43.1).

#pragma once

#include "tools/collect/Conversion.h"

#include <array>
#include <bitset>
#include <compare>
#include <cstdint>
#include <optional>
#include <span>
#include <string>

namespace Ipmi {

// The thresholds in the order of their bits in every mask of the standard.
enum Threshold : std::size_t {
    lowerNonCritical,
    lowerCritical,
    lowerNonRecoverable,
    upperNonCritical,
    upperCritical,
    upperNonRecoverable,
};
inline constexpr std::size_t thresholdCount = 6;
using ThresholdMask = std::bitset<thresholdCount>;
using RawThresholds = std::array<std::uint8_t, thresholdCount>;

inline constexpr std::uint8_t bmcOwner = 0x20; // the BMC's address on the IPMB

// Identifies a sensor in the machine.
struct SensorAddress {
    std::uint8_t channel = 0;
    std::uint8_t owner = bmcOwner;
    std::uint8_t lun = 0;
    std::uint8_t number = 0;

    auto operator<=>(const SensorAddress&) const = default;
};

struct SensorUnits {
    std::uint8_t base = 0;
    std::uint8_t rate = 0;
    bool isModified = false; // a percentage, or a product or quotient with another unit
};

enum class ThresholdAccess : std::uint8_t { none = 0, readable = 1, settable = 2, fixed = 3 };

struct SensorRecord {
    SensorAddress address;
    std::uint8_t entity = 0;
    std::uint8_t entityInstance = 0;
    std::uint8_t sensorType = 0;
    std::uint8_t eventType = 0;
    AnalogFormat format = AnalogFormat::none;
    SensorUnits units;
    Linearization linearization = linear;
    Factors factors;
    ThresholdAccess access = ThresholdAccess::none;
    ThresholdMask readable; // by Get Sensor Thresholds
    ThresholdMask reported; // in the answer to Get Sensor Reading
    RawThresholds thresholds{};
    std::string name;
};

inline constexpr std::uint8_t fullSensorRecord = 1; // the type of the record

// Returns nothing for a record of another type and for one that is too short.
std::optional<SensorRecord> readSensorRecord(std::span<const std::uint8_t> record);

} // namespace Ipmi
