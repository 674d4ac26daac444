// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Takes down the present machine as a model file.

#pragma once

#include <string>

namespace Vorn {

// The text of a model file with every sensor that a cursor shows, temperatures first, then
// voltages, then tachometers, each with its present values; a value that is not finite is left
// out. A path that came up before is followed by "#2", "#3" and so on, since paths in a model are
// unique. Throws what Vorn::Instrumentation throws.
std::string recordMachineFile();

} // namespace Vorn
