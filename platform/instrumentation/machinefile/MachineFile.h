// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/machinefile/MachineFileNode.h"

#include <optional>
#include <vector>

namespace Vorn {

// Describes the renewal of a file by another process. Times are seconds since the machine started,
// which also pass while it is suspended and do not jump when its clock is set.
struct Renewal {
    double period = 0; // from one reading of the sensors to the next, in seconds
    double time = 0;   // when the sensors were read

    bool operator==(const Renewal&) const = default;
};

// The content of a model file.
struct MachineFile {
    std::vector<MachineFileNode> nodes;
    std::optional<Renewal> renewal = {}; // where another process renews the file
};

} // namespace Vorn
