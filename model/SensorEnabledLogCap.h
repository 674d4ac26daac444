// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace Vorn::SensorProfileProvider {

// Holds the capabilities that all sensors of the machine share: which requested states they accept
// and whether their names can be edited. The values are the same on every machine; each accessor
// stores its value before it returns it. A value type for one thread.
class SensorEnabledLogCap {
public:
    std::string getInstanceID() { return instanceID_ = "ZUMLO:SensorEnabledLogicalElementCap1"; }
    bool getElementNameEditSupported() { return elementNameEditSupported_ = false; }

    // Appends 0, 1 and 2 at every call; the first call on a copy returns exactly these.
    std::vector<std::uint16_t> getStatesSupported()
    {
        statesSupported_.insert(statesSupported_.end(), {0, 1, 2});
        return statesSupported_;
    }

private:
    std::string instanceID_;
    bool elementNameEditSupported_ = false;
    std::vector<std::uint16_t> statesSupported_;
};

} // namespace Vorn::SensorProfileProvider
