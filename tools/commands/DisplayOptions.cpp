// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/commands/DisplayOptions.h"

#include "tools/output/Terminal.h"

#include <CLI/CLI.hpp>

#include <set>

namespace Tools {

void DisplayOptions::addForm(
    CLI::App& parser, const char* option, Form form, const char* description)
{
    const auto choose = [this, form] {
        if (form_ != Form::table && form_ != form)
            throw CLI::ValidationError("only one form of output can be given");
        form_ = form;
    };
    parser.add_flag_callback(option, choose, description);
}

void DisplayOptions::addJson(CLI::App& parser)
{
    addForm(parser, "--json", Form::json, "Print a JSON document");
    addForm(parser, "--cim", Form::cim, "Print all CIM properties in a JSON document");
}

void DisplayOptions::addTables(CLI::App& parser)
{
    addForm(parser, "--flat", Form::flat, "Print one line for each sensor");
    addForm(parser, "--csv", Form::csv, "Print comma-separated values");
}

void DisplayOptions::addColor(CLI::App& parser)
{
    const std::set<std::string> choices = {"always", "auto", "never"};
    parser.add_option("--color", color_, "auto (on a terminal), always or never")
        ->type_name("WHEN")
        ->check(CLI::IsMember(choices).description(""));
}

TextStyle DisplayOptions::style() const
{
    const bool isColored = color_ == "always" || (color_ == "auto" && isColorTerminal());
    return {outputWidth(), isColored, isUtf8Locale()};
}

} // namespace Tools
