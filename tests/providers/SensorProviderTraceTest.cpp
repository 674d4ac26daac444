// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace lines of whole requests, line by line.

#include "tests/providers/Factories.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace {

using ::testing::ElementsAre;
using ::testing::ElementsAreArray;
using Testing::LogCapture;
using Testing::LogLine;
using Testing::ProviderTest;
using Testing::ScriptedMachine;
using Testing::ScriptedNode;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

constexpr const char* Class = "ZUMLO_NumericSensor";
const std::string Separator(78, '=');

class SensorProviderTraceTest : public ProviderTest {
protected:
    SensorProviderTraceTest()
        : mi_(SensorProfileProvider_Create_InstanceMI(broker(), nullptr, nullptr))
    {
    }

    // What one request writes, without the lines of the harvest.
    std::vector<std::string> traceOf(const std::vector<ScriptedNode>& nodes,
        const std::vector<std::pair<std::string, std::string>>& keys,
        CMPIStatus (*request)(
            CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*))
    {
        const ScriptedMachine machine(nodes);
        const CMPIObjectPath* const ref = path(Class, keys).handle();
        const LogCapture capture;
        request(mi_, context(), result(), ref);
        std::vector<std::string> lines;
        for (const LogLine& line : capture.log()) {
            if (line.component == "Nimbrel.Sensor")
                continue;
            lines.push_back(shortened(line));
        }
        EXPECT_EQ(ownLines(capture.trace()), ownLines(capture.log()));
        return lines;
    }

    // The library's lines; the embedded broker writes to the trace channel, too.
    static std::vector<std::string> ownLines(const std::vector<LogLine>& lines)
    {
        std::vector<std::string> own;
        for (const LogLine& line : lines)
            if (line.component.starts_with("Nimbrel."))
                own.push_back(Testing::withoutPointers(line));
        return own;
    }

    // Component, level and text without parameters; factory lines, whose line number is that of
    // the source, without it.
    static std::string shortened(const LogLine& line)
    {
        std::string text = line.text.substr(0, line.text.find(",Parameters"));
        if (line.component == "Nimbrel.SensorFactory" && line.function != "makeSensorInstance")
            text = text.substr(0, text.find(" [Line"));
        if (line.text == Separator)
            text = "=";
        return line.component.substr(8) + " " + std::to_string(line.level) + " " + line.function +
               " " + text;
    }

    static CMPIStatus enumerateNames(CMPIInstanceMI* mi, const CMPIContext* context,
        const CMPIResult* result, const CMPIObjectPath* ref)
    {
        return mi->ft->enumerateInstanceNames(mi, context, result, ref);
    }

    static CMPIStatus enumerate(CMPIInstanceMI* mi, const CMPIContext* context,
        const CMPIResult* result, const CMPIObjectPath* ref)
    {
        return mi->ft->enumerateInstances(mi, context, result, ref, nullptr);
    }

    static CMPIStatus get(CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* ref)
    {
        return mi->ft->getInstance(mi, context, result, ref, nullptr);
    }

    CMPIInstanceMI* mi_;
};

const std::vector<ScriptedNode> OneFan = {{NodeType::Tachometer, "/f", "Fan", NodeReading{}}};

std::vector<std::string> entry(const std::string& handler, int line)
{
    return {"SensorProfileProvider 4000 markProviderEntry =",
        "SensorProfileProvider 4000 markProviderEntry ENTERING: " + handler +
            "() in SensorProvider [Line: " + std::to_string(line) + "]"};
}

std::vector<std::string> exit(const std::string& handler, int line)
{
    return {"SensorProfileProvider 4000 markProviderExit EXITING: " + handler +
                "() in SensorProvider [Line: " + std::to_string(line) + "]",
        "SensorProfileProvider 4000 markProviderExit ="};
}

std::vector<std::string> failure(const std::string& handler, int line, const std::string& text)
{
    return {"SensorProfileProvider 6000 " + handler +
            " MESSAGE [File: SensorProvider, Line: " + std::to_string(line) + "]: " + text};
}

const std::vector<std::string> BuiltFactory = {
    "SensorFactory 3000 SensorFactory ENTERING: SensorFactory() in SensorFactory",
    "SensorFactory 4000 _createSensorMap ENTERING: _createSensorMap() in SensorFactory",
    "SensorFactory 4000 _createSensorMap EXITING: _createSensorMap() in SensorFactory",
    "SensorFactory 3000 SensorFactory EXITING: SensorFactory() in SensorFactory"};

const std::vector<std::string> EmptyFactory = {BuiltFactory.front(), BuiltFactory.back()};

std::vector<std::string> operation(const std::string& name, int level = 3000)
{
    const std::string head = "SensorFactory " + std::to_string(level) + " " + name;
    return {head + " ENTERING: " + name + "() in SensorFactory",
        head + " EXITING: " + name + "() in SensorFactory"};
}

const std::vector<std::string> Counted = operation("getNumberOfInstances", 4000);

