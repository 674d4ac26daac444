// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the attributes of fans, voltages and temperatures mean for their channel. The kernel's
// Documentation/hwmon/sysfs-interface.rst defines each attribute.

#pragma once

#include "platform/instrumentation/hwmon/Status.h"

#include <sensors/sensors.h>

#include <optional>

namespace Vorn::Hwmon {

struct AttributeMeaning {
    sensors_subfeature_type type;
    double divisor; // of the kernel's number, which gives the value in the unit of the reading
    // Stores a value of the attribute; none when it could not be read.
    void (*store)(ChannelState& channel, std::optional<double> value);
};

// Returns a null pointer for a type that means nothing for its channel.
const AttributeMeaning* meaningOf(sensors_subfeature_type type);

// libsensors 3.6.0 has no subfeature for `*_enable`.
extern const AttributeMeaning enableMeaning;

} // namespace Vorn::Hwmon
