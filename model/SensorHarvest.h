// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The harvest reads the instrumentation into plain records. It keeps no state between calls.
// Results are inverted: true means that nothing was harvested.

#pragma once

#include "model/Sensor.h"
#include "model/SensorEnabledLogCap.h"

#include <vector>

namespace Vorn {
class Instrumentation;
}

namespace Vorn::SensorProfileProvider {

// Appends the temperatures, voltages and tachometers of the machine, type by type. A type that
// fails is reported on standard error; the records before its failure stay, and the next type
// follows. Returns false when at least one type was present and read to its end.
bool getSensorInstances(std::vector<Sensor>& vectSensor);

// Appends a record for each node from the cursor's current one to the last of the selected type.
// Returns false. Throws ProviderException, with the cursor on the node, when a record refuses a
// value; exceptions of the instrumentation propagate.
bool setVector(std::vector<Sensor>& vectSensor, Vorn::Instrumentation& instrumentation);

// Appends the one capabilities record. Returns true after a standard exception, which it reports on
// standard error.
bool getSensorEnabledLogCapInstances(std::vector<SensorEnabledLogCap>& vectSensorEnabledLogCap);

} // namespace Vorn::SensorProfileProvider
