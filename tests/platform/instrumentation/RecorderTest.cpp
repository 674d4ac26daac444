// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Recorder.h"

#include "platform/instrumentation/machinefile/MachineFileReader.h"
#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/ScriptedMachine.h"

#include <gmock/gmock.h>

#include <limits>

namespace RecorderTests {

using Testing::ScriptedMachine;
using testing::SizeIs;
using Vorn::recordMachineFile;
using Vorn::NodeLexicon::NodeType;

TEST(RecorderTest, WalksTemperaturesThenVoltagesThenTachometers)
{
    const ScriptedMachine machine({{NodeType::Tachometer, "/f", "", {}},
        {NodeType::Voltage, "/v", "", {}}, {NodeType::Temperature, "/t", "", {}}});
    const auto nodes = Vorn::readMachineFile(recordMachineFile()).nodes;
    ASSERT_THAT(nodes, SizeIs(3));
    EXPECT_EQ(nodes[0].path, "/t");
    EXPECT_EQ(nodes[1].path, "/v");
    EXPECT_EQ(nodes[2].path, "/f");
}

TEST(RecorderTest, LeavesOutNumbersThatAreNotFinite)
{
    const ScriptedMachine machine({{NodeType::Voltage, "/v", "",
        {.reading = std::numeric_limits<double>::quiet_NaN(),
            .lowerCritical = 1.5,
            .upperCritical = std::numeric_limits<double>::infinity()}}});
    const auto nodes = Vorn::readMachineFile(recordMachineFile()).nodes;
    EXPECT_FALSE(nodes.at(0).values.reading);
    EXPECT_FALSE(nodes.at(0).values.upperCritical);
    EXPECT_EQ(nodes.at(0).values.lowerCritical, 1.5);
}

TEST(RecorderTest, MakesPathsUnique)
{
    const ScriptedMachine machine({{NodeType::Voltage, "/v", "1", {}},
        {NodeType::Voltage, "/v", "2", {}}, {NodeType::Tachometer, "/v", "3", {}}});
    const auto nodes = Vorn::readMachineFile(recordMachineFile()).nodes;
    ASSERT_THAT(nodes, SizeIs(3));
    EXPECT_EQ(nodes[0].path, "/v");
    EXPECT_EQ(nodes[1].path, "/v#2");
    EXPECT_EQ(nodes[2].path, "/v#3");
}

TEST(RecorderTest, MakesTextsValid)
{
    const ScriptedMachine machine({{NodeType::Voltage, "/\xFF", "a\xFE", {}}});
    const auto nodes = Vorn::readMachineFile(recordMachineFile()).nodes;
    EXPECT_EQ(nodes.at(0).path, "/\xEF\xBF\xBD");
    EXPECT_EQ(nodes.at(0).description, "a\xEF\xBF\xBD");
}

TEST(RecorderTest, PassesOnTheErrorOfASource)
{
    ScriptedMachine machine;
    machine.failConstruction();
    EXPECT_EQ(Testing::errorOf([] { recordMachineFile(); }), "scripted: construction");
}

} // namespace RecorderTests
