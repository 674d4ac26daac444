// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/machinefile/MachineFile.h"

#include <string_view>

namespace Vorn {

// Returns what the text of a model file describes, the nodes in its order. Whole millivolts in it
// are published as they are (keepingThousandths()). Thread-safe; independent of the process's
// locale. Throws std::runtime_error: for text that is not JSON with line and column, for JSON of
// another shape with the JSON pointer (RFC 6901) of the value, and with what was expected there and
// found.
MachineFile readMachineFile(std::string_view text);

} // namespace Vorn
