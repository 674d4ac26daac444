// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/machinefile/MachineFile.h"

#include <string>

namespace Vorn {

// Returns the text of a model file: one line for each node, in the order given, members always in
// the same order, numbers in the shortest form of which the reader makes the same double. A value
// that a node lacks, or that is not finite, is left out. Bytes that are not UTF-8 become U+FFFD.
std::string writeMachineFile(const MachineFile& file);

} // namespace Vorn
