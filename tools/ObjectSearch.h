// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Finds the object that a user names.

#pragma once

#include "tools/sensors/Selector.h"

#include <optional>
#include <string>
#include <vector>

namespace Host {
class ObjectPath;
}

namespace Tools {

class ProviderClient;

struct ObjectFound {
    const Host::Instance* object = nullptr; // null unless one object matches
    Sensors choices;                        // the sensors that match
    bool isMachineEmpty = false;            // the machine has no sensors
    std::string complaint;                  // why there is no object
};

// Reads the sensors once, when it needs them first.
class ObjectSearch {
public:
    // Finds only sensors that the filter accepts, unless it is empty. Provider and filter must
    // outlive the object.
    ObjectSearch(ProviderClient& provider, const SensorFilter& filter)
        : provider_(provider), filter_(filter)
    {
    }

    // Finds an object by object path, by DeviceID, by a selector that only one sensor matches, or
    // by InstanceID, in this order. Throws UsageError for a malformed path, and std::runtime_error
    // when a provider fails.
    ObjectFound find(const std::string& wanted);

private:
    ObjectFound findByPath(const Host::ObjectPath& path, const std::string& wanted) const;
    const Sensors& sensors();

    ProviderClient& provider_;
    const SensorFilter& filter_;
    std::optional<Sensors> sensors_;
};

} // namespace Tools
