// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/hwmon/Chip.h"
#include "platform/instrumentation/hwmon/Status.h"

namespace Vorn::Hwmon {

// Reads a fan, voltage or temperature feature from the kernel, with the administrator's `compute`
// lines applied and without unset limits. REQUIRES: a ChipList lock is held; the feature exists.
Channel readChannel(const Feature& feature);

} // namespace Vorn::Hwmon
