// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Source.h"

#include <string>

namespace Vorn {

// One sensor in a model file.
struct MachineFileNode {
    NodeLexicon::NodeType type{};
    std::string path;
    std::string description;
    unsigned sensorType = 0;
    NodeReading values;
};

} // namespace Vorn
