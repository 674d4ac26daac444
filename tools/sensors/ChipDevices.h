// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the kernel's sysfs knows of the chips beside the sensors shown here.

#pragma once

#include "tools/sensors/SensorList.h"

#include <cstddef>
#include <map>
#include <set>
#include <string>

namespace Tools {

// The devices that chips belong to, and the channels of other kinds, read from /sys/class/hwmon.
class ChipDevices {
public:
    // Reads the present machine. What cannot be read is left out.
    ChipDevices();

    // Sets the devices of the sensors. A device is a disk's or battery's model, the name of a network
    // interface, or the name of a PCI slot.
    void nameIn(Sensors& sensors) const;

    // Returns a sentence such as "5 channels of other kinds are not shown (power, current)."; an
    // empty text when there are none.
    std::string otherChannels() const;

private:
    void read(const std::string& folder);
    void countChannels(const std::string& folder);

    std::map<std::string, std::string> devices_; // by the name of the chip
    std::size_t otherChannels_ = 0;
    std::set<std::string> otherKinds_;
};

} // namespace Tools
