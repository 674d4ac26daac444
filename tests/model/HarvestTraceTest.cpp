// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace lines of a harvest.

#include "model/SensorHarvest.h"

#include "tests/support/LogCapture.h"
#include "tests/support/ScriptedMachine.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>

namespace {

using namespace Vorn::SensorProfileProvider;
using ::testing::ElementsAre;
using Testing::LogCapture;
using Testing::LogLine;
using Testing::ScriptedMachine;
using Vorn::NodeLexicon::NodeType;

std::string address(const void* pointer)
{
    return (std::ostringstream() << pointer).str();
}

LogLine mark(const std::string& kind, const std::string& function, unsigned line,
    const std::string& parameters)
{
    return {"log", 3000, "Nimbrel.Sensor", function, "Sensor", line,
        kind + ": " + function + "() in Sensor [Line: " + std::to_string(line) +
            "],Parameters List: " + parameters};
}

TEST(HarvestTraceTest, AHarvestIsMarkedAndSoIsEveryWalkInIt)
{
    const ScriptedMachine machine(
        {{NodeType::Temperature, "/t1", "t1"}, {NodeType::Tachometer, "/f1", "f1"}});
    const LogCapture capture;
    std::vector<Sensor> sensors;
    getSensorInstances(sensors);
    const auto lines = capture.log();
    ASSERT_EQ(lines.size(), 6U);
    const std::string vector = " vectSensor=" + address(&sensors);
    EXPECT_EQ(lines[0], mark("ENTERING", "getSensorInstances", 668, vector));
    const auto cursor = lines[1].text.substr(lines[1].text.find(" instrumentation="));
    EXPECT_THAT(cursor, ::testing::MatchesRegex(" instrumentation=0x[0-9a-f]+"));
    EXPECT_EQ(lines[1], mark("ENTERING", "setVector", 740, vector + cursor));
    EXPECT_EQ(lines[2], mark("EXITING", "setVector", 920, vector + cursor));
    EXPECT_EQ(lines[3].function, "setVector");
    EXPECT_EQ(lines[4].line, 920U);
    EXPECT_EQ(lines[5], mark("EXITING", "getSensorInstances", 732, vector));
}

TEST(HarvestTraceTest, ARefusalLeavesTheWalkWithoutItsExitMark)
{
    const ScriptedMachine machine({{NodeType::Temperature, "/a", ""}});
    const LogCapture capture;
    std::vector<Sensor> sensors;
    ::testing::internal::CaptureStderr();
    getSensorInstances(sensors);
    ::testing::internal::GetCapturedStderr();
    std::vector<unsigned> marked;
    for (const LogLine& line : capture.log())
        if (line.component == "Nimbrel.Sensor")
            marked.push_back(line.line);
    EXPECT_THAT(marked, ElementsAre(668, 740, 732));
}

TEST(HarvestTraceTest, TheCapabilitiesHarvestIsMarked)
{
    const LogCapture capture;
    std::vector<SensorEnabledLogCap> capabilities;
    getSensorEnabledLogCapInstances(capabilities);
    const std::string vector = " vectSensorEnabledLogCap=" + address(&capabilities);
    EXPECT_THAT(
        capture.log(), ElementsAre(mark("ENTERING", "getSensorEnabledLogCapInstances", 639, vector),
                           mark("EXITING", "getSensorEnabledLogCapInstances", 660, vector)));
}

} // namespace
