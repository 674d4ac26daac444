// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/output/TextStyle.h"
#include "tools/sensors/Sensor.h"

#include <string>

namespace Tools {

// Returns some ten lines about one sensor: label, reading, state and limits first.
std::string sensorDetails(const Sensor& sensor, const TextStyle& style);

} // namespace Tools
