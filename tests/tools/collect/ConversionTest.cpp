// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/Conversion.h"

#include <gmock/gmock.h>

#include <array>
#include <cmath>
#include <numbers>

namespace ConversionTests {

using Ipmi::AnalogFormat;
using Ipmi::convert;
using Ipmi::Factors;
using Ipmi::factorsOf;
using testing::DoubleEq;
using testing::Optional;

TEST(ConversionTest, ReadsEachFormat)
{
    struct {
        std::uint8_t raw;
        AnalogFormat format;
        double value;
    } const rows[] = {
        {0, AnalogFormat::unsignedNumber, 0},
        {255, AnalogFormat::unsignedNumber, 255},
        {127, AnalogFormat::onesComplement, 127},
        {0x80, AnalogFormat::onesComplement, -127},
        {0xFE, AnalogFormat::onesComplement, -1},
        {0xFF, AnalogFormat::onesComplement, 0},
        {127, AnalogFormat::twosComplement, 127},
        {0x80, AnalogFormat::twosComplement, -128},
        {0xFF, AnalogFormat::twosComplement, -1},
    };
    for (const auto& [raw, format, value] : rows)
        EXPECT_EQ(convert(raw, format, {}, 0), value) << int{raw};
    EXPECT_EQ(convert(1, AnalogFormat::none, {}, 0), std::nullopt);
}

TEST(ConversionTest, AppliesFactorsWithTheNearestDoubleAsTheResult)
{
    struct {
        std::uint8_t raw;
        Factors factors;
        double value;
    } const rows[] = {
        {195, {.m = 17, .resultExponent = -3}, 3.315},
        {100, {.m = -6, .resultExponent = -2}, -6},
        {10, {.m = 3, .b = -5, .bExponent = 2, .resultExponent = 1}, -4700},
        {10, {.m = 3, .b = 5, .bExponent = -1}, 30.5},
        {10, {.m = 3, .b = 5, .bExponent = -3, .resultExponent = -5}, 0.00030005},
        {255, {.m = 511, .b = 511, .bExponent = 7, .resultExponent = 7}, 51101303050000000.0},
        {255, {.m = -512, .b = -512, .bExponent = -8, .resultExponent = -8}, -0.0013056000000512},
    };
    for (const auto& [raw, factors, value] : rows)
        EXPECT_EQ(convert(raw, AnalogFormat::unsignedNumber, factors, 0), value);
}

TEST(ConversionTest, AppliesEachLinearization)
{
    const std::array<double, 12> values = {2, std::numbers::ln2, std::log10(2), 1, std::exp(2), 100,
        4, 0.5, 4, 8, std::numbers::sqrt2, std::cbrt(2)};
    for (std::uint8_t code = 0; code < values.size(); ++code)
        EXPECT_THAT(
            convert(2, AnalogFormat::unsignedNumber, {}, code), Optional(DoubleEq(values[code])))
            << int{code};
    EXPECT_EQ(convert(2, AnalogFormat::unsignedNumber, {}, 0x70), 2);
    EXPECT_EQ(convert(2, AnalogFormat::unsignedNumber, {}, 0x7F), 2);
}

TEST(ConversionTest, ReturnsNothingWhereThereIsNoFiniteNumber)
{
    EXPECT_EQ(convert(0, AnalogFormat::unsignedNumber, {}, 7), std::nullopt); // 1/0
    EXPECT_EQ(convert(0, AnalogFormat::unsignedNumber, {}, 1), std::nullopt); // ln 0
    EXPECT_EQ(convert(0xFF, AnalogFormat::twosComplement, {}, 10), std::nullopt);
    EXPECT_EQ(convert(255, AnalogFormat::unsignedNumber, {.m = 511, .resultExponent = 7}, 4),
        std::nullopt);
    EXPECT_EQ(convert(2, AnalogFormat::unsignedNumber, {}, 12), std::nullopt);
    EXPECT_EQ(convert(2, AnalogFormat::unsignedNumber, {}, 0x6F), std::nullopt);
}

TEST(ConversionTest, ReadsFactorsOfTenAndFourBits)
{
    const auto factors = [](std::array<std::uint8_t, Ipmi::factorBytes> bytes) {
        return factorsOf(bytes);
    };
    EXPECT_EQ(factors({0x3B, 0, 0, 0, 0, 0xD0}), (Factors{.m = 59, .resultExponent = -3}));
    EXPECT_EQ(factors({0xFA, 0xC0, 0, 0, 0, 0xE0}), (Factors{.m = -6, .resultExponent = -2}));
    EXPECT_EQ(factors({0xFF, 0x7F, 0x00, 0xBF, 0xFF, 0x78}),
        (Factors{.m = 511, .b = -512, .bExponent = -8, .resultExponent = 7}));
}

} // namespace ConversionTests
