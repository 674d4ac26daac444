// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tables of sensors.

#pragma once

#include "tools/output/TextStyle.h"
#include "tools/sensors/SensorList.h"

#include <string>

namespace Tools {

enum class Grouping { byChip, none };

// Returns a table with label, reading, state and limits of each sensor: below a line for each chip,
// or with the chip in each line. The fewer columns of a terminal there are, the fewer columns the
// table has; only the widest has the identifiers, and the narrowest has neither limits nor
// readings. No line is longer than the width.
std::string sensorTable(const Sensors& sensors, Grouping grouping, const TextStyle& style);

} // namespace Tools
