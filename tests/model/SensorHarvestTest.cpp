// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/SensorHarvest.h"

#include "diagnostics/ProviderException.h"
#include "platform/instrumentation/Instrumentation.h"
#include "tests/support/ScriptedMachine.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <unistd.h>

namespace {

using namespace Vorn::SensorProfileProvider;
using ::testing::ElementsAre;
using Testing::ScriptedMachine;
using Testing::ScriptedNode;
using Vorn::Instrumentation;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

constexpr NodeType temperature = NodeType::Temperature;
constexpr NodeType voltage = NodeType::Voltage;
constexpr NodeType tachometer = NodeType::Tachometer;

ScriptedNode node(NodeType type, const std::string& name)
{
    return {type, "/" + name, name, NodeReading{}};
}

std::vector<std::string> names(const std::vector<Sensor>& sensors)
{
    std::vector<std::string> found;
    for (const Sensor& sensor : sensors)
        found.push_back(sensor.getElementName());
    return found;
}

struct Harvest {
    std::vector<Sensor> sensors;
    bool nothing;
    std::string standardError;
};

Harvest harvest()
{
    Harvest result;
    ::testing::internal::CaptureStderr();
    result.nothing = getSensorInstances(result.sensors);
    result.standardError = ::testing::internal::GetCapturedStderr();
    return result;
}

TEST(HarvestTest, OfAMachineWithoutSensorsReportsThatNothingWasFound)
{
    const ScriptedMachine machine;
    const Harvest result = harvest();
    EXPECT_TRUE(result.nothing);
    EXPECT_TRUE(result.sensors.empty());
    EXPECT_EQ(result.standardError, "");
}

TEST(HarvestTest, ThatFailsOutlivesAStandardErrorThatNobodyReads)
{
    ScriptedMachine machine;
    machine.failConstruction();
    int ends[2];
    ASSERT_EQ(pipe(ends), 0);
    close(ends[0]);
    const int standardError = dup(STDERR_FILENO);
    dup2(ends[1], STDERR_FILENO);
    std::vector<Sensor> sensors;
    const bool nothing = getSensorInstances(sensors); // SIGPIPE would terminate the program here
    dup2(standardError, STDERR_FILENO);
    close(standardError);
    close(ends[1]);
    EXPECT_TRUE(nothing);
}

TEST(NodeLexiconTest, NumbersAreThoseOfTheHardwareModel)
{
    using Vorn::NodeLexicon::Properties;
    EXPECT_THAT((std::vector{tachometer, voltage, temperature}),
        ElementsAre(NodeType{20}, NodeType{21}, NodeType{22}));
    EXPECT_THAT(
        (std::vector{Properties::Reading, Properties::UpperCritical, Properties::UpperNonCritical,
            Properties::LowerCritical, Properties::LowerNonCritical, Properties::BaseUnits,
            Properties::UpperFatal, Properties::LowerFatal, Properties::PossibleStates}),
        ElementsAre(Properties{14}, Properties{22}, Properties{23}, Properties{32}, Properties{33},
            Properties{62}, Properties{88}, Properties{103}, Properties{125}));
}

TEST(HarvestTest, GoesThroughTemperaturesThenVoltagesThenTachometers)
{
    const ScriptedMachine machine({node(tachometer, "fan1"), node(voltage, "in1"),
        node(temperature, "temp1"), node(tachometer, "fan2"), node(temperature, "temp2")});
    const Harvest result = harvest();
    EXPECT_FALSE(result.nothing);
    EXPECT_THAT(names(result.sensors), ElementsAre("temp1", "temp2", "in1", "fan1", "fan2"));
}

TEST(HarvestTest, OfFansAloneSucceeds)
{
    const ScriptedMachine machine({node(tachometer, "fan1")});
    const Harvest result = harvest();
    EXPECT_FALSE(result.nothing);
    EXPECT_EQ(result.sensors.size(), 1U);
}

TEST(HarvestTest, AppendsToWhatIsThere)
{
    const ScriptedMachine machine({node(tachometer, "fan1")});
    std::vector<Sensor> sensors(2);
    EXPECT_FALSE(getSensorInstances(sensors));
    EXPECT_THAT(names(sensors), ElementsAre("", "", "fan1"));
}

TEST(HarvestTest, NamesASensorByItsDescriptionAndPath)
{
    const ScriptedMachine machine({{temperature, "/a/b", "CPU 1 Temp", NodeReading{}},
        {temperature, "/a/c", "CPU 1 Temp", NodeReading{}}});
    Harvest result = harvest();
    ASSERT_EQ(result.sensors.size(), 2U);
    EXPECT_EQ(result.sensors[0].getDeviceID(), "CPU 1 Temp:/a/b");
    EXPECT_EQ(result.sensors[1].getDeviceID(), "CPU 1 Temp:/a/c");
    EXPECT_EQ(result.sensors[0].getElementName(), "CPU 1 Temp");
}

TEST(HarvestTest, TakesTheTypeThatTheNodeReports)
{
    ScriptedNode odd = node(temperature, "odd");
    odd.sensorType = 21;
    ScriptedNode unknown = node(temperature, "unknown");
    unknown.sensorType = 99;
    const ScriptedMachine machine({odd, unknown});
    Harvest result = harvest();
    ASSERT_EQ(result.sensors.size(), 2U);
    EXPECT_EQ(result.sensors[0].getSensorType(), 3);
    EXPECT_EQ(result.sensors[1].getSensorType(), 0);
}

TEST(HarvestTest, FillsEveryFieldOfASensor)
{
    NodeReading reading;
    reading.status = 26;
    reading.reading = 1.5;
    reading.lowerNonCritical = 2;
    reading.upperNonCritical = 3;
    reading.lowerCritical = 4;
    reading.upperCritical = 5;
    reading.lowerFatal = 6;
    reading.upperFatal = 7;
    reading.baseUnits = 5;
    reading.possibleStates = {{1, 26}};
    const ScriptedMachine machine({{voltage, "/v", "Vcore", reading}});
    Harvest result = harvest();
    ASSERT_EQ(result.sensors.size(), 1U);
    Sensor& sensor = result.sensors[0];
    EXPECT_EQ(sensor.getSensorType(), 3);
    EXPECT_EQ(sensor.getCurrentState(), "CriticalHigh");
    EXPECT_EQ(sensor.getEnabledState(), 5);
    EXPECT_EQ(sensor.getOperationalStatus(), std::vector<std::uint16_t>{0});
    EXPECT_EQ(sensor.getHealthState(), 25);
    EXPECT_EQ(sensor.getHealthStatus(), "Error");
    EXPECT_EQ(sensor.getRequestedState(), 2);
    EXPECT_EQ(sensor.getPossibleStates().size(), 14U);
    EXPECT_EQ(sensor.getPossibleStates()[1], "CriticalHigh");
    EXPECT_EQ(sensor.getCurrentReading(), 1500);
    EXPECT_EQ(sensor.getLowerThresholdNonCritical(), 2000);
    EXPECT_EQ(sensor.getUpperThresholdNonCritical(), 3000);
    EXPECT_EQ(sensor.getLowerThresholdCritical(), 4000);
    EXPECT_EQ(sensor.getUpperThresholdCritical(), 5000);
    EXPECT_EQ(sensor.getLowerThresholdFatal(), 6000);
    EXPECT_EQ(sensor.getUpperThresholdFatal(), 7000);
    EXPECT_EQ(sensor.getBaseUnits(), 5);
}

TEST(HarvestTest, OfANodeWithoutStatusOrPropertiesLeavesTheDefaults)
{
    const ScriptedMachine machine({node(temperature, "bare")});
    Harvest result = harvest();
    ASSERT_EQ(result.sensors.size(), 1U);
    Sensor& sensor = result.sensors[0];
    EXPECT_EQ(sensor.getCurrentState(), "");
    EXPECT_EQ(sensor.getEnabledState(), 0);
    EXPECT_TRUE(sensor.getOperationalStatus().empty());
    EXPECT_EQ(sensor.getHealthState(), 0);
    EXPECT_EQ(sensor.getHealthStatus(), "");
    EXPECT_EQ(sensor.getRequestedState(), 2); // always requested enabled
    EXPECT_EQ(sensor.getPossibleStates().size(), 12U);
    EXPECT_EQ(sensor.getCurrentReading(), 0);
    EXPECT_EQ(sensor.getUpperThresholdFatal(), 0);
    EXPECT_EQ(sensor.getBaseUnits(), 0);
}

TEST(HarvestTest, DoesNotCarryValuesFromOneNodeToTheNext)
{
    NodeReading reading;
    reading.reading = 50;
    reading.upperCritical = 90;
    reading.possibleStates = {{1}};
    const ScriptedMachine machine(
        {{temperature, "/a", "a", reading}, {temperature, "/b", "b", NodeReading{}}});
    Harvest result = harvest();
    ASSERT_EQ(result.sensors.size(), 2U);
    EXPECT_EQ(result.sensors[1].getCurrentReading(), 0);
    EXPECT_EQ(result.sensors[1].getUpperThresholdCritical(), 0);
    EXPECT_EQ(result.sensors[1].getPossibleStates().size(), 12U);
}

// ---- Failures ----

// The text of the base class; the exception's own text is never printed.
const std::string generic = "std::exception\n";

TEST(HarvestFailureTest, AtConstructionIsReportedOncePerTypeWithTheGenericText)
{
    ScriptedMachine machine({node(temperature, "t")});
    machine.failConstruction();
    const Harvest result = harvest();
    EXPECT_TRUE(result.nothing);
    EXPECT_TRUE(result.sensors.empty());
    EXPECT_EQ(result.standardError, generic + generic + generic);
}

class HarvestFailureOfTypeTest : public ::testing::TestWithParam<NodeType> {
protected:
    std::vector<ScriptedNode> nodes() const
    {
        return {node(temperature, "t1"), node(temperature, "t2"), node(temperature, "t3"),
            node(voltage, "v1"), node(voltage, "v2"), node(voltage, "v3"), node(tachometer, "f1"),
            node(tachometer, "f2"), node(tachometer, "f3")};
    }

