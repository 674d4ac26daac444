// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The classes of the sensor profile and the providers that serve them, as this host knows them
// without a repository.

#pragma once

#include "host/broker/ClassInformation.h"
#include "host/manager/ProviderRegistration.h"

#include <optional>
#include <string>
#include <vector>

namespace Host {

// The five classes that are served, with their superclasses up to CIM_ManagedElement.
ClassTable sensorProfileClasses();

// Library files with their folders. Without the second one nobody serves ZUMLO_ComputerSystem.
std::vector<ProviderRegistration> sensorProfileProviders(
    const std::string& sensorLibrary, const std::optional<std::string>& computerSystemLibrary);

} // namespace Host
