// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/machinefile/MachineFile.h"

#include <map>
#include <optional>
#include <vector>

namespace Vorn {

// The content of a model file as a source serves it.
struct ServedMachineFile {
    explicit ServedMachineFile(MachineFile file);

    std::map<NodeLexicon::NodeType, std::vector<Node>> nodes; // in the file's order
    std::vector<NodeReading> readings;                        // by the tokens of the nodes
    std::optional<Renewal> renewal;
};

} // namespace Vorn
