// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The registrations of the providers of the sensor profile.

#pragma once

#include "host/manager/ProviderRegistration.h"

#include <optional>
#include <string>
#include <vector>

namespace Host {

// Both functions take library files with their folders. Without the second one no provider serves
// ZUMLO_ComputerSystem and the registration of the profile.

// Returns the providers of the sensors, their computer system and their capabilities.
std::vector<ProviderRegistration> sensorProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary);

// Returns the providers of sensorProfileProviders() and those of the profile's registration, which
// need root/interop.
std::vector<ProviderRegistration> registeredProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary);

} // namespace Host
