// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Changes of the set of chips and of the sensors configuration.

#pragma once

#include <string>

namespace Vorn::Hwmon {

// Returns whether the kernel has a hwmon class. Where it has none there are no sensors, and
// libsensors would report an error of the kernel's interface.
bool hasHwmon();

// Returns a text that changes with the set of chips and with the configuration; never empty.
// Costs a few system calls per chip.
std::string machineFingerprint();

} // namespace Vorn::Hwmon
