// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Finds the object that a user names.

#pragma once

#include <string>

namespace Host {
class Instance;
}

namespace Tools {

class ProviderClient;

struct ObjectFound {
    const Host::Instance* object = nullptr; // null when there is none
    bool isMachineEmpty = false;            // the machine has no sensors
};

// Finds an object by object path, DeviceID, name of a sensor or InstanceID, in this order. Throws
// UsageError for a malformed path, and std::runtime_error when several sensors have the name or a
// provider fails.
ObjectFound findObject(ProviderClient& provider, const std::string& wanted);

} // namespace Tools
