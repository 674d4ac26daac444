// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <optional>
#include <string>

namespace Vorn::Companion {

// This computer, as its CIM instance describes it.
struct ComputerSystem {
    std::string name;                     // SystemName of all that belongs to the computer
    std::optional<std::string> machineId; // hashed: the machine's own is not for publication
};

// Returns the computer as it is now: a renamed one has its new name at the next request.
ComputerSystem thisComputerSystem();

} // namespace Vorn::Companion
