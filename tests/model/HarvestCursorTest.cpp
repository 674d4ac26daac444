// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The cursors of a harvest, and its use of a node's path.

#include "model/SensorHarvest.h"

#include "tests/support/LogCapture.h"
#include "tests/support/ScriptedMachine.h"
#include "tests/support/WatchedMachine.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

namespace {

using namespace Vorn::SensorProfileProvider;
using ::testing::ElementsAre;
using Testing::LogCapture;
using Testing::LogLine;
using Testing::StrangeException;
using Testing::WatchedMachine;

TEST(HarvestCursorTest, IsMadeForEachTypeAndGoneBeforeTheNext)
{
    const WatchedMachine machine([] {});
    std::vector<Sensor> sensors;
    EXPECT_FALSE(getSensorInstances(sensors));
    EXPECT_EQ(sensors.size(), 3U);
    EXPECT_EQ(machine.cursorsMade(), 3U);
    EXPECT_EQ(machine.mostCursorsAtOnce(), 1U);
    EXPECT_EQ(machine.cursorsLeft(), 0U);
}

TEST(HarvestCursorTest, IsGoneBeforeTheNextAlsoWhenItsWalkFailed)
{
    const WatchedMachine machine([] { throw std::runtime_error("no reading"); });
    std::vector<Sensor> sensors;
    ::testing::internal::CaptureStderr();
    EXPECT_TRUE(getSensorInstances(sensors));
    ::testing::internal::GetCapturedStderr();
    EXPECT_EQ(machine.cursorsMade(), 3U);
    EXPECT_EQ(machine.mostCursorsAtOnce(), 1U);
    EXPECT_EQ(machine.cursorsLeft(), 0U);
}

TEST(HarvestFailureTest, OfAKindThatIsNoStandardExceptionIsTheCallers)
{
    const WatchedMachine machine([] { throw StrangeException(); });
    const LogCapture capture;
    std::vector<Sensor> sensors;
    ::testing::internal::CaptureStderr();
    EXPECT_THROW(getSensorInstances(sensors), StrangeException);
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "");
    EXPECT_TRUE(sensors.empty());
    EXPECT_EQ(machine.cursorsMade(), 1U);
    EXPECT_EQ(machine.cursorsLeft(), 0U);
    std::vector<unsigned> marks;
    for (const LogLine& line : capture.log())
        marks.push_back(line.line);
    EXPECT_THAT(marks, ElementsAre(668, 740)); // entering marks only
}

TEST(HarvestTest, NamesASensorByThePrintableFormOfItsPath)
{
    const Testing::ScriptedMachine machine(
        {{Vorn::NodeLexicon::NodeType::Temperature, "/a\n\xFF", "CPU", Vorn::NodeReading{}}});
    std::vector<Sensor> sensors;
    EXPECT_FALSE(getSensorInstances(sensors));
    ASSERT_EQ(sensors.size(), 1U);
    EXPECT_EQ(sensors[0].getDeviceID(), "CPU:/a\\n\xEF\xBF\xBD");
}

} // namespace
