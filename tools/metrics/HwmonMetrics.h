// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/metrics/Exposition.h"

namespace Tools {

// Adds what node_exporter's collector of hwmon has of the present machine, with its names and
// labels, so that dashboards that were made for it continue to work: each attribute in
// /sys/class/hwmon as a series, without the configuration of libsensors.
void addHwmon(Exposition& exposition);

} // namespace Tools
