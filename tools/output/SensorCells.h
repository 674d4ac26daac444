// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The columns that several tables of sensors have.

#pragma once

#include "tools/output/Table.h"
#include "tools/sensors/Sensor.h"

#include <string>

namespace Tools {

Emphasis emphasisOf(Urgency urgency);
Cell stateCell(const Sensor& sensor);
Cell readingCell(const Sensor& sensor);
Cell unitCell(const Sensor& sensor, const TextStyle& style); // empty without a reading

// Returns the line above the sensors of a chip: its name and its device.
Line chipHeading(const Sensor& sensor, const TextStyle& style);

// Returns the limit, rounded and without the zeros that end its fraction; `absent` when there is
// none.
std::string limitText(const std::optional<Quantity>& limit);

// Returns a reading or limit of the sensor in full, such as "58 °C"; `absent` when there is none.
std::string textWithUnit(const std::optional<Quantity>& quantity, const Sensor& sensor);

} // namespace Tools
