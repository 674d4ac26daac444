// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The harvest of a record that refuses a value, for each value, and the order in which the harvest
// sets them.

#include "diagnostics/ProviderException.h"
#include "model/SensorHarvest.h"
#include "platform/instrumentation/Instrumentation.h"
#include "tests/model/RefusingSensor.h"
#include "tests/support/ScriptedMachine.h"

#include <gtest/gtest.h>

namespace {

using namespace Vorn::SensorProfileProvider;
using Testing::ScriptedMachine;
using Testing::ScriptedNode;
using Vorn::NodeLexicon::NodeType;

struct Refusal {
    std::string setter;
    std::string message;
};

// The setters in the order of the harvest.
const std::vector<Refusal> refusals = {
    {"setDeviceID", "Failed while setting Device ID"},
    {"setElementName", "Failed while setting Element Name"},
    {"setSensorType", "Failed while setting Sensor Type"},
    {"setCurrentState", "Failed while setting Current State"},
    {"setEnabledState", "Failed while setting Enabled State"},
    {"setOperationalStatus", "Failed while setting Operational Status"},
    {"setHealthState", "Failed while setting Health State"},
    {"setRequestedState", "Failed while setting Requested State"},
    {"setPossibleStates", "Failed while setting Possible States"},
    {"setCurrentReading", "Failed while setting Current Reading"},
    {"setLowerThresholdNonCritical", "Failed while setting LowerThresholdNonCritical"},
    {"setUpperThresholdNonCritical", "Failed while setting UpperThresholdNonCritical"},
    {"setLowerThresholdCritical", "Failed while setting LowerThresholdCritical"},
    {"setUpperThresholdCritical", "Failed while setting UpperThresholdCritical"},
    {"setLowerThresholdFatal", "Failed while setting LowerThresholdFatal"},
    {"setUpperThresholdFatal", "Failed while setting UpperThresholdFatal"},
    {"setBaseUnits", "Failed while setting Requested State"}, // deliberately names another field
};

ScriptedNode fullNode(NodeType type, const std::string& name)
{
    Vorn::NodeReading reading;
    reading.status = 1;
    reading.reading = reading.lowerNonCritical = reading.upperNonCritical = 1.0;
    reading.lowerCritical = reading.upperCritical = 1.0;
    reading.lowerFatal = reading.upperFatal = 1.0;
    reading.baseUnits = 2;
    reading.possibleStates = {{1}};
    return {type, "/" + name, name, reading};
}

class RefusalTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        Testing::refusedSetter.clear();
        Testing::setterCalls.clear();
    }
};

TEST_F(RefusalTest, ValuesAreHandedOverInOrder)
{
    const ScriptedMachine machine({fullNode(NodeType::Voltage, "v")});
    std::vector<Sensor> sensors;
    EXPECT_FALSE(getSensorInstances(sensors));
    std::vector<std::string> expected;
    for (const Refusal& refusal : refusals)
        expected.push_back(refusal.setter);
    EXPECT_EQ(Testing::setterCalls, expected);
}

TEST_F(RefusalTest, AStatusOfZeroCallsNoneOfTheFourStatusSetters)
{
    ScriptedNode node = fullNode(NodeType::Voltage, "v");
    node.reading = {};
    const ScriptedMachine machine({node});
    std::vector<Sensor> sensors;
    EXPECT_FALSE(getSensorInstances(sensors));
    EXPECT_EQ(Testing::setterCalls, (std::vector<std::string>{"setDeviceID", "setElementName",
                                        "setSensorType", "setRequestedState"}));
}

TEST_F(RefusalTest, EachRefusedValueThrowsItsMessage)
{
    for (const Refusal& refusal : refusals) {
        const ScriptedMachine machine({fullNode(NodeType::Temperature, "t")});
        Testing::refusedSetter = refusal.setter;
        Vorn::Instrumentation instrumentation;
        instrumentation.selectNode(NodeType::Temperature);
        std::vector<Sensor> sensors;
        std::string message = "nothing was thrown";
        try {
            setVector(sensors, instrumentation);
        } catch (const Vorn::ProviderException& exception) {
            message = exception.what();
        }
        EXPECT_EQ(message, refusal.message) << refusal.setter;
        EXPECT_TRUE(sensors.empty()) << refusal.setter;
        EXPECT_TRUE(instrumentation) << refusal.setter;
    }
}

TEST_F(RefusalTest, ARefusedValueEndsTheWalkOfItsTypeWithTheGenericText)
{
    for (const Refusal& refusal : refusals) {
        const ScriptedMachine machine(
            {fullNode(NodeType::Temperature, "t"), fullNode(NodeType::Voltage, "v")});
        Testing::refusedSetter = refusal.setter;
        std::vector<Sensor> sensors;
        ::testing::internal::CaptureStderr();
        EXPECT_TRUE(getSensorInstances(sensors)) << refusal.setter;
        EXPECT_EQ(::testing::internal::GetCapturedStderr(), "std::exception\nstd::exception\n")
            << refusal.setter;
        EXPECT_TRUE(sensors.empty()) << refusal.setter;
    }
}

} // namespace
