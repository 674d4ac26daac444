// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/commands/DisplayOptions.h"

#include "tools/output/Terminal.h"

#include <CLI/CLI.hpp>

#include <set>

namespace Tools {

void DisplayOptions::addJson(CLI::App& parser)
{
    parser.add_flag("--json", isJson_, "Print a JSON document");
}

void DisplayOptions::addColor(CLI::App& parser)
{
    const std::set<std::string> choices = {"always", "auto", "never"};
    parser.add_option("--color", color_, "auto (on a terminal), always or never")
        ->type_name("WHEN")
        ->check(CLI::IsMember(choices).description(""));
}

bool DisplayOptions::isColored() const
{
    return color_ == "always" || (color_ == "auto" && isColorTerminal());
}

} // namespace Tools
