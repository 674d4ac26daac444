// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The whole numbers that the hardware reports, as records publish them.

#include "model/Sensor.h"
#include "platform/instrumentation/Thousandths.h"
#include "tests/platform/instrumentation/HwmonMachine.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace HwmonPrecisionTests {

using HwmonPrecisionTest = Testing::HwmonTest;

using Vorn::keepingThousandths;
using Vorn::SensorProfileProvider::Sensor;

constexpr unsigned tachometer = 20;
constexpr unsigned voltage = 21;
constexpr int largest = 100'000;

std::int32_t published(unsigned sensorType, double reading)
{
    Sensor sensor;
    sensor.setSensorType(sensorType);
    sensor.setCurrentReading(reading);
    return sensor.getCurrentReading();
}

bool isAtMostOneDoubleAway(double value, double from)
{
    constexpr double infinity = std::numeric_limits<double>::infinity();
    return value >= std::nextafter(from, -infinity) && value <= std::nextafter(from, infinity);
}

TEST(KeepingThousandthsTest, EveryWholeNumberIsPublishedAsItIs)
{
    for (int number = -largest; number <= largest; ++number) {
        const double volts = keepingThousandths(number / 1000.0);
        ASSERT_EQ(published(voltage, volts), number);
        ASSERT_PRED2(isAtMostOneDoubleAway, volts, number / 1000.0);
        ASSERT_EQ(published(tachometer, number), number);
    }
}

TEST(KeepingThousandthsTest, OtherVoltagesStayAsTheyAre)
{
    for (const double volts : {0.0, 1.0, 1.2345, -1.2345, 12.0009999, 1e300, -1e300, 5e-324,
             std::nextafter(1.2, 1.0), std::nextafter(1.2, 2.0)})
        EXPECT_EQ(keepingThousandths(volts), volts);
}

// Each channel of a bound tree is read as the source reads it.
TEST_F(HwmonPrecisionTest, ReadingsAndLimitsOfVoltagesKeepTheirMillivolts)
{
    for (const int number : {408, 1000, 1100, 1200, 1208, 3232, 3300, 3376, 4350, 12096, -1200}) {
        const std::string text = std::to_string(number);
        const auto values =
            Testing::nodeOf({{"in0_input", text}, {"in0_max", text}, {"in0_lcrit", text}}).values;
        EXPECT_EQ(published(voltage, *values.reading), number);
        EXPECT_EQ(published(voltage, *values.upperNonCritical), number);
        EXPECT_EQ(published(voltage, *values.lowerCritical), number);
        EXPECT_EQ(values.status, 25U) << "a reading is not below an equal limit";
    }
}

} // namespace HwmonPrecisionTests
