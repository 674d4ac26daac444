// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/commands/ColorOption.h"

#include "tools/output/Terminal.h"

#include <CLI/CLI.hpp>

#include <map>

namespace Tools {

namespace {

const std::map<std::string, ColorChoice> choices = {{"auto", ColorChoice::automatic},
    {"always", ColorChoice::always}, {"never", ColorChoice::never}};

} // namespace

void ColorOption::addTo(CLI::App& parser)
{
    parser.add_option("--color", color_, "auto (on a terminal), always or never")
        ->type_name("WHEN")
        ->check(CLI::IsMember(choices).description(""));
}

bool ColorOption::isColored() const
{
    return isColorWanted(choices.at(color_));
}

} // namespace Tools
