// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/hwmon/Catalogue.h"
#include "platform/instrumentation/hwmon/Status.h"

namespace Vorn::Hwmon {

// Reads each attribute of a feature once, with the administrator's `compute` lines applied and
// without unset limits. `folder` is a descriptor of the chip's folder, or -1 where that could not
// be opened: only computed values can be read then.
Channel readChannel(const Chip& chip, int folder, const Feature& feature);

// Returns volts whose millivolts, truncated, are the whole number that the hardware reported. Of
// some numbers the nearest double lies below: 1200 mV divided by 1000 would be truncated to 1199.
// For these it returns the next double away from zero, for all others the argument. REQUIRES: the
// argument is finite.
double keepingMillivolts(double volts);

} // namespace Vorn::Hwmon
