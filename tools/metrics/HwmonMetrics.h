// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/metrics/Exposition.h"

namespace Tools {

// Adds the series that node_exporter's collector of hwmon publishes on the present machine, so that
// dashboards that were made for it continue to work: one for each attribute in /sys/class/hwmon,
// without the configuration of libsensors.
void addHwmon(Exposition& exposition);

} // namespace Tools
