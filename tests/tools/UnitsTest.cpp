// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/Units.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>

namespace {

using namespace Tools;

TEST(ScaledTest, AppliesThePowerOfTen)
{
    EXPECT_EQ(scaled(12345, -3), "12.345");
    EXPECT_EQ(scaled(41, 0), "41");
    EXPECT_EQ(scaled(12, 2), "1200");
    EXPECT_EQ(scaled(-12345, -3), "-12.345");
}

TEST(ScaledTest, FillsUpWithZeros)
{
    EXPECT_EQ(scaled(0, -3), "0.000");
    EXPECT_EQ(scaled(5, -3), "0.005");
    EXPECT_EQ(scaled(-5, -3), "-0.005");
    EXPECT_EQ(scaled(-345, -3), "-0.345");
    EXPECT_EQ(scaled(0, 4), "0");
}

TEST(ScaledTest, KnowsTheExtremes)
{
    EXPECT_EQ(scaled(std::numeric_limits<std::int32_t>::min(), -3), "-2147483.648");
    EXPECT_EQ(scaled(std::numeric_limits<std::int64_t>::min(), -18), "-9.223372036854775808");
    EXPECT_EQ(scaled(7, std::numeric_limits<std::int32_t>::min()), "7e-2147483648");
    EXPECT_EQ(scaled(7, 40), "7e40");
}

TEST(ScaledToHundredthsTest, RoundsFractions)
{
    EXPECT_EQ(scaledToHundredths(12599, -3), "12.60");
    EXPECT_EQ(scaledToHundredths(3134, -3), "3.13");
    EXPECT_EQ(scaledToHundredths(3135, -3), "3.14");
    EXPECT_EQ(scaledToHundredths(-12599, -3), "-12.60");
    EXPECT_EQ(scaledToHundredths(-12504, -3), "-12.50");
    EXPECT_EQ(scaledToHundredths(1234567, -6), "1.23");
    EXPECT_EQ(scaledToHundredths(9999, -3), "10.00");
}

TEST(ScaledToHundredthsTest, LeavesTheRestAlone)
{
    EXPECT_EQ(scaledToHundredths(1500, 0), "1500");
    EXPECT_EQ(scaledToHundredths(125, -1), "12.5");
    EXPECT_EQ(scaledToHundredths(12, 2), "1200");
    EXPECT_EQ(scaledToHundredths(5, -3), "0.005");
    EXPECT_EQ(scaledToHundredths(-999, -3), "-0.999");
    EXPECT_EQ(scaledToHundredths(0, -3), "0.000");
    EXPECT_EQ(scaledToHundredths(7, -40), "7e-40");
}

TEST(WithoutTrailingZerosTest, TouchesFractionsOnly)
{
    EXPECT_EQ(withoutTrailingZeros("12.500"), "12.5");
    EXPECT_EQ(withoutTrailingZeros("12.000"), "12");
    EXPECT_EQ(withoutTrailingZeros("0.000"), "0");
    EXPECT_EQ(withoutTrailingZeros("1200"), "1200");
    EXPECT_EQ(withoutTrailingZeros("7e-20"), "7e-20");
}

TEST(UnitSymbolTest, HasTheCommonSymbols)
{
    EXPECT_EQ(unitSymbol(2), "°C");
    EXPECT_EQ(unitSymbol(5), "V");
    EXPECT_EQ(unitSymbol(19), "RPM");
    EXPECT_EQ(unitSymbol(65), "%");
}

TEST(UnitSymbolTest, IsTheValueMapsTextElsewhere)
{
    EXPECT_EQ(unitSymbol(18), "CFM");
    EXPECT_EQ(unitSymbol(51), "Moles");
}

TEST(UnitSymbolTest, IsEmptyWhereNoUnitIsKnown)
{
    for (const std::uint64_t code : {0U, 1U, 67U, 65535U})
        EXPECT_EQ(unitSymbol(code), "") << code;
}

} // namespace
