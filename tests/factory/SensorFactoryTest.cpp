// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The factory's constructor, counts and trace lines.

#include "factory/SensorFactory.h"

#include "tests/support/LogCapture.h"
#include "tests/support/ProviderTest.h"
#include "tests/support/WatchedMachine.h"

#include <gmock/gmock.h>

namespace SensorFactoryTests {

using namespace Vorn::SensorProfileProvider;
using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

const std::vector<ScriptedNode> twoSensors = {{NodeType::Temperature, "/t", "t", NodeReading{}},
    {NodeType::Tachometer, "/f", "f", NodeReading{}}};

std::vector<std::string> factoryLines(const LogCapture& capture)
{
    std::vector<std::string> found;
    for (const LogLine& line : capture.log())
        if (line.component == "Nimbrel.SensorFactory")
            found.push_back(std::to_string(line.level) + " " + line.file + " " +
                            line.text.substr(0, line.text.find(" [Line:")) +
                            (line.text.find(",Parameters") == std::string::npos
                                    ? ""
                                    : line.text.substr(line.text.find(",Parameters"))));
    return found;
}

TEST(SensorFactoryTest, WithoutFlagsHarvestsNothing)
{
    const ScriptedMachine machine(twoSensors);
    EXPECT_EQ(SensorFactory().getNumberOfInstances(), 0);
    EXPECT_EQ(SensorFactory(false, false).getNumberOfInstances(), 0);
}

TEST(SensorFactoryTest, CountsSensorsAndNotCapabilities)
{
    const ScriptedMachine machine(twoSensors);
    EXPECT_EQ(SensorFactory(true, false).getNumberOfInstances(), 2);
    EXPECT_EQ(SensorFactory(true, true).getNumberOfInstances(), 2);
    EXPECT_EQ(SensorFactory(false, true).getNumberOfInstances(), 0);
}

TEST(SensorFactoryTest, CountsSensorsOfOneIdentifierOnce)
{
    const ScriptedMachine machine({{NodeType::Temperature, "/same", "t", NodeReading{}},
        {NodeType::Voltage, "/same", "t", NodeReading{}}});
    EXPECT_EQ(SensorFactory(true, false).getNumberOfInstances(), 1);
}

TEST(SensorFactoryTest, OfAFailedHarvestHasNoSensorsThoughRecordsWereAppended)
{
    ScriptedNode broken = {NodeType::Temperature, "/b", "b", NodeReading{}};
    broken.failsWhenRead = true;
    const ScriptedMachine machine({{NodeType::Temperature, "/t", "t", NodeReading{}}, broken});
    ::testing::internal::CaptureStderr();
    SensorFactory factory(true, false);
    ::testing::internal::GetCapturedStderr();
    EXPECT_EQ(factory.getNumberOfInstances(), 0);
}

TEST(SensorFactoryTest, CutsItsCountTo16Bits)
{
    std::vector<ScriptedNode> nodes(65537, {NodeType::Temperature, "", "sensor", NodeReading{}});
    for (std::size_t i = 0; i < nodes.size(); ++i)
        nodes[i].path = "/" + std::to_string(i);
    const ScriptedMachine machine(nodes);
    EXPECT_EQ(SensorFactory(true, false).getNumberOfInstances(), 1);
}

TEST(SensorFactoryTraceTest, TheDefaultConstructorAndTheDestructorWriteNothing)
{
    const LogCapture capture;
    {
        SensorFactory factory;
    }
    EXPECT_TRUE(capture.log().empty());
}

TEST(SensorFactoryTraceTest, TheRequestConstructorTracesItsFlagsAndItsMaps)
{
    const ScriptedMachine machine(twoSensors);
    const LogCapture capture;
    SensorFactory factory(true, true);
    EXPECT_THAT(factoryLines(capture),
        ElementsAre("3000 SensorFactory ENTERING: SensorFactory() in SensorFactory,Parameters "
                    "List:  isSen=1 isCap=1",
            "4000 SensorFactory ENTERING: _createSensorMap() in SensorFactory",
            "4000 SensorFactory EXITING: _createSensorMap() in SensorFactory",
            "4000 SensorFactory ENTERING: _createEnabledLogicalElementCapMap() in SensorFactory",
            "4000 SensorFactory EXITING: _createEnabledLogicalElementCapMap() in SensorFactory",
            "3000 SensorFactory EXITING: SensorFactory() in SensorFactory,Parameters List:  "
            "isSen=1 isCap=1"));
}

TEST(
    SensorFactoryTraceTest, AnExceptionThatIsNoStandardOneLeavesTheConstructorWithoutItsExitingLine)
{
    const Testing::WatchedMachine machine([] { throw Testing::StrangeException(); });
    const LogCapture capture;
    EXPECT_THROW(SensorFactory(true, true), Testing::StrangeException);
    EXPECT_EQ(machine.cursorsLeft(), 0U);
    EXPECT_THAT(factoryLines(capture),
        ElementsAre("3000 SensorFactory ENTERING: SensorFactory() in SensorFactory,Parameters "
                    "List:  isSen=1 isCap=1"));
}

TEST(SensorFactoryTraceTest, AFailedHarvestBuildsNoMap)
{
    const ScriptedMachine machine;
    const LogCapture capture;
    SensorFactory factory(true, false);
    EXPECT_THAT(factoryLines(capture),
        ElementsAre("3000 SensorFactory ENTERING: SensorFactory() in SensorFactory,Parameters "
                    "List:  isSen=1 isCap=0",
            "3000 SensorFactory EXITING: SensorFactory() in SensorFactory,Parameters List:  "
            "isSen=1 isCap=0"));
}

TEST(SensorFactoryTraceTest, CountingIsMarkedWithoutParameters)
{
    SensorFactory factory;
    const LogCapture capture;
    factory.getNumberOfInstances();
    EXPECT_THAT(factoryLines(capture),
        ElementsAre("4000 SensorFactory ENTERING: getNumberOfInstances() in SensorFactory",
            "4000 SensorFactory EXITING: getNumberOfInstances() in SensorFactory"));
}

TEST(SensorFactoryTraceTest, SensorsAreHarvestedBeforeCapabilities)
{
    const ScriptedMachine machine(twoSensors);
    const LogCapture capture;
    SensorFactory factory(true, true);
    std::vector<std::string> functions;
    for (const LogLine& line : capture.log())
        if (line.component == "Nimbrel.Sensor" && line.text.starts_with("ENTERING"))
            functions.push_back(line.function);
    EXPECT_THAT(functions, ElementsAre("getSensorInstances", "setVector", "setVector",
                               "getSensorEnabledLogCapInstances"));
}

} // namespace SensorFactoryTests
