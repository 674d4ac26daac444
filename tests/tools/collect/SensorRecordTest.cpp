// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/SensorRecord.h"

#include "tests/support/bmc/SimulatedSensor.h"
#include "tools/collect/SensorKind.h"

#include <gtest/gtest.h>

namespace SensorRecordTests {

using Ipmi::kindOf;
using Ipmi::readSensorRecord;
using Ipmi::SensorRecord;
using Testing::SimulatedSensor;
using Vorn::NodeLexicon::NodeType;

std::vector<std::uint8_t> bytesOf(const SimulatedSensor& sensor)
{
    const std::string record = Testing::recordOf(sensor);
    return {record.begin(), record.end()};
}

TEST(SensorRecordTest, ReadsTheFieldsOfAFullRecord)
{
    const SimulatedSensor sensor{.idString = Testing::eightBit("Fan"),
        .type = 4,
        .unit = 18,
        .thresholds = {{Testing::lnc, 1}, {Testing::lc, 2}, {Testing::lnr, 3}, {Testing::unc, 4},
            {Testing::uc, 5}, {Testing::unr, 6}},
        .entity = {29, 7},
        .owner = 0x2C,
        .lun = 3,
        .units1 = 0x80 | 3 << 3,
        .linearization = 7,
        .m = -300,
        .resultExponent = -6,
        .access = 3,
        .number = 9};
    const auto record = readSensorRecord(bytesOf(sensor));
    ASSERT_TRUE(record);
    EXPECT_EQ(
        record->address, (Ipmi::SensorAddress{.channel = 0, .owner = 0x2C, .lun = 3, .number = 9}));
    EXPECT_EQ(record->entity, 29);
    EXPECT_EQ(record->entityInstance, 7);
    EXPECT_EQ(record->sensorType, 4);
    EXPECT_EQ(record->eventType, 1);
    EXPECT_EQ(record->format, Ipmi::AnalogFormat::twosComplement);
    EXPECT_EQ(record->units.base, 18);
    EXPECT_EQ(record->units.rate, 3);
    EXPECT_FALSE(record->units.isModified);
    EXPECT_EQ(record->linearization, 7);
    EXPECT_EQ(record->factors, (Ipmi::Factors{.m = -300, .resultExponent = -6}));
    EXPECT_EQ(record->access, Ipmi::ThresholdAccess::fixed);
    EXPECT_EQ(record->readable, 0x3F);
    EXPECT_EQ(record->reported, 0x3F);
    EXPECT_EQ(record->thresholds, (Ipmi::RawThresholds{1, 2, 3, 4, 5, 6}));
    EXPECT_EQ(record->name, "Fan");
}

TEST(SensorRecordTest, LeavesOutOtherAndTruncatedRecords)
{
    auto bytes = bytesOf({.idString = Testing::eightBit("")});
    EXPECT_TRUE(readSensorRecord(bytes));
    for (std::size_t size = 0; size < bytes.size(); ++size)
        EXPECT_FALSE(readSensorRecord(std::span(bytes).first(size))) << size;
    bytes[3] = 2; // compact
    EXPECT_FALSE(readSensorRecord(bytes));
}

TEST(SensorKindTest, PublishesTemperaturesVoltagesAndFans)
{
    struct {
        int type;
        int unit;
        int rate;
        double value; // of a raw 100
        std::optional<NodeType> node;
        unsigned baseUnits;
    } const rows[] = {
        {1, 1, 0, 100, NodeType::Temperature, 2}, {1, 2, 0, 340.0 / 9, NodeType::Temperature, 2},
        {1, 3, 0, -173.15, NodeType::Temperature, 2}, {2, 4, 0, 100, NodeType::Voltage, 5},
        {4, 18, 0, 100, NodeType::Tachometer, 19}, {4, 18, 4, 100, NodeType::Tachometer, 19},
        {4, 41, 4, 100, NodeType::Tachometer, 19}, {4, 42, 3, 6000, NodeType::Tachometer, 19},
        {4, 41, 5, 100.0 / 60, NodeType::Tachometer, 19},
        {4, 19, 0, 6000, NodeType::Tachometer, 19}, {4, 41, 0, 0, {}, 0}, {4, 18, 3, 0, {}, 0},
        {4, 4, 0, 0, {}, 0}, {1, 1, 3, 0, {}, 0}, {1, 4, 0, 0, {}, 0}, {2, 1, 0, 0, {}, 0},
        {2, 4, 4, 0, {}, 0}, {3, 5, 0, 0, {}, 0}, // a current
    };
    for (const auto& row : rows) {
        SensorRecord record;
        record.format = Ipmi::AnalogFormat::unsignedNumber;
        record.sensorType = static_cast<std::uint8_t>(row.type);
        record.units = {static_cast<std::uint8_t>(row.unit), static_cast<std::uint8_t>(row.rate)};
        const auto kind = kindOf(record);
        ASSERT_EQ(kind.has_value(), row.node.has_value()) << row.type << " " << row.unit;
        if (!kind)
            continue;
        EXPECT_EQ(kind->type, row.node);
        EXPECT_EQ(kind->baseUnits(), row.baseUnits);
        EXPECT_NEAR(kind->inBaseUnit(100), row.value, 1e-12);

        record.units.isModified = true;
        EXPECT_FALSE(kindOf(record));
        record.units.isModified = false;
        record.format = Ipmi::AnalogFormat::none;
        EXPECT_FALSE(kindOf(record));
        record.format = Ipmi::AnalogFormat::twosComplement;
        for (const auto& [linearization, isKnown] :
            {std::pair(11, true), {12, false}, {0x6F, false}, {0x70, true}, {0x7F, true}}) {
            record.linearization = static_cast<Ipmi::Linearization>(linearization);
            EXPECT_EQ(kindOf(record).has_value(), isKnown) << linearization;
        }
    }
}

TEST(SensorKindTest, DoesNotFallShortOfAWholeNumberOfThousandths)
{
    constexpr Ipmi::SensorKind fromKelvins{NodeType::Temperature, -273.15};
    for (int kelvins = 0; kelvins <= 500; ++kelvins) {
        const long double thousandths = fromKelvins.inBaseUnit(kelvins) * 1000.0L;
        EXPECT_EQ(std::trunc(thousandths), kelvins * 1000 - 273150) << kelvins;
    }
}

// Speeds are reciprocals of times.
TEST(SensorKindTest, DoesNotFallShortOfAWholeNumberOfRevolutions)
{
    constexpr Ipmi::SensorKind fan{NodeType::Tachometer};
    int wholeNumbers = 0;
    for (int m = 1; m < 512; ++m)
        for (int x = 1; x < 256; ++x) {
            constexpr int scale = 1'000'000;
            if (scale % (m * x) != 0)
                continue;
            ++wholeNumbers;
            const auto speed =
                Ipmi::convert(static_cast<std::uint8_t>(x), Ipmi::AnalogFormat::unsignedNumber,
                    {.m = m, .resultExponent = -6}, Ipmi::reciprocal);
            const long double thousandths = fan.inBaseUnit(speed.value()) * 1000.0L;
            EXPECT_EQ(std::trunc(thousandths), 1000.0L * (scale / (m * x))) << m << " " << x;
        }
    EXPECT_GT(wholeNumbers, 200);
}

} // namespace SensorRecordTests
