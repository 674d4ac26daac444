// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/providers/RequestTrace.h"

#include "tests/support/Pattern.h"

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
    static const Pattern number(R"(( \[Line: \d+\])|(, Line: \d+))");
    static const Pattern names(R"(.*( _RefLeftClass=.*) rc=.*)");
    std::string text = line.text.substr(0, line.text.find(",Parameters"));
    if (!hasGivenLine(line))
        text = number.replace(text, "");
    if (const auto found = names.match(line.text); !found.empty())
        text += found[1];
    const bool hasPlace = hasGivenLine(line) || line.file == "Trace";
    return line.component.substr(std::string("Nimbrel.").size()) + " " +
           std::to_string(line.level) + place(line.function, line.file, hasPlace ? line.line : 0) +
           text;
}

} // namespace Testing
