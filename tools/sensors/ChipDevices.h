// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What /sys/class/hwmon has of chips beside their sensors.

#pragma once

#include "platform/instrumentation/hwmon/Machine.h"
#include "tools/sensors/SensorList.h"

#include <map>
#include <optional>
#include <string>
#include <vector>

namespace Tools {

// Finds the devices of chips on the present machine: the model of a disk or battery, the name of a
// network interface or of a PCI slot. What a chip never changes is read once, as long as the chip
// stays, so that a server does not follow the links of all chips for each scrape. Not thread-safe.
class ChipDevices {
public:
    // Sets the devices of the sensors' chips. Leaves out what cannot be read.
    void nameIn(Sensors& sensors);

private:
    struct Chip {
        std::string suffix;               // that libsensors appends to its name
        std::vector<std::string> folders; // of its device, and of the one with the address
        std::string model;                // of its device
    };
    struct Known {
        Vorn::Hwmon::FolderId id;
        std::string name; // the driver's
        std::optional<Chip> chip;
    };

    static Chip chipIn(const std::string& folder);
    std::string deviceOf(const Chip& chip) const;
    void renewSlots();

    std::map<std::string, Known> known_; // by the name of the folder
    std::vector<std::string> slots_;
    std::map<std::string, std::string> slotAt_; // the name of the slot by its address
};

// Sets the devices once.
inline void nameDevices(Sensors& sensors)
{
    ChipDevices().nameIn(sensors);
}

// Returns a sentence such as "5 channels of other kinds are not shown (current, power)." about the
// present machine; an empty text when there are none.
std::string otherChannels();

} // namespace Tools
