// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The state of a sensor: the answer to Get Sensor Reading (IPMI 2.0, section 35.14) as a status
// code of the hardware model.

#pragma once

#include "tools/collect/SensorRecord.h"

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

namespace Ipmi {

// The limits in the unit of the reading, in the order of Threshold; absent where the sensor has
// none.
using Limits = std::array<std::optional<double>, thresholdCount>;

// What the controller says of one sensor.
struct SensorAnswer {
    enum class Kind {
        reading,     // the raw reading is valid
        disabled,    // the controller does not scan the sensor
        unavailable, // there is no sensor or no reading at present
        failed,      // the controller does not say why
    };
    Kind kind = Kind::failed;
    std::uint8_t raw = 0;
    std::optional<ThresholdMask> crossed = {}; // absent in a short answer
};

// Returns whether the code says that there is no such sensor, or that the command is none for it.
bool meansUnavailable(std::uint8_t completionCode);

// Interprets the bytes of an answer, which begin with the completion code. `ignoresScanning` is for
// controllers that say of each sensor that they do not scan it.
SensorAnswer interpret(std::span<const std::uint8_t> answer, bool ignoresScanning);

// Returns the thresholds that the reading is at or beyond.
ThresholdMask crossedBy(double reading, const Limits& limits);

// Returns whether the reading is at or below a threshold.
bool isLow(const ThresholdMask& crossed);

// Returns the status of a sensor with a reading. Those of critical and non-recoverable thresholds
// precede those of non-critical ones, upper thresholds precede lower ones.
unsigned statusOf(const ThresholdMask& crossed);

// Returns the codes that the status of a sensor with these thresholds can take, ascending, without
// those of lost communication, which is no state of the sensor.
std::vector<unsigned> possibleStates(const ThresholdMask& thresholds);

} // namespace Ipmi
