// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/Command.h"

#include "tools/output/Output.h"

#include <CLI/CLI.hpp>

namespace Tools {

Command::Command(CLI::App& tool, const char* name, const char* description)
    : parser_(tool.add_subcommand(name, description))
{
}

ExitCode Command::reportFailure(Output& /*out*/, const std::string& reason, ExitCode code) const
{
    complain(reason);
    return code;
}

bool Command::isChosen() const
{
    return parser_->parsed();
}

} // namespace Tools
