// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The statuses that the hwmon source derives from alarms, faults and limits.

#include "tests/platform/instrumentation/HwmonMachine.h"

#include <gmock/gmock.h>

namespace HwmonStatusTests {

using Testing::Attributes;
using testing::ElementsAre;
using Testing::HwmonTest;
using Testing::nodeOf;

struct Row {
    std::string name;
    Attributes attributes;
    unsigned status;
};

class HwmonStatusTest : public HwmonTest, public testing::WithParamInterface<Row> {};

TEST_P(HwmonStatusTest, FollowsFromTheAttributes)
{
    EXPECT_EQ(nodeOf(GetParam().attributes).values.status, GetParam().status);
}

const Row rows[] = {
    {"normal", {{"temp1_input", "50000"}}, 1},
    {"temperatureFault", {{"temp1_input", "50000"}, {"temp1_fault", "1"}}, 13},
    {"fanFault", {{"fan1_input", "0"}, {"fan1_fault", "1"}}, 13},
    {"noFault", {{"temp1_input", "50000"}, {"temp1_fault", "0"}}, 1},
    {"unreadable", {{"temp1_input", "N/A"}, {"temp1_crit", "90000"}}, 13},
    {"notANumber", {{"temp1_input", "nan"}}, 13},
    {"noInputAtAll", {{"temp1_crit", "90000"}}, 13},
    {"disabled", {{"temp1_input", "50000"}, {"temp1_enable", "0"}}, 16},
    {"enabled", {{"temp1_input", "50000"}, {"temp1_enable", "1"}}, 1},
    {"disabledVoltage", {{"in3_input", "0"}, {"in3_enable", "0"}}, 16},
    {"disabledFan", {{"fan2_input", "0"}, {"fan2_enable", "0"}}, 16},
    {"unreadableBeforeDisabled", {{"temp1_input", "N/A"}, {"temp1_enable", "0"}}, 13},
    {"emergencyAlarm", {{"temp1_input", "50000"}, {"temp1_emergency_alarm", "1"}}, 26},
    {"critAlarm", {{"temp1_input", "50000"}, {"temp1_crit_alarm", "1"}}, 26},
    {"voltageCritAlarm", {{"in0_input", "1000"}, {"in0_crit_alarm", "1"}}, 26},
    {"atCrit", {{"temp1_input", "95000"}, {"temp1_crit", "95000"}}, 26},
    {"lcritAlarm", {{"temp1_input", "50000"}, {"temp1_lcrit_alarm", "1"}}, 25},
    {"voltageLcritAlarm", {{"in0_input", "1000"}, {"in0_lcrit_alarm", "1"}}, 25},
    {"atLcrit", {{"in0_input", "1000"}, {"in0_lcrit", "1000"}, {"in0_crit", "2000"}}, 25},
    {"maxAlarm", {{"temp1_input", "50000"}, {"temp1_max_alarm", "1"}}, 23},
    {"fanMaxAlarm", {{"fan1_input", "900"}, {"fan1_max_alarm", "1"}}, 23},
    {"atMax", {{"in0_input", "2000"}, {"in0_max", "2000"}}, 23},
    {"voltageMaxAlarm", {{"in0_input", "1000"}, {"in0_max_alarm", "1"}}, 23},
    {"minAlarm", {{"temp1_input", "50000"}, {"temp1_min_alarm", "1"}}, 22},
    {"voltageMinAlarm", {{"in0_input", "1000"}, {"in0_min_alarm", "1"}}, 22},
    {"fanMinAlarm", {{"fan1_input", "900"}, {"fan1_min_alarm", "1"}}, 22},
    {"atMin", {{"fan1_input", "600"}, {"fan1_min", "600"}}, 22},
    {"plainAlarm", {{"temp1_input", "50000"}, {"temp1_alarm", "1"}}, 21},
    {"plainAlarmOfVoltage", {{"in0_input", "1000"}, {"in0_alarm", "1"}}, 21},
    {"plainAlarmOfAFanBelowItsMinimum",
        {{"fan1_input", "500"}, {"fan1_min", "600"}, {"fan1_alarm", "1"}}, 22},
    {"plainAlarmOfAFanAboveItsMinimum",
        {{"fan1_input", "700"}, {"fan1_min", "600"}, {"fan1_alarm", "1"}}, 21},
    {"anAlarmThatCannotBeReadIsNotRaised", {{"temp1_input", "50000"}, {"temp1_crit_alarm", "N/A"}},
        1},
    {"limitsThatNobodySetAreNotReached",
        {{"in1_input", "1000"}, {"in1_min", "0"}, {"in1_max", "0"}, {"in1_lcrit", "0"},
            {"in1_crit", "0"}},
        1},
    {"aFanWhoseMinimumNobodySetMayStandStill", {{"fan1_input", "0"}, {"fan1_min", "0"}}, 1},
    {"aZeroBesideASetEndIsMeant", {{"in1_input", "0"}, {"in1_min", "0"}, {"in1_max", "85"}}, 22},
    {"pairsOfLimitsDoNotTouchEachOther",
        {{"in1_input", "1000"}, {"in1_min", "0"}, {"in1_max", "0"}, {"in1_crit", "2000"}}, 1},
    {"withinAllLimits",
        {{"temp1_input", "50000"}, {"temp1_min", "10000"}, {"temp1_max", "80000"},
            {"temp1_lcrit", "0"}, {"temp1_crit", "90000"}, {"temp1_emergency", "100000"}},
        1},
    {"alarmsNotRaised",
        {{"temp1_input", "50000"}, {"temp1_alarm", "0"}, {"temp1_min_alarm", "0"},
            {"temp1_max_alarm", "0"}, {"temp1_crit_alarm", "0"}},
        1},
    {"aboveCrit", {{"temp1_input", "95001"}, {"temp1_crit", "95000"}}, 26},
    {"aboveEmergencyWithoutCrit", {{"temp1_input", "120000"}, {"temp1_emergency", "100000"}}, 1},
    {"belowLcrit", {{"in0_input", "999"}, {"in0_lcrit", "1000"}, {"in0_crit", "2000"}}, 25},
    {"justBelowMax", {{"temp1_input", "79999"}, {"temp1_max", "80000"}}, 1},
    {"justAboveMin", {{"temp1_input", "10001"}, {"temp1_min", "10000"}}, 1},
    {"plainAlarmOfAFanAtItsMinimum",
        {{"fan1_input", "600"}, {"fan1_min", "600"}, {"fan1_alarm", "1"}}, 22},
    {"faultBeforeDisabled", {{"temp1_input", "50000"}, {"temp1_fault", "1"}, {"temp1_enable", "0"}},
        13},
    {"faultBeforeCritical",
        {{"temp1_input", "95000"}, {"temp1_fault", "1"}, {"temp1_crit", "90000"}}, 13},
    {"disabledBeforeCritical",
        {{"temp1_input", "95000"}, {"temp1_enable", "0"}, {"temp1_crit", "90000"}}, 16},
    {"criticalHighBeforeCriticalLow",
        {{"temp1_input", "50000"}, {"temp1_lcrit_alarm", "1"}, {"temp1_crit_alarm", "1"}}, 26},
    {"criticalLowBeforeWarningHigh",
        {{"temp1_input", "50000"}, {"temp1_max_alarm", "1"}, {"temp1_lcrit_alarm", "1"}}, 25},
    {"warningHighBeforeWarningLow",
        {{"temp1_input", "50000"}, {"temp1_min_alarm", "1"}, {"temp1_max_alarm", "1"}}, 23},
    {"warningLowBeforePlain",
        {{"temp1_input", "50000"}, {"temp1_alarm", "1"}, {"temp1_min_alarm", "1"}}, 22},
};

INSTANTIATE_TEST_SUITE_P(EveryRow, HwmonStatusTest, testing::ValuesIn(rows),
    [](const auto& row) { return row.param.name; });

TEST_F(HwmonTest, EveryLimitAlarmAndSwitchAddsItsPossibleState)
{
    const std::map<std::string, std::vector<unsigned>> states = {{"temp1_min", {1, 22}},
        {"temp1_max", {1, 23}}, {"temp1_lcrit", {1, 25}}, {"temp1_crit", {1, 26}},
        {"temp1_emergency", {1}}, {"temp1_alarm", {1, 21}}, {"temp1_min_alarm", {1, 22}},
        {"temp1_max_alarm", {1, 23}}, {"temp1_lcrit_alarm", {1, 25}}, {"temp1_crit_alarm", {1, 26}},
        {"temp1_emergency_alarm", {1, 26}}, {"temp1_enable", {1, 16}}};
    Attributes all{{"temp1_input", "50000"}};
    for (const auto& [attribute, expected] : states) {
        EXPECT_EQ(
            nodeOf({{"temp1_input", "50000"}, {attribute, "1"}}).values.possibleStates, expected)
            << attribute;
        all.emplace(attribute, "1");
    }
    EXPECT_THAT(*nodeOf(all).values.possibleStates, ElementsAre(1, 16, 21, 22, 23, 25, 26));
}

TEST_F(HwmonTest, LimitsThatNobodySetAreAbsent)
{
    const auto values = nodeOf(
        {{"in1_input", "1000"}, {"in1_min", "0"}, {"in1_max", "0"}, {"in1_lcrit", "0"},
            {"in1_crit",
                "0"}}).values;
    EXPECT_FALSE(values.lowerNonCritical || values.upperNonCritical);
    EXPECT_FALSE(values.lowerCritical || values.upperCritical);
    EXPECT_THAT(*values.possibleStates, ElementsAre(1));
}

TEST_F(HwmonTest, ALimitThatCannotBeReadIsAbsent)
{
    const auto values =
        nodeOf({{"temp1_input", "50000"}, {"temp1_max", "N/A"}, {"temp1_crit", "90000"}}).values;
    EXPECT_FALSE(values.upperNonCritical);
    EXPECT_EQ(values.upperCritical, 90.0);
}

TEST_F(HwmonTest, AZeroBesideALimitThatCannotBeReadIsMeant)
{
    const auto values =
        nodeOf({{"in1_input", "1000"}, {"in1_min", "0"}, {"in1_max", "N/A"}}).values;
    EXPECT_EQ(values.lowerNonCritical, 0.0);
    EXPECT_FALSE(values.upperNonCritical);
    EXPECT_THAT(*values.possibleStates, ElementsAre(1, 22));
    EXPECT_EQ(
        nodeOf({{"in1_input", "0"}, {"in1_min", "0"}, {"in1_max", "N/A"}}).values.status, 22U);
}

TEST_F(HwmonTest, AChannelWithAFaultShowsItsLimitsButNoReading)
{
    const auto values =
        nodeOf({{"temp1_input", "-128000"}, {"temp1_fault", "1"}, {"temp1_max", "80000"}}).values;
    EXPECT_FALSE(values.reading);
    EXPECT_EQ(values.upperNonCritical, 80.0);
}

} // namespace HwmonStatusTests
