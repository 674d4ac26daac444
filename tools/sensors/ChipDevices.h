// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What /sys/class/hwmon has of chips beside their sensors.

#pragma once

#include "platform/instrumentation/hwmon/Machine.h"
#include "tools/sensors/SensorList.h"

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace Tools {

// Finds the devices of chips: the model of a disk or battery, the name of a network interface or of
// a PCI slot. What a chip never changes is read once, as long as the chip stays, so that a server
// does not follow the links of all chips for each scrape. Not thread-safe.
class ChipDevices {
public:
    // Sets the devices of the sensors' chips, which the machine has. Leaves out what cannot be
    // read.
    void nameIn(Sensors& sensors, const Vorn::Hwmon::Machine& machine);

private:
    struct Chip {
        std::string name;                 // as libsensors names it
        std::vector<std::string> folders; // of its device, and of the one with the address
        std::string model;                // of its device
    };
    using Interfaces = std::map<std::string, std::string>; // by the folder of the device

    static Chip chipIn(const std::string& folder);
    static Interfaces networkInterfaces();
    std::string deviceOf(const Chip& chip, const Interfaces& interfaces) const;
    void renewChips(const Vorn::Hwmon::Machine& machine);
    void renewSlots();

    std::map<std::pair<std::string, Vorn::Hwmon::FolderId>, Chip> chips_; // by the folder
    std::vector<std::string> slots_;
    std::map<std::string, std::string> slotAt_; // the name of the slot by its address
};

// Sets the devices of the present machine once.
void nameDevices(Sensors& sensors);

// Returns a sentence such as "5 channels of other kinds are not shown (current, power)." about the
// present machine; an empty text when there are none.
std::string otherChannels();

} // namespace Tools
