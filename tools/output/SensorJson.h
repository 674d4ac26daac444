// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/output/Output.h"
#include "tools/sensors/SensorList.h"

namespace Tools {

// Writes a JSON array with an object in a line for each sensor, which the schema
// sensorctl-list.schema.json describes. Invalid UTF-8 becomes U+FFFD, and unprintable characters
// are escaped.
void writeSensorJson(Output& out, const Sensors& sensors);

} // namespace Tools
