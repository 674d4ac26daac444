// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A table of sensors.

#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace Host {
class Instance;
}

namespace Tools {

// Returns a table with name, reading, unit, state, health and limits of each sensor, in the given
// order.
std::string sensorTable(
    const std::vector<const Host::Instance*>& sensors, std::size_t width, bool isColored);

} // namespace Tools
