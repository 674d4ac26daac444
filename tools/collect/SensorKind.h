// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What an analog sensor is published as.

#pragma once

#include "platform/instrumentation/NodeLexicon.h"
#include "tools/collect/SensorRecord.h"

#include <optional>

namespace Ipmi {

// The type of a sensor's node, and the conversion from the sensor's unit to that of the node:
// (value + offset) * numerator / denominator.
struct SensorKind {
    Vorn::NodeLexicon::NodeType type{};
    double offset = 0;
    double numerator = 1;
    double denominator = 1;

    // Returns the value in the unit of the node. Where that is a whole number of thousandths, the
    // result is the double that does not truncate to the thousandth below.
    double inBaseUnit(double value) const;

    // Returns the code of the unit in the DMTF value map CIM_NumericSensor.BaseUnits.
    unsigned baseUnits() const;
};

// Returns nothing for a sensor that is neither a temperature, a voltage nor a fan in a unit of its
// type, and for one whose number cannot be calculated.
std::optional<SensorKind> kindOf(const SensorRecord& sensor);

} // namespace Ipmi
