// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/Sensor.h"

#include <gtest/gtest.h>

#include <limits>
#include <map>

namespace {

using Vorn::SensorProfileProvider::Sensor;
using Codes = std::vector<std::uint16_t>;
using Labels = std::vector<std::string>;

// All codes near the entries of the tables, and some far from them.
const std::vector<unsigned> allCodes = [] {
    std::vector<unsigned> codes;
    for (unsigned code = 0; code <= 40; ++code)
        codes.push_back(code);
    codes.insert(codes.end(), {255, 256, 65536, 65537, 65536 + 26, 0xFFFFFFFFU});
    return codes;
}();

template <typename Value>
Value expected(const std::map<unsigned, Value>& rows, unsigned code, Value otherwise)
{
    const auto row = rows.find(code);
    return row == rows.end() ? otherwise : row->second;
}

TEST(SensorTest, ANewRecordIsEmpty)
{
    Sensor sensor;
    EXPECT_EQ(sensor.getDeviceID(), "");
    EXPECT_EQ(sensor.getElementName(), "");
    EXPECT_EQ(sensor.getCurrentState(), "");
    EXPECT_EQ(sensor.getHealthStatus(), "");
    EXPECT_EQ(sensor.getBaseUnits(), 0);
    EXPECT_EQ(sensor.getRateUnits(), 0);
    EXPECT_EQ(sensor.getUnitModifier(), 0);
    EXPECT_EQ(sensor.getSensorType(), 0);
    EXPECT_EQ(sensor.getEnabledState(), 0);
    EXPECT_EQ(sensor.getRequestedState(), 0);
    EXPECT_EQ(sensor.getHealthState(), 0);
    EXPECT_EQ(sensor.getCurrentReading(), 0);
    EXPECT_EQ(sensor.getLowerThresholdNonCritical(), 0);
    EXPECT_EQ(sensor.getUpperThresholdNonCritical(), 0);
    EXPECT_EQ(sensor.getLowerThresholdCritical(), 0);
    EXPECT_EQ(sensor.getUpperThresholdCritical(), 0);
    EXPECT_EQ(sensor.getLowerThresholdFatal(), 0);
    EXPECT_EQ(sensor.getUpperThresholdFatal(), 0);
    EXPECT_TRUE(sensor.getOperationalStatus().empty());
}

TEST(SensorTest, BeforeASensorTypeIsSetReadingsAreStoredUnscaled)
{
    Sensor sensor;
    EXPECT_TRUE(sensor.setCurrentReading(41.9));
    EXPECT_EQ(sensor.getCurrentReading(), 41);
}

TEST(SensorTest, DeviceIDIsStrippedWhenReadAndRefusedWhenEmpty)
{
    Sensor sensor;
    EXPECT_TRUE(sensor.setDeviceID("  CPU 1 Temp:/a/b "));
    EXPECT_EQ(sensor.getDeviceID(), "CPU 1 Temp:/a/b");
    EXPECT_FALSE(sensor.setDeviceID(""));
    EXPECT_EQ(sensor.getDeviceID(), "");
    EXPECT_TRUE(sensor.setDeviceID(" ")); // accepted: only the empty text is refused
}

TEST(SensorTest, ElementNameIsStrippedWhenReadAndRefusedWhenEmpty)
{
    Sensor sensor;
    EXPECT_TRUE(sensor.setElementName(" CPU 1 "));
    EXPECT_EQ(sensor.getElementName(), "CPU 1");
    EXPECT_FALSE(sensor.setElementName(""));
    EXPECT_EQ(sensor.getElementName(), "");
}

TEST(SensorTest, BaseUnitsKeepTheirLow16Bits)
{
    Sensor sensor;
    EXPECT_TRUE(sensor.setBaseUnits(65536 + 19));
    EXPECT_EQ(sensor.getBaseUnits(), 19);
    EXPECT_TRUE(sensor.setBaseUnits(0));
    EXPECT_EQ(sensor.getBaseUnits(), 0);
}

TEST(SensorTest, ARateIsRefusedWhenItsLow16BitsAreZeroAndAlwaysReadAsZero)
{
    Sensor sensor;
    EXPECT_FALSE(sensor.setRateUnits(0));
    EXPECT_FALSE(sensor.setRateUnits(65536));
    EXPECT_TRUE(sensor.setRateUnits(5));
    EXPECT_EQ(sensor.getRateUnits(), 0);
    EXPECT_EQ(sensor.getRateUnits(), 0);
}

TEST(SensorTest, UnitModifierIsStoredAsItIs)
{
    Sensor sensor;
    EXPECT_TRUE(sensor.setUnitModifier(-9));
    EXPECT_EQ(sensor.getUnitModifier(), -9);
}

TEST(SensorTest, EachSensorTypeCodeGivesItsTypeScaleAndModifier)
{
    struct Row {
        std::uint16_t type;
        std::int32_t scaledTwoAndAHalf;
        int modifier;
    };
    const std::map<unsigned, Row> rows = {{20, {5, 2, 0}}, {21, {3, 2500, -3}}, {22, {2, 2, 0}}};
    for (const unsigned code : allCodes) {
        const bool known = rows.contains(code);
        const Row row = known ? rows.at(code) : Row{0, 2, 0};
        Sensor sensor;
        sensor.setBaseUnits(7);
        sensor.setUnitModifier(4);
        EXPECT_TRUE(sensor.setSensorType(code));
        sensor.setCurrentReading(2.5);
        EXPECT_EQ(sensor.getSensorType(), row.type) << code;
        EXPECT_EQ(sensor.getCurrentReading(), row.scaledTwoAndAHalf) << code;
        EXPECT_EQ(sensor.getUnitModifier(), row.modifier) << code;
        EXPECT_EQ(sensor.getBaseUnits(), known ? 7 : 0) << code;
    }
}

TEST(SensorTest, EachNodeStatusGivesItsEnabledState)
{
    const std::map<unsigned, int> rows = {{0, 0}, {1, 2}, {12, 6}, {16, 3}};
    for (const unsigned code : allCodes) {
        Sensor sensor;
        EXPECT_TRUE(sensor.setEnabledState(code));
        EXPECT_EQ(sensor.getEnabledState(), expected(rows, code, 5)) << code;
    }
}

TEST(SensorTest, EachCodeGivesItsRequestedState)
{
    const std::map<unsigned, int> rows = {
        {0, 0}, {1, 2}, {3, 4}, {8, 9}, {9, 10}, {12, 4}, {16, 3}};
    for (const unsigned code : allCodes) {
        Sensor sensor;
        EXPECT_TRUE(sensor.setRequestedState(code));
        EXPECT_EQ(sensor.getRequestedState(), expected(rows, code, 12)) << code;
    }
}

TEST(SensorTest, EachNodeStatusGivesItsHealthStateAndStatus)
{
    using Health = std::pair<int, std::string>;
    const std::map<unsigned, Health> rows = {{0, {0, "UnKnown"}}, {20, {10, "Error"}},
        {21, {10, "Error"}}, {22, {10, "Error"}}, {23, {10, "Error"}}, {24, {25, "Error"}},
        {25, {25, "Error"}}, {26, {25, "Error"}}};
    for (const unsigned code : allCodes) {
        Sensor sensor;
        EXPECT_TRUE(sensor.setHealthState(code));
        const Health health = {sensor.getHealthState(), sensor.getHealthStatus()};
        EXPECT_EQ(health, expected(rows, code, Health{5, "OK"})) << code;
    }
}

const std::map<unsigned, std::string> stateLabelRows = {{1, "Normal"}, {12, "Offline"},
    {16, "Disabled"}, {21, "Warning"}, {22, "WarningLow"}, {23, "WarningHigh"}, {24, "Critical"},
    {25, "CriticalLow"}, {26, "CriticalHigh"}};

TEST(SensorTest, EachNodeStatusGivesItsCurrentState)
{
    for (const unsigned code : allCodes) {
        Sensor sensor;
        EXPECT_TRUE(sensor.setCurrentState(code));
        EXPECT_EQ(sensor.getCurrentState(), expected<std::string>(stateLabelRows, code, "Unknown"))
            << code;
    }
}

TEST(SensorTest, EachNodeStatusGivesItsOperationalStatus)
{
    const std::map<unsigned, int> rows = {
        {0, 0}, {1, 2}, {2, 8}, {3, 9}, {8, 15}, {10, 10}, {13, 13}, {17, 12}, {20, 5}};
    for (const unsigned code : allCodes) {
        Sensor sensor;
        EXPECT_TRUE(sensor.setOperationalStatus(code));
        EXPECT_EQ(sensor.getOperationalStatus(),
            Codes{static_cast<std::uint16_t>(expected(rows, code, 0))})
            << code;
    }
}

TEST(SensorTest, OperationalStatusGrowsWithEverySetting)
{
    Sensor sensor;
    sensor.setOperationalStatus(1);
    sensor.setOperationalStatus(1);
    sensor.setOperationalStatus(20);
    EXPECT_EQ(sensor.getOperationalStatus(), (Codes{2, 2, 5}));
}

const Labels fixedLabels = {"Normal", "Warning", "Non-Critical", "Lower Non-Critical",
    "Upper Non-Critical", "Critical", "Lower Critical", "Upper Critical", "Fatal", "Lower Fatal",
    "Upper Fatal", "Unknown"};

Labels withFixedLabels(Labels labels)
{
    labels.insert(labels.end(), fixedLabels.begin(), fixedLabels.end());
    return labels;
}

TEST(SensorTest, PossibleStatesAreTheirLabelsAndThenTheFixedOnes)
{
    Sensor sensor;
    EXPECT_TRUE(sensor.setPossibleStates({1, 99, 25, 65536 + 25}));
    EXPECT_EQ(sensor.getPossibleStates(),
        withFixedLabels({"Normal", "Unknown", "CriticalLow", "Unknown"}));
}

TEST(SensorTest, EachPossibleStateHasTheLabelOfTheCurrentState)
{
    Sensor sensor;
    sensor.setPossibleStates(allCodes);
    Labels labels;
    for (const unsigned code : allCodes)
        labels.push_back(expected<std::string>(stateLabelRows, code, "Unknown"));
    EXPECT_EQ(sensor.getPossibleStates(), withFixedLabels(labels));
}

TEST(SensorTest, PossibleStatesGrowWithEveryReadingAndAreReplacedBySetting)
{
    Sensor sensor;
    EXPECT_EQ(sensor.getPossibleStates(), fixedLabels);
    EXPECT_EQ(sensor.getPossibleStates(), withFixedLabels(fixedLabels));
    EXPECT_TRUE(sensor.setPossibleStates({1, 1}));
    EXPECT_EQ(sensor.getPossibleStates(), withFixedLabels({"Normal", "Normal"}));
    EXPECT_TRUE(sensor.setPossibleStates({}));
    EXPECT_EQ(sensor.getPossibleStates(), fixedLabels);
}

TEST(SensorTest, ThresholdListsGrowWithEveryReadingEachOnItsOwn)
{
    Sensor sensor;
    EXPECT_EQ(sensor.getSupportedThresholds(), (Codes{0, 1, 2, 3, 4, 5}));
    EXPECT_EQ(sensor.getSupportedThresholds(), (Codes{0, 1, 2, 3, 4, 5, 0, 1, 2, 3, 4, 5}));
    EXPECT_EQ(sensor.getSettableThresholds(), (Codes{0, 1, 2, 3, 4, 5}));
    EXPECT_EQ(sensor.getSettableThresholds().size(), 12U);
}

TEST(SensorTest, ACopyGrowsOnItsOwn)
{
    Sensor sensor;
    Sensor copy = sensor;
    copy.getSupportedThresholds();
    copy.getPossibleStates();
    EXPECT_EQ(sensor.getSupportedThresholds().size(), 6U);
    EXPECT_EQ(sensor.getPossibleStates().size(), 12U);
    EXPECT_EQ(copy.getSupportedThresholds().size(), 12U);
}

// ---- Scaling ----

struct Scaling {
    unsigned sensorType;
    double value;
    std::int32_t stored;
};

constexpr double infinity = std::numeric_limits<double>::infinity();
constexpr double notANumber = std::numeric_limits<double>::quiet_NaN();
constexpr std::int32_t outOfRange = std::numeric_limits<std::int32_t>::min();

const std::vector<Scaling> scalings = {
    {21, 12.3456, 12345},
    {22, -0.5, 0},
    {22, 2.9, 2},
    {22, -2.9, -2},
    {20, 1234.9, 1234},
    // The product is not rounded to double before it is truncated.
    {21, 3.3, 3299},
    {21, 4.35, 4349},
    {21, -3.3, -3299},
    {21, 1.1, 1100},
    {21, 0.0, 0},
    {99, 3.3, 3},
    // The limits of the range.
    {22, 2147483647.0, 2147483647},
    {22, 2147483647.9, 2147483647},
    {22, 2147483648.0, outOfRange},
    {22, -2147483648.0, outOfRange},
    {22, -2147483649.0, outOfRange},
    {22, 3.0e9, outOfRange},
    {21, 3.0e6, outOfRange},
    {21, 2147483.0, 2147483000},
    {22, infinity, outOfRange},
    {22, -infinity, outOfRange},
    {21, notANumber, outOfRange},
    {21, 1e308, outOfRange},
};

struct ScaledField {
    const char* name;
    bool (Sensor::*set)(double);
    std::int32_t (Sensor::*get)() const;
};

const std::vector<ScaledField> scaledFields = {
    {"CurrentReading", &Sensor::setCurrentReading, &Sensor::getCurrentReading},
    {"LowerThresholdNonCritical", &Sensor::setLowerThresholdNonCritical,
        &Sensor::getLowerThresholdNonCritical},
    {"UpperThresholdNonCritical", &Sensor::setUpperThresholdNonCritical,
        &Sensor::getUpperThresholdNonCritical},
    {"LowerThresholdCritical", &Sensor::setLowerThresholdCritical,
        &Sensor::getLowerThresholdCritical},
    {"UpperThresholdCritical", &Sensor::setUpperThresholdCritical,
        &Sensor::getUpperThresholdCritical},
    {"LowerThresholdFatal", &Sensor::setLowerThresholdFatal, &Sensor::getLowerThresholdFatal},
    {"UpperThresholdFatal", &Sensor::setUpperThresholdFatal, &Sensor::getUpperThresholdFatal},
};

TEST(SensorTest, EveryScaledFieldIsMultipliedInExtendedPrecisionAndCut)
{
    for (const ScaledField& field : scaledFields)
        for (const Scaling& scaling : scalings) {
            Sensor sensor;
            sensor.setSensorType(scaling.sensorType);
            EXPECT_TRUE((sensor.*field.set)(scaling.value));
            EXPECT_EQ((sensor.*field.get)(), scaling.stored)
                << field.name << " of type " << scaling.sensorType << ": " << scaling.value;
        }
}

TEST(SensorTest, EveryScaledFieldIsStoredApartFromTheOthers)
{
    Sensor sensor;
    double value = 1.0;
    for (const ScaledField& field : scaledFields)
        (sensor.*field.set)(value++);
    std::int32_t stored = 1;
    for (const ScaledField& field : scaledFields)
        EXPECT_EQ((sensor.*field.get)(), stored++) << field.name;
}

} // namespace
