// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The sensors of a machine.

#pragma once

#include "tools/sensors/Sensor.h"

#include <string>
#include <vector>

namespace Tools {

class ProviderClient;

// In natural order by chip, label and path.
using Sensors = std::vector<Sensor>;

// Returns whether a sensor comes before another one in a list.
bool isListedBefore(const Sensor& first, const Sensor& second);

// Returns the sensors in the order of a list. They belong to the argument.
std::vector<const Sensor*> inListOrder(const Sensors& sensors);

// Returns the properties of which a Sensor is made, with a null at the end.
std::vector<const char*> propertiesOfSensors();

// Returns the sensors that the instances describe, in their order.
Sensors sensorsOf(const std::vector<const Host::Instance*>& instances);

// Returns all sensors, with only those properties that a Sensor has unless `isWhole`. Their
// instances belong to the client's request. Throws as ProviderClient does.
Sensors readSensors(ProviderClient& provider, bool isWhole);

// Returns the sensors that a model file describes, with their names and kinds only, and the state
// of those without contact. Throws std::runtime_error with the file, the place in it and the
// reason.
Sensors sensorsInFile(const std::string& file);

// Returns a sentence such as "78 sensors: 68 normal, 8 warning, 2 lost."
std::string summaryOf(const Sensors& sensors);

} // namespace Tools
