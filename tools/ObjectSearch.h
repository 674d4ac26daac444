// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The object that a user means.

#pragma once

#include <string>

namespace Host {
class Instance;
}

namespace Tools {

class ProviderClient;

struct ObjectFound {
    const Host::Instance* object = nullptr; // null when there is none
    bool isMachineEmpty = false;            // there are no sensors at all to choose from
};

// By its object path, by DeviceID, by the name of a sensor or by InstanceID, whichever fits
// first. Throws UsageError for a path with a mistake in it, and std::runtime_error when several
// sensors have the name or when a provider fails.
ObjectFound findObject(ProviderClient& provider, const std::string& wanted);

} // namespace Tools
