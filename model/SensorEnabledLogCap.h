// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace Vorn::SensorProfileProvider {

// The capabilities every sensor of the machine shares: which requested states it accepts and
// whether its name can be edited. The values are the same on all machines; each accessor stores
// its value before it returns it. A value type for one thread.
class SensorEnabledLogCap {
public:
    SensorEnabledLogCap() = default;

    std::string getInstanceID();
    bool getElementNameEditSupported();
    // Appends 0, 1 and 2 at every call; called once on a copy it returns just these.
    std::vector<std::uint16_t> getStatesSupported();

private:
    std::string instanceID_;
    bool elementNameEditSupported_ = false;
    std::vector<std::uint16_t> statesSupported_;
};

} // namespace Vorn::SensorProfileProvider
