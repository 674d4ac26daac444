// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/hwmon/Chip.h"
#include "platform/instrumentation/hwmon/Status.h"

namespace Vorn::Hwmon {

// Reads a fan, voltage or temperature feature from the kernel, with the administrator's `compute`
// lines applied and without unset limits. REQUIRES: a ChipList lock is held; the feature exists.
Channel readChannel(const Feature& feature);

// Returns volts whose millivolts, truncated, are the whole number that the hardware reported. Of
// some numbers the nearest double lies below: 1200 mV divided by 1000 would be truncated to 1199.
// For these it returns the next double away from zero, for all others, such as computed ones, the
// argument. REQUIRES: the argument is finite.
double keepingMillivolts(double volts);

} // namespace Vorn::Hwmon
