// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"

#include "platform/instrumentation/Instrumentation.h"
#include "tools/SourceOptions.h"
#include "tools/output/Output.h"

#include <stdexcept>

namespace Tools {

using Vorn::NodeLexicon::NodeType;

namespace {

// Returns the text as a word of the shell.
std::string quoted(const std::string& text)
{
    std::string word = "'";
    for (const char c : text)
        word += c == '\'' ? "'\\''" : std::string(1, c);
    return word + "'";
}

std::string option(const std::string& name, const std::optional<std::string>& value)
{
    return value ? " " + name + " " + quoted(*value) : "";
}

} // namespace

std::size_t countSensors()
{
    std::size_t count = 0;
    for (const NodeType type : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer}) {
        Vorn::Instrumentation cursor;
        for (cursor.selectNode(type); cursor; ++cursor)
            ++count;
    }
    return count;
}

void checkMachineIsEmpty()
{
    if (const std::size_t count = countSensors(); count != 0)
        throw std::runtime_error("the machine has " + std::to_string(count) +
                                 " sensors, of which the provider shows none");
}

ExitCode complainOfEmptyMachine(const std::optional<std::string>& model)
{
    if (model)
        complain(*model + ": this machine has no sensors");
    else
        complain("this machine has no sensors (--model FILE shows one that a file describes)");
    return ExitCode::nothingFound;
}

ExitCode complainOfNoObject(
    const ObjectFound& found, const std::string& command, const SourceOptions& source)
{
    if (found.isMachineEmpty) {
        checkMachineIsEmpty();
        return complainOfEmptyMachine(source.model());
    }
    const std::string start = "sensorctl " + command + option("--model", source.model()) +
                              option("--provider", source.provider());
    std::vector<std::string> lines;
    for (const Sensor& sensor : found.choices)
        lines.push_back(
            start + (sensor.deviceId.starts_with('-') ? " -- " : " ") + quoted(sensor.deviceId));
    complain(found.complaint, lines);
    return lines.empty() ? ExitCode::nothingFound : ExitCode::failure;
}

} // namespace Tools
