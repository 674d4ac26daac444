// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace lines of whole requests, written and expected, in this form:
//
//     SensorFactory 3000 makeSensorInstance(SensorFactory:269) ENTERING: makeSensorInstance() in
//     SensorFactory [Line: 269]
//
// Line numbers that follow the source instead of being an interface are left out, and so are
// parameter lists but for the class names that a target is looked up with.

#pragma once

#include "tests/support/ProviderTest.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Testing {

using Lines = std::vector<std::string>;

inline std::string place(const std::string& function, const std::string& file, unsigned line)
{
    return " " + function + "(" + file + (line ? ":" + std::to_string(line) : "") + ") ";
}

// Returns a log line in this form.
std::string requestLine(const LogLine& line);

// Returns the lines that a request writes to both channels, without those of the harvest.
template <typename Request>
Lines traceOf(const Request& request)
{
    const LogCapture capture;
    request();
    const auto own = [](const std::vector<LogLine>& all) {
        Lines lines; // the embedded broker writes to the trace channel, too
        for (const LogLine& line : all)
            if (line.component.starts_with("Nimbrel.") && line.component != "Nimbrel.Sensor")
                lines.push_back(requestLine(line));
        return lines;
    };
    EXPECT_EQ(own(capture.trace()), own(capture.log()));
    return own(capture.log());
}

inline std::string numbered(const std::string& text, unsigned line)
{
    return line ? text + " [Line: " + std::to_string(line) + "]" : text;
}

// The expected lines of one handler. A line of 0 is not given.
struct HandlerLines {
    std::string component;
    std::string module;
    std::string handler;

    Lines entry(unsigned line = 0) const
    {
        return {component + " 4000 markProviderEntry(Trace:336) " + std::string(78, '='),
            component + " 4000 markProviderEntry(Trace:337) " +
                numbered("ENTERING: " + handler + "() in " + module, line)};
    }

    Lines exit(unsigned line = 0) const
    {
        return {component + " 4000 markProviderExit(Trace:348) " +
                    numbered("EXITING: " + handler + "() in " + module, line),
            component + " 4000 markProviderExit(Trace:349) " + std::string(78, '=')};
    }

    Lines failure(const std::string& text, unsigned line = 0) const
    {
        return {component + " 6000" + place(handler, module, line) + "MESSAGE [File: " + module +
                (line ? ", Line: " + std::to_string(line) : "") + "]: " + text};
    }
};

inline std::string operationLine(const std::string& mark, const std::string& name, unsigned line,
    int level = 3000, const std::string& parameters = {})
{
    return "SensorFactory " + std::to_string(level) + place(name, "SensorFactory", line) +
           numbered(mark + ": " + name + "() in SensorFactory", line) + parameters;
}

// Returns the expected lines of an operation of the factory.
inline Lines operation(const std::string& name, unsigned entry = 0, unsigned exit = 0)
{
    return {operationLine("ENTERING", name, entry), operationLine("EXITING", name, exit)};
}

// Returns the expected lines of an operation that ends without its exit mark.
inline Lines brokenOff(const std::string& name, unsigned entry = 0)
{
    return {operationLine("ENTERING", name, entry)};
}

inline Lines sequence(const std::vector<Lines>& parts)
{
    Lines lines;
    for (const Lines& part : parts)
        lines.insert(lines.end(), part.begin(), part.end());
    return lines;
}

inline Lines around(const Lines& outer, const Lines& inner)
{
    return sequence({{outer.front()}, inner, {outer.back()}});
}

inline Lines counted()
{
    return {operationLine("ENTERING", "getNumberOfInstances", 0, 4000),
        operationLine("EXITING", "getNumberOfInstances", 0, 4000)};
}

// Returns the expected lines of the factory's constructor, with those of the maps that it fills.
inline Lines builtFactory(const Lines& maps)
{
    Lines inner;
    for (const std::string& map : maps) {
        inner.push_back(operationLine("ENTERING", map, 0, 4000));
        inner.push_back(operationLine("EXITING", map, 0, 4000));
    }
    return around(operation("SensorFactory"), inner);
}

// Returns only the lines of the provider.
inline Lines ownLines(Lines lines)
{
    std::erase_if(
        lines, [](const std::string& line) { return line.starts_with("SensorFactory "); });
    return lines;
}

// Returns the expected lines of the look-up of an association's target. `exit` is the line number
// of its exit mark.
inline Lines lookedUp(const std::string& association, const std::string& resultClass, unsigned exit)
{
    const std::string names = " _RefLeftClass=" + association + " _RefRightClass=" + resultClass;
    const std::string path = "get_assoc_targetClass_ObjectPath";
    const std::string name = "get_assoc_targetClass_Name";
    return {operationLine("ENTERING", path, 1288, 3000, names),
        operationLine("ENTERING", name, 1185, 3000, names),
        operationLine("EXITING", name, exit, 3000, names),
        operationLine("EXITING", path, 1316, 3000, names)};
}

} // namespace Testing
