// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/Conversion.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

namespace Ipmi {

namespace {

// Returns the number in the lowest bits in two's complement.
int signedBits(unsigned bits, unsigned count)
{
    const unsigned sign = 1U << (count - 1);
    return static_cast<int>(bits & (sign - 1)) - static_cast<int>(bits & sign);
}

std::optional<int> numberOf(std::uint8_t raw, AnalogFormat format)
{
    switch (format) {
    case AnalogFormat::unsignedNumber:
        return raw;
    case AnalogFormat::onesComplement:
        return raw < 0x80 ? raw : raw - 0xFF;
    case AnalogFormat::twosComplement:
        return signedBits(raw, 8);
    case AnalogFormat::none:
        break;
    }
    return std::nullopt;
}

double powerOfTen(int exponent)
{
    return std::pow(10.0, exponent);
}

// Divides one whole number by another where it can, so that the result is the double nearest to the
// decimal number: 3315 / 1000 is 3.315, 3315 * 0.001 is not.
double scaled(int x, const Factors& factors)
{
    const int common = std::min(factors.bExponent, 0);
    const double sum =
        factors.m * x * powerOfTen(-common) + factors.b * powerOfTen(factors.bExponent - common);
    const int exponent = factors.resultExponent + common;
    return exponent < 0 ? sum / powerOfTen(-exponent) : sum * powerOfTen(exponent);
}

double linearized(double y, Linearization code)
{
    switch (code) {
    case linear:
        return y;
    case 1:
        return std::log(y);
    case 2:
        return std::log10(y);
    case 3:
        return std::log2(y);
    case 4:
        return std::exp(y);
    case 5:
        return std::pow(10.0, y);
    case 6:
        return std::exp2(y);
    case reciprocal:
        return 1.0 / y;
    case 8:
        return y * y;
    case 9:
        return y * y * y;
    case 10:
        return std::sqrt(y);
    case 11:
        return std::cbrt(y);
    default:
        return needsFactors(code) ? y : std::nan("");
    }
}

} // namespace

Factors factorsOf(std::span<const std::uint8_t, factorBytes> bytes)
{
    const auto tenBits = [&](std::size_t at) {
        return signedBits(bytes[at] | (bytes[at + 1] & 0xC0U) << 2U, 10);
    };
    return {.m = tenBits(0),
        .b = tenBits(2),
        .bExponent = signedBits(bytes[5] & 0xFU, 4),
        .resultExponent = signedBits(bytes[5] >> 4U, 4)};
}

std::optional<double> convert(
    std::uint8_t raw, AnalogFormat format, const Factors& factors, Linearization linearization)
{
    const auto x = numberOf(raw, format);
    if (!x)
        return std::nullopt;
    const double value = linearized(scaled(*x, factors), linearization);
    return std::isfinite(value) ? std::optional(value) : std::nullopt;
}

} // namespace Ipmi
