// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/CommandLine.h"

#include "tools/LibraryLog.h"
#include "tools/UsageError.h"
#include "tools/output/Output.h"

#include <CLI/CLI.hpp>

#include <cmpidt.h>

#include <unistd.h>

#include <algorithm>
#include <cerrno> // program_invocation_name
#include <cstddef>
#include <exception>
#include <string>

namespace Tools {

namespace {

constexpr std::size_t columnOfDescriptions = 22; // in the help

constexpr const char* footer = "Exit codes: 0 success, 1 failure, 2 wrong usage, 3 nothing found.\n"
                               "`sensorctl COMMAND --help` describes a command.";

// CMPI_VERSION is a hundred times the version.
std::string versionText()
{
    constexpr int cmpi = CMPI_VERSION;
    return "sensorctl " SENSOR_PROFILE_VERSION " (CMPI " + std::to_string(cmpi / 100) + "." +
           std::to_string(cmpi % 100 / 10) + ")";
}

// Returns null when the command line names no command.
Command* chosenOf(const Commands& commands)
{
    const auto chosen = std::find_if(commands.begin(), commands.end(),
        [](const std::unique_ptr<Command>& command) { return command->isChosen(); });
    return chosen == commands.end() ? nullptr : chosen->get();
}

ExitCode refuse(
    const CLI::App& tool, const Command* command, Output& out, const std::string& reason)
{
    std::string words = program_invocation_name;
    for (const CLI::App* const chosen : tool.get_subcommands())
        words += " " + chosen->get_name();
    const std::string text = reason + " (" + words + " --help says what is possible)";
    if (command != nullptr)
        return command->reportFailure(out, text, ExitCode::wrongUsage);
    complain(text);
    return ExitCode::wrongUsage;
}

// Runs a command and prints what its libraries logged.
ExitCode runCommand(Command& command, Output& out)
{
    if (command.writesLog())
        return command.run(out);
    LibraryLog log;
    command.useLog(log);
    try {
        const ExitCode code = command.run(out);
        out.flush();
        log.printMessages("");
        return code;
    } catch (const UsageError&) {
        throw;
    } catch (const std::exception& error) {
        log.printMessages(error.what());
        throw;
    }
}

ExitCode print(Output& out, const std::string& text)
{
    out.write(text);
    out.flush();
    return ExitCode::success;
}

ExitCode run(
    int argc, const char* const* argv, const std::function<Commands(CLI::App&)>& addCommands)
{
    CLI::App tool(
        "Shows the hardware sensors of this machine as CIM clients see them.", "sensorctl");
    tool.set_version_flag("--version", versionText(), "Print the version and exit");
    tool.require_subcommand(0, 1); // runChosen() reports a missing command in plainer words
    tool.get_formatter()->label("SUBCOMMAND", "COMMAND");
    tool.get_formatter()->column_width(columnOfDescriptions);
    tool.footer(footer);
    const Commands commands = addCommands(tool);
    Output out(STDOUT_FILENO);
    try {
        tool.parse(argc, argv);
    } catch (const CLI::CallForHelp&) {
        return print(out, tool.help());
    } catch (const CLI::CallForVersion& version) {
        return print(out, version.what() + std::string("\n"));
    } catch (const CLI::ParseError& error) {
        return refuse(tool, chosenOf(commands), out, error.what());
    }
    Command* const command = chosenOf(commands);
    if (command == nullptr)
        return refuse(tool, nullptr, out, "a command is missing");
    try {
        return runCommand(*command, out);
    } catch (const UsageError& error) {
        return refuse(tool, command, out, error.what());
    } catch (const std::exception& error) {
        return command->reportFailure(out, error.what(), ExitCode::failure);
    }
}

} // namespace

int runTool(
    int argc, const char* const* argv, const std::function<Commands(CLI::App&)>& addCommands)
{
    reserveStandardStreams();
    try {
        return static_cast<int>(run(argc, argv, addCommands));
    } catch (const std::exception& error) {
        complain(error.what());
        return static_cast<int>(ExitCode::failure);
    }
}

} // namespace Tools
