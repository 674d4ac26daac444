// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>

namespace Vorn {

// Returns the text of a model file that describes this machine: all sensors of a cursor,
// temperatures first, then voltages, then tachometers, each with its current values; a value that
// is not finite is left out. A path that occurred before is followed by "#2", "#3" and so on, since
// paths in a model are unique. Throws what Vorn::Instrumentation throws.
std::string recordMachineFile();

} // namespace Vorn
