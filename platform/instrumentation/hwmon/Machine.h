// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whether chips came or went, or the administrator changed the sensors configuration.

#pragma once

#include <string>

namespace Vorn::Hwmon {

// Whether the kernel has a hwmon class at all. Where it has none there are no sensors, and
// libsensors would take the lack for an error of the kernel's interface.
bool hasHwmon();

// A text that stays the same as long as the set of chips and the configuration do; never empty.
// Costs a few system calls per chip.
std::string machineFingerprint();

} // namespace Vorn::Hwmon
