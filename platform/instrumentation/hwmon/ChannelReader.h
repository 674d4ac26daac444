// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/hwmon/Catalogue.h"
#include "platform/instrumentation/hwmon/Status.h"

namespace Vorn::Hwmon {

// Reads each attribute of a feature once, with the administrator's `compute` lines applied and
// without unset limits. `folder` is a descriptor of the chip's folder, or -1 where that could not
// be opened: only computed values can be read then.
ChannelState readChannel(const Chip& chip, int folder, const Feature& feature);

} // namespace Vorn::Hwmon
