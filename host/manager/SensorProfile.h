// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The registrations of the providers of the sensor profile.

#pragma once

#include "host/manager/ProviderRegistration.h"

#include <optional>
#include <string>
#include <vector>

namespace Host {

// Library files with their folders. Without the second one no provider serves
// ZUMLO_ComputerSystem.
std::vector<ProviderRegistration> sensorProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary);

} // namespace Host
