// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/machinefile/MachineFileNode.h"

#include <optional>
#include <vector>

namespace Vorn {

// When a process wrote a file that it renews again and again. Times are seconds since the machine
// started, which also pass while it is suspended and do not jump when its clock is set.
struct Renewal {
    double period = 0; // in seconds
    double time = 0;

    bool operator==(const Renewal&) const = default;
};

// The content of a model file.
struct MachineFile {
    std::vector<MachineFileNode> nodes;
    std::optional<Renewal> renewal = {}; // of a file that a process renews
};

} // namespace Vorn
