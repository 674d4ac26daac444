// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/output/Output.h"
#include "tools/sensors/SensorList.h"

#include <string>

namespace Tools {

// Appends the object for a sensor, without a line feed.
void appendSensorJson(std::string& json, const Sensor& sensor);

// Writes a JSON array with an object in a line for each sensor, which the schema
// sensorctl-list.schema.json describes. Invalid UTF-8 becomes U+FFFD, and unprintable characters
// are escaped.
void writeSensorJson(Output& out, const Sensors& sensors);

} // namespace Tools
