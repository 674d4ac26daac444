// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/sensors/ChipDevices.h"
#include "tools/sensors/SensorList.h"

#include <chrono>
#include <map>
#include <string>
#include <vector>

namespace Host {
class Manager;
}

namespace Vorn::Hwmon {
struct Catalogue;
}

namespace Tools {

// The sensors of the machine at one time, without their instances, in the provider's order.
struct Harvest {
    Sensors sensors;
    // The sources of VORN_INSTRUMENTATION, such as "hwmon" or "model:FILE", and whether each could
    // be read and no sensor of it is missing.
    std::map<std::string, bool> sources;
    std::chrono::duration<double> duration{};

    // Returns the names of the sources that could not be read, or not whole.
    std::vector<std::string> lostSources() const;
};

// Reads all sensors through the provider that the manager has loaded. Where a source fails, the
// harvest has the sensors of the others.
Harvest readHarvest(const Host::Manager& manager, ChipDevices& devices);

// Reads the records of which the provider makes instances, in less time. Of up to 65,535 sensors,
// which is the most that the provider publishes, the result is the same. REQUIRES:
// canReadRecords().
Harvest readHarvestOfRecords(ChipDevices& devices);

// Returns whether records can be read beside a provider in this process. Otherwise both would use
// the shared libsensors, which has one list of chips.
bool canReadRecords();

// Returns the state of each source, as a harvest with these sensors has it. The chips are those of
// the source hwmon; null where they cannot be listed.
std::map<std::string, bool> statesOfSources(
    const Sensors& sensors, const Vorn::Hwmon::Catalogue* chips);

} // namespace Tools
