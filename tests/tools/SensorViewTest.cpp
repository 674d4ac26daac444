// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/SensorView.h"

#include "tests/tools/InstanceTest.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <optional>

namespace {

using Tools::Health;
using Tools::SensorView;

class SensorViewTest : public Testing::InstanceTest {
protected:
    SensorView view() const { return SensorView(instance_); }
};

TEST_F(SensorViewTest, InstanceWithoutPropertiesSaysNothing)
{
    EXPECT_EQ(view().name(), "");
    EXPECT_EQ(view().reading(), std::nullopt);
    EXPECT_EQ(view().unit(), "");
    EXPECT_EQ(view().state(), "");
    EXPECT_EQ(view().health(), Health::unknown);
    EXPECT_EQ(view().limit("UpperThresholdFatal"), std::nullopt);
}

TEST_F(SensorViewTest, ReadingIsScaledToItsUnit)
{
    setNumber("CurrentReading", 12345);
    setNumber("UnitModifier", -3);
    setCode("BaseUnits", 5);
    EXPECT_EQ(view().reading(), "12.345");
    EXPECT_EQ(view().unit(), "V");
}

TEST_F(SensorViewTest, ZeroOfAWorkingSensorIsAReading)
{
    setNumber("CurrentReading", 0);
    setCode("EnabledState", 2);
    setCodes("OperationalStatus", {2});
    EXPECT_EQ(view().reading(), "0");
}

TEST_F(SensorViewTest, LostCommunicationHasNoReading)
{
    setNumber("CurrentReading", 42);
    setCodes("OperationalStatus", {13});
    EXPECT_EQ(view().reading(), std::nullopt);
}

TEST_F(SensorViewTest, ZeroWithoutContactIsNoReading)
{
    setNumber("CurrentReading", 0);
    setCodes("OperationalStatus", {12});
    EXPECT_EQ(view().reading(), std::nullopt);
    setNumber("CurrentReading", 7);
    EXPECT_EQ(view().reading(), "7");
}

TEST_F(SensorViewTest, ZeroOfADisabledOrOfflineSensorIsNoReading)
{
    for (const std::uint64_t state : {3U, 6U}) {
        setCode("EnabledState", state);
        setNumber("CurrentReading", 0);
        EXPECT_EQ(view().reading(), std::nullopt) << state;
        setNumber("CurrentReading", 7);
        EXPECT_EQ(view().reading(), "7") << state;
    }
}

TEST_F(SensorViewTest, MarkForWhatDoesNotFitIsNoNumber)
{
    setNumber("CurrentReading", std::numeric_limits<std::int32_t>::min());
    setNumber("UpperThresholdFatal", std::numeric_limits<std::int32_t>::min());
    EXPECT_EQ(view().reading(), std::nullopt);
    EXPECT_EQ(view().limit("UpperThresholdFatal"), std::nullopt);
    EXPECT_EQ(view().roundedLimit("UpperThresholdFatal"), std::nullopt);
}

TEST_F(SensorViewTest, LimitsAreScaledWithoutSuperfluousDigits)
{
    setNumber("UnitModifier", -3);
    setNumber("UpperThresholdCritical", 13200);
    EXPECT_EQ(view().limit("UpperThresholdCritical"), "13.2");
    setNumber("UpperThresholdCritical", 13199);
    EXPECT_EQ(view().limit("UpperThresholdCritical"), "13.199");
    EXPECT_EQ(view().roundedLimit("UpperThresholdCritical"), "13.2");
}

TEST_F(SensorViewTest, StateIsTheLabelOfTheProvider)
{
    setText("CurrentState", "WarningLow");
    setCodes("OperationalStatus", {13});
    EXPECT_EQ(view().state(), "WarningLow");
}

TEST_F(SensorViewTest, UnknownStateGivesWayToTheOperationalStatus)
{
    setText("CurrentState", "Unknown");
    EXPECT_EQ(view().state(), "Unknown");
    for (const auto& [status, label] : {std::pair{5U, "Pred. Failure"}, {8U, "Starting"},
             {9U, "Stopping"}, {10U, "Stopped"}, {12U, "No Contact"}, {13U, "Lost Comm."},
             {15U, "Dormant"}, {0U, "Unknown"}, {2U, "Unknown"}}) {
        setCodes("OperationalStatus", {status});
        EXPECT_EQ(view().state(), label);
    }
}

TEST_F(SensorViewTest, HealthFollowsTheValueMap)
{
    for (const auto& [code, health] :
        {std::pair{0U, Health::unknown}, {5U, Health::ok}, {10U, Health::warning},
            {15U, Health::critical}, {25U, Health::critical}, {30U, Health::critical}}) {
        setCode("HealthState", code);
        EXPECT_EQ(view().health(), health) << code;
    }
}

TEST_F(SensorViewTest, PropertyOfAnUnexpectedTypeCountsAsAbsent)
{
    setText("CurrentReading", "12");
    setCode("CurrentState", 1);
    setCode("OperationalStatus", 13);
    EXPECT_EQ(view().reading(), std::nullopt);
    EXPECT_EQ(view().state(), "");
}

} // namespace
