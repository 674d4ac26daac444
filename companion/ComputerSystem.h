// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// This computer, as an instance of ZUMLO_ComputerSystem describes it.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <optional>
#include <string>

namespace Vorn::Companion {

inline constexpr const char* ComputerSystemClass = "ZUMLO_ComputerSystem";

struct ComputerSystem {
    std::string name;                     // SystemName of all that belongs to the computer
    std::optional<std::string> machineId; // hashed: the machine's own is not for publication
};

// Returns the computer as it is now: a renamed one has its new name at the next request.
ComputerSystem thisComputerSystem();

// Returns a path with this computer as host; null when the broker fails to make it with its keys.
CMPIObjectPath* makeSystemPath(
    const CMPIBroker* broker, const char* nameSpace, const ComputerSystem& system);

// Returns an instance with the keys and, of the other properties, those in the list (all when it is
// null), without properties that the broker refuses. Null when the broker fails to make an instance
// with its keys.
CMPIInstance* makeSystemInstance(const CMPIBroker* broker, const CMPIObjectPath* path,
    const ComputerSystem& system, const char** properties);

} // namespace Vorn::Companion
