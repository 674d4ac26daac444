// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// This computer, as far as its CIM instance tells about it.

#pragma once

#include <optional>
#include <string>

namespace Vorn::Companion {

struct ComputerSystem {
    std::string name;                     // SystemName of all that belongs to the computer
    std::optional<std::string> machineId; // hashed: the machine's own is not for publication
};

// Reads it afresh: a renamed machine has its new name at the next request.
ComputerSystem thisComputerSystem();

} // namespace Vorn::Companion
