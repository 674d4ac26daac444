// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The subcommands, each in a file of its own.

#pragma once

#include "tools/Command.h"

#include <memory>
#include <string>
#include <vector>

namespace Tools {

std::unique_ptr<Command> makeListCommand(CLI::App& tool);
std::unique_ptr<Command> makeGetCommand(CLI::App& tool);
std::unique_ptr<Command> makeWalkCommand(CLI::App& tool);
std::unique_ptr<Command> makeWatchCommand(CLI::App& tool);
std::unique_ptr<Command> makeCheckCommand(CLI::App& tool);
std::unique_ptr<Command> makeRecordCommand(CLI::App& tool);
std::unique_ptr<Command> makeCollectCommand(CLI::App& tool);
std::unique_ptr<Command> makeMetricsCommand(CLI::App& tool);
// Takes the words of the command line, which the program of the server parses again.
std::unique_ptr<Command> makeServeCommand(CLI::App& tool, std::vector<std::string> words);

} // namespace Tools
