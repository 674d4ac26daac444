// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The tool as a function that main() calls.

#pragma once

#include "tools/Command.h"

#include <functional>
#include <memory>
#include <vector>

namespace Tools {

using Commands = std::vector<std::unique_ptr<Command>>;

// Parses and executes the command line, and returns the exit code of the process. Messages go to
// standard error, results to standard output. The function adds the commands to the parser.
int runTool(
    int argc, const char* const* argv, const std::function<Commands(CLI::App&)>& addCommands);

} // namespace Tools
