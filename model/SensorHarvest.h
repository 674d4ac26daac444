// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The harvest: what the instrumentation says now, as plain records. Nothing is kept from one
// call to the next. Results are inverted: true means that nothing was harvested.

#pragma once

#include "model/Sensor.h"
#include "model/SensorEnabledLogCap.h"

#include <vector>

namespace Vorn {
class Instrumentation;
}

namespace Vorn::SensorProfileProvider {

// Appends the temperatures, voltages and tachometers of the machine, type by type. A type whose
// walk fails is reported on standard error and left where it failed; the others follow.
// Returns false when at least one type was present and walked to its end.
bool getSensorInstances(std::vector<Sensor>& vectSensor);

// Walks a cursor from its present node to the last of the selected type and appends a record
// for each. Returns false. Throws ProviderException naming the value that a record refused,
// with the cursor still on that node, and whatever the instrumentation throws.
bool setVector(std::vector<Sensor>& vectSensor, Vorn::Instrumentation& instrumentation);

// Appends the one capabilities record. Returns true, having reported on standard error, when
// a standard exception kept it from being appended.
bool getSensorEnabledLogCapInstances(std::vector<SensorEnabledLogCap>& vectSensorEnabledLogCap);

} // namespace Vorn::SensorProfileProvider
