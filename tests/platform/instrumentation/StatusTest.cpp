// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/Status.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

namespace StatusTests {

using Vorn::Hwmon::Alarms;
using Vorn::Hwmon::Channel;
using Vorn::Hwmon::Limits;
using Vorn::Hwmon::possibleStatesOf;
using Vorn::Hwmon::statusOf;
using Vorn::Hwmon::withoutUnset;

constexpr Limits allLimits{.min = 10, .max = 80, .lcrit = 0, .crit = 90, .emergency = 100};

struct Row {
    std::string name;
    Channel channel;
    unsigned status;
};

class StatusTableTest : public testing::TestWithParam<Row> {};

TEST_P(StatusTableTest, GivesTheStatusOfTheRow)
{
    EXPECT_EQ(statusOf(GetParam().channel), GetParam().status);
}

const Row rows[] = {
    {"noLimits", {.reading = 50}, 1},
    {"withinAllLimits", {.reading = 50, .limits = allLimits}, 1},
    {"alarmsNotRaised",
        {.reading = 50,
            .limits = allLimits,
            .alarms = {.plain = false, .min = false, .max = false, .crit = false}},
        1},
    {"fault", {.hasFault = true, .reading = 50}, 13},
    {"unreadable", {.reading = std::nullopt}, 13},
    {"disabled", {.isEnabled = false, .reading = 50}, 16},
    {"enabled", {.isEnabled = true, .reading = 50}, 1},
    {"emergencyAlarm", {.reading = 50, .alarms = {.emergency = true}}, 26},
    {"critAlarm", {.reading = 50, .alarms = {.crit = true}}, 26},
    {"atCrit", {.reading = 90, .limits = allLimits}, 26},
    {"aboveCrit", {.reading = 90.001, .limits = allLimits}, 26},
    {"aboveEmergencyWithoutCrit", {.reading = 120, .limits = {.emergency = 100}}, 1},
    {"lcritAlarm", {.reading = 50, .alarms = {.lcrit = true}}, 25},
    {"atLcrit", {.reading = 0, .limits = allLimits}, 25},
    {"belowLcrit", {.reading = -0.5, .limits = allLimits}, 25},
    {"maxAlarm", {.reading = 50, .alarms = {.max = true}}, 23},
    {"atMax", {.reading = 80, .limits = allLimits}, 23},
    {"justBelowMax", {.reading = 79.999, .limits = allLimits}, 1},
    {"minAlarm", {.reading = 50, .alarms = {.min = true}}, 22},
    {"atMin", {.reading = 10, .limits = allLimits}, 22},
    {"justAboveMin", {.reading = 10.001, .limits = allLimits}, 1},
    {"plainAlarm", {.reading = 50, .limits = allLimits, .alarms = {.plain = true}}, 21},
    {"plainAlarmOfAFanAtItsMinimum",
        {.reading = 600, .limits = {.min = 600}, .alarms = {.plain = true}}, 22},
    {"plainAlarmOfAFanAboveItsMinimum",
        {.reading = 900, .limits = {.min = 600}, .alarms = {.plain = true}}, 21},
    {"faultBeforeDisabled", {.hasFault = true, .isEnabled = false, .reading = 50}, 13},
    {"unreadableBeforeDisabled", {.isEnabled = false, .reading = std::nullopt}, 13},
    {"faultBeforeCritical", {.hasFault = true, .reading = 95, .limits = allLimits}, 13},
    {"disabledBeforeCritical", {.isEnabled = false, .reading = 95, .limits = allLimits}, 16},
    {"criticalHighBeforeCriticalLow", {.reading = 50, .alarms = {.lcrit = true, .crit = true}}, 26},
    {"criticalLowBeforeWarningHigh", {.reading = 50, .alarms = {.max = true, .lcrit = true}}, 25},
    {"warningHighBeforeWarningLow", {.reading = 50, .alarms = {.min = true, .max = true}}, 23},
    {"warningLowBeforePlain", {.reading = 50, .alarms = {.plain = true, .min = true}}, 22},
};

INSTANTIATE_TEST_SUITE_P(EveryRow, StatusTableTest, testing::ValuesIn(rows),
    [](const auto& row) { return row.param.name; });

TEST(UnsetLimitsTest, APairWithBothEndsZeroIsAbsent)
{
    const Limits limits = withoutUnset({.min = 0, .max = 0, .lcrit = 0, .crit = 0});
    EXPECT_FALSE(limits.min || limits.max || limits.lcrit || limits.crit);
}

TEST(UnsetLimitsTest, AnEndThatIsMissingCountsAsZero)
{
    const Limits limits = withoutUnset({.min = 0, .crit = 0, .emergency = 0});
    EXPECT_FALSE(limits.min || limits.crit || limits.emergency);
}

TEST(UnsetLimitsTest, AZeroBesideASetEndIsMeant)
{
    const Limits limits = withoutUnset({.min = 0, .max = 85, .lcrit = -40, .crit = 0});
    EXPECT_EQ(limits.min, 0);
    EXPECT_EQ(limits.max, 85);
    EXPECT_EQ(limits.lcrit, -40);
    EXPECT_EQ(limits.crit, 0);
}

TEST(UnsetLimitsTest, AZeroBesideAnEndThatCannotBeReadIsMeant)
{
    constexpr double unreadable = std::numeric_limits<double>::quiet_NaN();
    const Limits limits =
        withoutUnset({.min = 0, .max = unreadable, .lcrit = unreadable, .crit = 0});
    EXPECT_EQ(limits.min, 0);
    EXPECT_FALSE(limits.max || limits.lcrit);
    EXPECT_EQ(limits.crit, 0);
}

TEST(UnsetLimitsTest, WhatCannotBeReadIsAbsent)
{
    constexpr double unreadable = std::numeric_limits<double>::quiet_NaN();
    const Limits limits =
        withoutUnset({.min = unreadable, .max = unreadable, .crit = 95, .emergency = unreadable});
    EXPECT_FALSE(limits.min || limits.max || limits.emergency);
    EXPECT_EQ(limits.crit, 95);
}

TEST(UnsetLimitsTest, ThePairsDoNotTouchEachOther)
{
    const Limits limits = withoutUnset({.min = 0, .max = 0, .crit = 95});
    EXPECT_FALSE(limits.min || limits.max);
    EXPECT_EQ(limits.crit, 95);
}

TEST(PossibleStatesTest, AChannelWithoutLimitsCanOnlyBeNormal)
{
    EXPECT_EQ(possibleStatesOf({.reading = 1}), std::vector<unsigned>{1});
}

TEST(PossibleStatesTest, EveryLimitAddsItsState)
{
    EXPECT_EQ(possibleStatesOf({.limits = {.min = 1}}), (std::vector<unsigned>{1, 22}));
    EXPECT_EQ(possibleStatesOf({.limits = {.max = 1}}), (std::vector<unsigned>{1, 23}));
    EXPECT_EQ(possibleStatesOf({.limits = {.lcrit = 1}}), (std::vector<unsigned>{1, 25}));
    EXPECT_EQ(possibleStatesOf({.limits = {.crit = 1}}), (std::vector<unsigned>{1, 26}));
    EXPECT_EQ(possibleStatesOf({.limits = {.emergency = 1}}), std::vector<unsigned>{1});
}

TEST(PossibleStatesTest, EveryAlarmAddsItsStateRaisedOrNot)
{
    EXPECT_EQ(possibleStatesOf({.alarms = {.plain = false}}), (std::vector<unsigned>{1, 21}));
    EXPECT_EQ(possibleStatesOf({.alarms = {.min = true}}), (std::vector<unsigned>{1, 22}));
    EXPECT_EQ(possibleStatesOf({.alarms = {.max = false}}), (std::vector<unsigned>{1, 23}));
    EXPECT_EQ(possibleStatesOf({.alarms = {.lcrit = false}}), (std::vector<unsigned>{1, 25}));
    EXPECT_EQ(possibleStatesOf({.alarms = {.crit = true}}), (std::vector<unsigned>{1, 26}));
    EXPECT_EQ(possibleStatesOf({.alarms = {.emergency = false}}), (std::vector<unsigned>{1, 26}));
}

TEST(PossibleStatesTest, ASwitchAddsDisabledAndAllStatesAscend)
{
    EXPECT_EQ(
        possibleStatesOf({.isEnabled = true, .limits = allLimits, .alarms = {.plain = false}}),
        (std::vector<unsigned>{1, 16, 21, 22, 23, 25, 26}));
}

} // namespace StatusTests
