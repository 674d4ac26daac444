// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace lines of whole requests.

#include "tests/providers/Factories.h"
#include "tests/providers/RequestTrace.h"

#include <gmock/gmock.h>

namespace SensorProviderTraceTests {

using ::testing::ElementsAre;
using ::testing::ElementsAreArray;
using namespace Testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

constexpr const char* Class = "ZUMLO_NumericSensor";

class SensorProviderTraceTest : public ProviderTest {
protected:
    SensorProviderTraceTest()
        : mi_(SensorProfileProvider_Create_InstanceMI(broker(), nullptr, nullptr))
    {
    }

    // Returns the lines that one request writes, without those of the harvest.
    Lines traceOf(const std::vector<ScriptedNode>& nodes,
        const std::vector<std::pair<std::string, std::string>>& keys,
        CMPIStatus (*request)(
            CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*))
    {
        const ScriptedMachine machine(nodes);
        const CMPIObjectPath* const ref = path(Class, keys).handle();
        return Testing::traceOf([&] { request(mi_, context(), result(), ref); });
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

const std::vector<ScriptedNode> oneFan = {{NodeType::Tachometer, "/f", "Fan", NodeReading{}}};

HandlerLines handlerOf(const std::string& request)
{
    return {"SensorProfileProvider", "SensorProvider", "Sensor_" + request};
}

const Lines builtFactoryLines = builtFactory({"_createSensorMap"});
const Lines emptyFactoryLines = builtFactory({});
const Lines pathLines = operation("getAllSensorCMPIObjPaths");
const Lines oneInstance = operation("makeSensorInstance", 269, 737);

TEST_F(SensorProviderTraceTest, OfEnumeratedNames)
{
    const HandlerLines lines = handlerOf("EnumInstanceNames");
    EXPECT_THAT(traceOf(oneFan, {}, enumerateNames),
        ElementsAreArray(
            sequence({lines.entry(74), builtFactoryLines, counted(), pathLines, lines.exit(114)})));
}

TEST_F(SensorProviderTraceTest, OfEnumeratedNamesWithoutSensors)
{
    const HandlerLines lines = handlerOf("EnumInstanceNames");
    EXPECT_THAT(traceOf({}, {}, enumerateNames),
        ElementsAreArray(sequence({lines.entry(74), emptyFactoryLines, counted(), pathLines,
            lines.failure("getAllSensorCMPIObjPaths failed", 94), lines.exit(96)})));
}

TEST_F(SensorProviderTraceTest, OfEnumeratedInstances)
{
    const HandlerLines lines = handlerOf("EnumInstances");
    EXPECT_THAT(traceOf(oneFan, {}, enumerate),
        ElementsAreArray(sequence({lines.entry(136), builtFactoryLines, counted(),
            around(operation("getAllSensorCMPIInstances"), oneInstance), lines.exit(170)})));
}

TEST_F(SensorProviderTraceTest, OfAnInstanceFound)
{
    const HandlerLines lines = handlerOf("GetInstance");
    EXPECT_THAT(traceOf(oneFan, {{"DeviceID", "Fan:/f"}}, get),
        ElementsAreArray(sequence({lines.entry(192), builtFactoryLines, counted(),
            around(operation("getOneSensorCMPIInstance"), oneInstance), lines.exit(293)})));
}

TEST_F(SensorProviderTraceTest, OfAnInstanceNotFound)
{
    const HandlerLines lines = handlerOf("GetInstance");
    EXPECT_THAT(traceOf(oneFan, {{"DeviceID", "other"}}, get),
        ElementsAreArray(sequence(
            {lines.entry(192), builtFactoryLines, counted(), brokenOff("getOneSensorCMPIInstance"),
                lines.failure("getOneSensorCMPIInstance failed", 220), lines.exit(222)})));
}

TEST_F(SensorProviderTraceTest, OfAnInstanceSearchedByItsPath)
{
    const HandlerLines lines = handlerOf("GetInstance");
    EXPECT_THAT(traceOf(oneFan, {{"Other", "x"}}, get),
        ElementsAreArray(sequence({lines.entry(192), builtFactoryLines, counted(),
            around(operation("getAllSensorCMPIInstances"), oneInstance), lines.exit(293)})));
}

TEST_F(SensorProviderTraceTest, OfARequestWithoutKeysHasNoFactory)
{
    const HandlerLines lines = handlerOf("GetInstance");
    EXPECT_THAT(
        traceOf(oneFan, {}, get), ElementsAreArray(sequence({lines.entry(192), lines.exit(293)})));
}

TEST_F(SensorProviderTraceTest, BracketLinesStandInTheTraceHeader)
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

TEST_F(SensorProviderTraceTest, FailuresStandInTheHandlersModule)
{
    const ScriptedMachine machine;
    const CMPIObjectPath* const ref = path(Class).handle();
    const LogCapture capture(6000);
    enumerateNames(mi_, context(), result(), ref);
    EXPECT_THAT(Testing::withoutPointers(capture.log()),
        ElementsAre("Sensor_EnumInstanceNames(SensorProvider:94) 6000 MESSAGE [File: "
                    "SensorProvider, Line: 94]: getAllSensorCMPIObjPaths failed"));
}

} // namespace SensorProviderTraceTests
