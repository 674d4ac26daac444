// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Many sensors, a line each.

#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace Host {
class Instance;
}

namespace Tools {

// Name, reading with its unit, state, health and limits of each sensor, in the given order.
std::string sensorTable(
    const std::vector<const Host::Instance*>& sensors, std::size_t width, bool isColored);

} // namespace Tools
