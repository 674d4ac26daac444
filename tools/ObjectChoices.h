// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The messages for the user where no object, or more than one, is found.

#pragma once

#include "tools/Command.h"
#include "tools/ObjectSearch.h"

#include <optional>
#include <string>

namespace CLI {
class App;
}

namespace Tools {

// Writes to standard error why there is no object, with the command lines for sensors to choose
// from. They begin with the words by which the tool was called, and repeat the options that the
// command's parser was given. Calls checkMachineIsEmpty() where the machine has no sensors.
ExitCode complainOfNoObject(
    const ObjectFound& found, const CLI::App& parser, const std::optional<std::string>& model);

} // namespace Tools
