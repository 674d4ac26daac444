// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reads one fan, voltage or temperature feature.

#pragma once

#include "platform/instrumentation/hwmon/Chip.h"
#include "platform/instrumentation/hwmon/Status.h"

namespace Vorn::Hwmon {

// Every value afresh from the kernel, with the administrator's `compute` lines applied; limits
// that nobody set are left out. REQUIRES: a ChipList lock is held; the feature is there.
Channel readChannel(const Feature& feature);

} // namespace Vorn::Hwmon