    // Returns the names that are harvested when the iteration of the type ends before the given
    // position.
    std::vector<std::string> namesWhenTypeEndsAt(std::size_t position) const
    {
        std::vector<std::string> left;
        std::map<NodeType, std::size_t> seen;
        for (const ScriptedNode& scripted : nodes())
            if (scripted.type != GetParam() || seen[scripted.type]++ < position)
                left.push_back(scripted.description);
        return left;
    }
};

TEST_P(HarvestFailureOfTypeTest, AtSelectionLeavesTheOtherTypes)
{
    ScriptedMachine machine(nodes());
    machine.failSelection(GetParam());
    const Harvest result = harvest();
    EXPECT_FALSE(result.nothing);
    EXPECT_EQ(names(result.sensors), namesWhenTypeEndsAt(0));
    EXPECT_EQ(result.standardError, generic);
}

TEST_P(HarvestFailureOfTypeTest, AtAPropertyKeepsTheNodesBeforeIt)
{
    auto scripted = nodes();
    for (ScriptedNode& each : scripted)
        each.failsWhenRead = each.type == GetParam() && each.description.back() == '2';
    const ScriptedMachine machine(scripted);
    const Harvest result = harvest();
    EXPECT_FALSE(result.nothing);
    EXPECT_EQ(names(result.sensors), namesWhenTypeEndsAt(1));
    EXPECT_EQ(result.standardError, generic);
}

TEST_P(HarvestFailureOfTypeTest, ByARefusedNameKeepsTheNodesBeforeIt)
{
    auto scripted = nodes();
    for (ScriptedNode& each : scripted)
        if (each.type == GetParam() && each.description.back() == '3')
            each.description.clear();
    const ScriptedMachine machine(scripted);
    const Harvest result = harvest();
    EXPECT_FALSE(result.nothing);
    EXPECT_EQ(names(result.sensors), namesWhenTypeEndsAt(2));
    EXPECT_EQ(result.standardError, generic);
}

TEST_P(HarvestFailureOfTypeTest, AloneIsAHarvestOfNothing)
{
    ScriptedNode broken = node(GetParam(), "broken");
    broken.failsWhenRead = true;
    const ScriptedMachine machine({broken});
    const Harvest result = harvest();
    EXPECT_TRUE(result.nothing);
    EXPECT_TRUE(result.sensors.empty());
}

INSTANTIATE_TEST_SUITE_P(EveryType, HarvestFailureOfTypeTest,
    ::testing::Values(temperature, voltage, tachometer),
    [](const auto& test) { return std::to_string(static_cast<unsigned>(test.param)); });

TEST(HarvestFailureTest, KeepsRecordsThoughNoTypeSucceeds)
{
    ScriptedNode broken = node(temperature, "broken");
    broken.failsWhenRead = true;
    const ScriptedMachine machine({node(temperature, "t1"), broken});
    const Harvest result = harvest();
    EXPECT_TRUE(result.nothing);
    EXPECT_THAT(names(result.sensors), ElementsAre("t1"));
}

TEST(SetVectorTest, ThrowsTheRefusalAndStaysOnTheNode)
{
    const ScriptedMachine machine({{temperature, "/a", "", NodeReading{}}});
    Instrumentation instrumentation;
    instrumentation.selectNode(temperature);
    std::vector<Sensor> sensors;
    try {
        setVector(sensors, instrumentation);
        FAIL() << "an empty name was accepted";
    } catch (const Vorn::ProviderException& refusal) {
        EXPECT_STREQ(refusal.what(), "Failed while setting Element Name");
    }
    EXPECT_TRUE(sensors.empty());
    ASSERT_TRUE(instrumentation);
    EXPECT_EQ(instrumentation.getPathToNode(), "/a");
}

TEST(SetVectorTest, BeginsAtTheNodeUnderTheCursor)
{
    const ScriptedMachine machine({node(temperature, "t1"), node(temperature, "t2")});
    Instrumentation instrumentation;
    instrumentation.selectNode(temperature);
    ++instrumentation;
    std::vector<Sensor> sensors;
    EXPECT_FALSE(setVector(sensors, instrumentation));
    EXPECT_THAT(names(sensors), ElementsAre("t2"));
    EXPECT_FALSE(instrumentation);
}

TEST(CapabilitiesHarvestTest, AppendsOneRecord)
{
    std::vector<SensorEnabledLogCap> capabilities;
    EXPECT_FALSE(getSensorEnabledLogCapInstances(capabilities));
    EXPECT_EQ(capabilities.size(), 1U);
    EXPECT_FALSE(getSensorEnabledLogCapInstances(capabilities));
    EXPECT_EQ(capabilities.size(), 2U);
}

} // namespace
