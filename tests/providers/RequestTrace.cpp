// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/providers/RequestTrace.h"

#include <regex>
#include <set>

namespace Testing {

namespace {

bool hasGivenLine(const LogLine& line)
{
    static const std::set<std::string> modules = {
        "Nimbrel.SensorProfileProvider", "Nimbrel.SensorEnabledLogicalElementCapabilitiesProvider"};
    static const std::set<std::string> operations = {"makeSensorInstance",
        "makeSensorEnabledLogicalElementCapInstance",
        "getAllSensorEnabledLogicalElementCapCMPIInstances",
        "getOneSensorEnabledLogicalElementCapCMPIInstance",
        "getAllSensorEnabledLogicalElementCapCMPIObjPaths", "get_assoc_targetClass_Name",
        "get_assoc_targetClass_ObjectPath"};
    return modules.contains(line.component) || operations.contains(line.function);
}

} // namespace

std::string requestLine(const LogLine& line)
{
    static const std::regex number(R"(( \[Line: \d+\])|(, Line: \d+))");
    static const std::regex names(R"(.*( _RefLeftClass=.*) rc=.*)");
    std::string text = line.text.substr(0, line.text.find(",Parameters"));
    if (!hasGivenLine(line))
        text = std::regex_replace(text, number, "");
    if (std::smatch found; std::regex_match(line.text, found, names))
        text += found[1];
    const bool hasPlace = hasGivenLine(line) || line.file == "Trace";
    return line.component.substr(std::string("Nimbrel.").size()) + " " +
           std::to_string(line.level) + place(line.function, line.file, hasPlace ? line.line : 0) +
           text;
}

} // namespace Testing
