// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Sensor.h"

#include "tests/tools/InstanceTest.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <optional>
#include <string>
#include <tuple>

namespace {

using Tools::Sensor;
using Tools::Urgency;

class SensorTest : public Testing::InstanceTest {
protected:
    Sensor seen() const { return Sensor(instance_); }

    std::optional<std::string> reading() const
    {
        const Sensor sensor = seen();
        return sensor.reading ? std::optional(sensor.reading->text()) : std::nullopt;
    }
};

TEST_F(SensorTest, InstanceWithoutPropertiesSaysNothing)
{
    EXPECT_EQ(seen().label, "");
    EXPECT_EQ(seen().kind, "");
    EXPECT_EQ(reading(), std::nullopt);
    EXPECT_EQ(seen().unit, "");
    EXPECT_EQ(seen().state.word, "Unknown");
    EXPECT_EQ(seen().state.urgency, Urgency::unknown);
    EXPECT_FALSE(seen().limits.back());
}

TEST_F(SensorTest, ReadingIsScaledToItsUnit)
{
    setNumber("CurrentReading", 12345);
    setNumber("UnitModifier", -3);
    setCode("BaseUnits", 5);
    EXPECT_EQ(reading(), "12.345");
    EXPECT_EQ(seen().unit, "V");
}

TEST_F(SensorTest, ZeroOfAWorkingSensorIsAReading)
{
    setNumber("CurrentReading", 0);
    setCode("EnabledState", 2);
    setCodes("OperationalStatus", {2});
    EXPECT_EQ(reading(), "0");
}

TEST_F(SensorTest, LostCommunicationHasNoReading)
{
    setNumber("CurrentReading", 42);
    setCodes("OperationalStatus", {13});
    EXPECT_EQ(reading(), std::nullopt);
}

TEST_F(SensorTest, ZeroWithoutContactIsNoReading)
{
    setNumber("CurrentReading", 0);
    setCodes("OperationalStatus", {12});
    EXPECT_EQ(reading(), std::nullopt);
    setNumber("CurrentReading", 7);
    EXPECT_EQ(reading(), "7");
}

TEST_F(SensorTest, ZeroOfADisabledOrOfflineSensorIsNoReading)
{
    for (const std::uint64_t state : {3U, 6U}) {
        setCode("EnabledState", state);
        setNumber("CurrentReading", 0);
        EXPECT_EQ(reading(), std::nullopt) << state;
        setNumber("CurrentReading", 7);
        EXPECT_EQ(reading(), "7") << state;
    }
}

TEST_F(SensorTest, MarkForWhatDoesNotFitIsNoNumber)
{
    setNumber("CurrentReading", std::numeric_limits<std::int32_t>::min());
    setNumber("UpperThresholdFatal", std::numeric_limits<std::int32_t>::min());
    EXPECT_EQ(reading(), std::nullopt);
    EXPECT_FALSE(seen().limits.back());
}

TEST_F(SensorTest, LimitsHaveTheModifierOfTheReading)
{
    setNumber("UnitModifier", -3);
    setNumber("LowerThresholdNonCritical", 10800);
    setNumber("UpperThresholdCritical", 13199);
    EXPECT_EQ(seen().limits[0]->text(), "10.8");
    EXPECT_EQ(seen().limits[4]->text(), "13.199");
    EXPECT_EQ(seen().limits[4]->rounded(), "13.20");
    EXPECT_DOUBLE_EQ(seen().limits[4]->number(), 13.199);
}

TEST_F(SensorTest, ChipIsTheFolderOfThePath)
{
    struct Expected {
        const char* id;
        const char* path;
        const char* chip;
        const char* feature;
    };
    setText("ElementName", "A:B");
    for (const Expected& expected : {Expected{"A:B:/hwmon/jc42-i2c-0-18/temp1",
                                         "/hwmon/jc42-i2c-0-18/temp1", "jc42-i2c-0-18", "temp1"},
             Expected{"A:B:/system/cpu1/vrm", "/system/cpu1/vrm", "system/cpu1", "vrm"},
             Expected{"A:B:/1", "/1", "/", "1"}, Expected{"other", "other", "/", "other"}}) {
        setText("DeviceID", expected.id);
        EXPECT_EQ(seen().path, expected.path);
        EXPECT_EQ(seen().chip, expected.chip);
        EXPECT_EQ(seen().feature, expected.feature);
        EXPECT_EQ(seen().deviceId, expected.id);
    }
}

TEST_F(SensorTest, KindFollowsTheSensorType)
{
    for (const auto& [code, kind] :
        {std::pair{2U, "temperature"}, {3U, "voltage"}, {5U, "fan"}, {0U, ""}, {4U, ""}}) {
        setCode("SensorType", code);
        EXPECT_EQ(seen().kind, kind);
    }
}

TEST_F(SensorTest, StateIsThatOfTheProvider)
{
    setCodes("OperationalStatus", {13});
    for (const auto& [state, word, urgency] : {std::tuple("Normal", "Normal", Urgency::normal),
             {"WarningLow", "Warning low", Urgency::warning},
             {"CriticalHigh", "Critical high", Urgency::critical},
             {"Disabled", "Disabled", Urgency::inactive}, {"New", "Unknown", Urgency::unknown}}) {
        setText("CurrentState", state);
        EXPECT_EQ(seen().state.word, word);
        EXPECT_EQ(seen().state.urgency, urgency);
    }
}

TEST_F(SensorTest, UnknownStateGivesWayToTheOperationalStatus)
{
    setText("CurrentState", "Unknown");
    EXPECT_EQ(seen().state.word, "Unknown");
    for (const auto& [status, word, urgency] : {std::tuple(5U, "Failing soon", Urgency::warning),
             {8U, "Starting", Urgency::inactive}, {12U, "No contact", Urgency::inactive},
             {13U, "Lost", Urgency::lost}, {15U, "Dormant", Urgency::inactive},
             {0U, "Unknown", Urgency::unknown}, {2U, "Unknown", Urgency::unknown}}) {
        setCodes("OperationalStatus", {status});
        EXPECT_EQ(seen().state.word, word);
        EXPECT_EQ(seen().state.urgency, urgency);
    }
}

TEST_F(SensorTest, PropertyOfAnUnexpectedTypeCountsAsAbsent)
{
    setText("CurrentReading", "12");
    setCode("CurrentState", 1);
    setCode("OperationalStatus", 13);
    EXPECT_EQ(reading(), std::nullopt);
    EXPECT_EQ(seen().state.word, "Unknown");
}

} // namespace
