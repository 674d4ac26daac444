// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/sensors/SensorList.h"

#include <chrono>
#include <string>
#include <vector>

namespace Host {
class Manager;
}

namespace Tools {

struct SourceState {
    std::string name; // such as "hwmon" or "model:FILE"
    bool isUp;        // whether it could be read and all its sensors are in the harvest
};

// The sensors of the machine at one time, without their instances, in the provider's order.
struct Harvest {
    Sensors sensors;
    std::vector<SourceState> sources; // those of VORN_INSTRUMENTATION
    std::chrono::duration<double> duration{};
};

// Reads all sensors through the provider. Where that fails, the harvest has those that it returned.
Harvest readHarvest(const Host::Manager& manager);

} // namespace Tools
