// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What /sys/class/hwmon has of chips beside their sensors.

#pragma once

#include "tools/sensors/SensorList.h"

#include <string>

namespace Tools {

// Sets the devices of the sensors' chips on the present machine: the model of a disk or battery,
// the name of a network interface or of a PCI slot. Leaves out what cannot be read.
void nameDevices(Sensors& sensors);

// Returns a sentence such as "5 channels of other kinds are not shown (current, power)." about the
// present machine; an empty text when there are none.
std::string otherChannels();

} // namespace Tools
