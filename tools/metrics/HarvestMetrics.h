// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/ResponseCounts.h"
#include "tools/metrics/Exposition.h"
#include "tools/metrics/SensorMetrics.h"
#include "tools/sensors/Harvest.h"

#include <cstddef>

namespace Tools {

// Adds the sensors, the duration of their harvest, the states of its sources, and the version of
// the tool.
void addHarvest(Exposition& exposition, const Harvest& harvest, SensorMetrics& sensors);

// Adds the numbers of HTTP responses.
void addResponses(Exposition& exposition, const Host::Http::ResponseCounts& answered);

// Adds the number of objects in the memory of open enumerations.
void addHeldObjects(Exposition& exposition, std::size_t objects);

} // namespace Tools
