// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/machinefile/MachineFileNode.h"

#include <string_view>
#include <vector>

namespace Vorn {

// Returns the nodes that the text of a model file describes, in its order. Whole millivolts in it
// are published as they are (keepingThousandths()). Thread-safe; independent of the process's
// locale. Throws std::runtime_error: for text that is not JSON with line and column, for JSON of
// another shape with the JSON pointer (RFC 6901) of the value, and with what was expected there and
// found.
std::vector<MachineFileNode> readMachineFile(std::string_view text);

} // namespace Vorn
