// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/ObjectChoices.h"

#include "tools/EmptyMachine.h"
#include "tools/output/Output.h"
#include "tools/output/PrintableText.h"
#include "tools/output/Terminal.h"

#include <CLI/CLI.hpp>

#include <algorithm>
#include <cerrno> // program_invocation_name
#include <string_view>
#include <vector>

namespace Tools {

namespace {

// Returns the text as a word of the shell.
std::string quoted(const std::string& text)
{
    constexpr std::string_view marks = "%+,-./:=@_";
    const bool isPlain = std::all_of(text.begin(), text.end(), [&](char c) {
        return (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') ||
               marks.find(c) != std::string_view::npos;
    });
    if (isPlain && !text.empty())
        return text;
    std::string word = "'";
    for (const char c : text)
        word += c == '\'' ? "'\\''" : std::string(1, c);
    return word + "'";
}

// Returns the options that the parser was given, each after a blank.
std::string givenOptions(const CLI::App& parser)
{
    std::string words;
    for (const CLI::Option* const option : parser.get_options()) {
        if (option->get_positional())
            continue;
        const bool isFlag = option->get_expected_max() == 0;
        for (const std::string& value : option->results()) {
            words.append(" ").append(option->get_name());
            if (!isFlag)
                words.append(" ").append(quoted(value));
        }
    }
    return words;
}

} // namespace

ExitCode complainOfNoObject(
    const ObjectFound& found, const CLI::App& parser, const std::optional<std::string>& model)
{
    if (found.isMachineEmpty) {
        checkMachineIsEmpty();
        return complainOfEmptyMachine(model);
    }
    const std::string start =
        quoted(program_invocation_name) + " " + parser.get_name() + givenOptions(parser);
    std::vector<std::string> lines;
    for (const Sensor& sensor : found.choices) {
        const bool isPrinted = printable(sensor.deviceId, isUtf8Locale()) == sensor.deviceId;
        const std::string& name = isPrinted ? sensor.deviceId : sensor.path;
        lines.push_back(start + (name.starts_with('-') ? " -- " : " ") + quoted(name));
    }
    complain(found.complaint, lines);
    return lines.empty() ? ExitCode::nothingFound : ExitCode::failure;
}

} // namespace Tools