const std::vector<std::string> OneInstance = {
    "SensorFactory 3000 makeSensorInstance ENTERING: makeSensorInstance() in SensorFactory "
    "[Line: 269]",
    "SensorFactory 3000 makeSensorInstance EXITING: makeSensorInstance() in SensorFactory "
    "[Line: 737]"};

std::vector<std::string> around(
    const std::vector<std::string>& outer, const std::vector<std::string>& inner)
{
    std::vector<std::string> lines = {outer.front()};
    lines.insert(lines.end(), inner.begin(), inner.end());
    lines.push_back(outer.back());
    return lines;
}

std::vector<std::string> sequence(const std::vector<std::vector<std::string>>& parts)
{
    std::vector<std::string> lines;
    for (const auto& part : parts)
        lines.insert(lines.end(), part.begin(), part.end());
    return lines;
}

TEST_F(SensorProviderTraceTest, ofEnumeratedNames)
{
    const std::string handler = "Sensor_EnumInstanceNames";
    EXPECT_THAT(traceOf(OneFan, {}, enumerateNames),
        ElementsAreArray(sequence({entry(handler, 74), BuiltFactory, Counted,
            operation("getAllSensorCMPIObjPaths"), exit(handler, 114)})));
}

TEST_F(SensorProviderTraceTest, ofEnumeratedNamesWithoutSensors)
{
    const std::string handler = "Sensor_EnumInstanceNames";
    EXPECT_THAT(traceOf({}, {}, enumerateNames),
        ElementsAreArray(sequence(
            {entry(handler, 74), EmptyFactory, Counted, operation("getAllSensorCMPIObjPaths"),
                failure(handler, 94, "getAllSensorCMPIObjPaths failed"), exit(handler, 96)})));
}

TEST_F(SensorProviderTraceTest, ofEnumeratedInstances)
{
    const std::string handler = "Sensor_EnumInstances";
    EXPECT_THAT(traceOf(OneFan, {}, enumerate),
        ElementsAreArray(sequence({entry(handler, 136), BuiltFactory, Counted,
            around(operation("getAllSensorCMPIInstances"), OneInstance), exit(handler, 170)})));
}

TEST_F(SensorProviderTraceTest, ofAnInstanceFound)
{
    const std::string handler = "Sensor_GetInstance";
    EXPECT_THAT(traceOf(OneFan, {{"DeviceID", "Fan:/f"}}, get),
        ElementsAreArray(sequence({entry(handler, 192), BuiltFactory, Counted,
            around(operation("getOneSensorCMPIInstance"), OneInstance), exit(handler, 293)})));
}

TEST_F(SensorProviderTraceTest, ofAnInstanceNotFound)
{
    const std::string handler = "Sensor_GetInstance";
    EXPECT_THAT(traceOf(OneFan, {{"DeviceID", "other"}}, get),
        ElementsAreArray(sequence({entry(handler, 192), BuiltFactory, Counted,
            {operation("getOneSensorCMPIInstance").front()},
            failure(handler, 220, "getOneSensorCMPIInstance failed"), exit(handler, 222)})));
}

TEST_F(SensorProviderTraceTest, ofAnInstanceSearchedByItsPath)
{
    const std::string handler = "Sensor_GetInstance";
    EXPECT_THAT(traceOf(OneFan, {{"Other", "x"}}, get),
        ElementsAreArray(sequence({entry(handler, 192), BuiltFactory, Counted,
            around(operation("getAllSensorCMPIInstances"), OneInstance), exit(handler, 293)})));
}

TEST_F(SensorProviderTraceTest, ofARequestWithoutKeysHasNoFactory)
{
    const std::string handler = "Sensor_GetInstance";
    EXPECT_THAT(traceOf(OneFan, {}, get),
        ElementsAreArray(sequence({entry(handler, 192), exit(handler, 293)})));
}

TEST_F(SensorProviderTraceTest, bracketLinesStandInTheTraceHeader)
{
    const ScriptedMachine machine;
    const CMPIObjectPath* const ref = path(Class).handle();
    const LogCapture capture;
    get(mi_, context(), result(), ref);
    std::vector<std::string> places;
    for (const LogLine& line : capture.log())
        places.push_back(line.file + ":" + std::to_string(line.line));
    EXPECT_THAT(places, ElementsAre("Trace:336", "Trace:337", "Trace:348", "Trace:349"));
}

TEST_F(SensorProviderTraceTest, failuresStandInTheHandlersModule)
{
    const ScriptedMachine machine;
    const CMPIObjectPath* const ref = path(Class).handle();
    const LogCapture capture(6000);
    enumerateNames(mi_, context(), result(), ref);
    EXPECT_THAT(Testing::withoutPointers(capture.log()),
        ElementsAre("Sensor_EnumInstanceNames(SensorProvider:94) 6000 MESSAGE [File: "
                    "SensorProvider, Line: 94]: getAllSensorCMPIObjPaths failed"));
}

} // namespace
