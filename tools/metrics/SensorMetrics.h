// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/metrics/Exposition.h"
#include "tools/sensors/SensorList.h"

namespace Tools {

// Adds the readings, limits, states and health of the sensors.
void addSensors(Exposition& exposition, const Sensors& sensors);

} // namespace Tools
