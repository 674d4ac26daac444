// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/metrics/Exposition.h"
#include "tools/sensors/Harvest.h"

#include <cstddef>

namespace Tools {

// Adds the sensors, what their harvest was like, and the version of the tool.
void addHarvest(Exposition& exposition, const Harvest& harvest);

// Adds the number of objects in the memory of open enumerations.
void addHeldObjects(Exposition& exposition, std::size_t objects);

} // namespace Tools
