// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// From the raw byte of an analog sensor to a number in its unit (IPMI 2.0, section 36.3).

#pragma once

#include <cstdint>
#include <optional>
#include <span>

namespace Ipmi {

// How the raw byte represents a number.
enum class AnalogFormat : std::uint8_t {
    unsignedNumber = 0,
    onesComplement = 1,
    twosComplement = 2,
    none = 3, // the sensor has no analog reading
};

// The factors of y = L((M x + B 10^Bexp) 10^Rexp).
struct Factors {
    int m = 1;
    int b = 0;
    int bExponent = 0;
    int resultExponent = 0;

    bool operator==(const Factors&) const = default;
};

// The size of the factors in a sensor data record and in the answer to Get Sensor Reading Factors.
inline constexpr std::size_t factorBytes = 6;

Factors factorsOf(std::span<const std::uint8_t, factorBytes> bytes);

// The codes of linearisation: 0 linear, 1 to 11 a function, from 0x70 factors that depend on the
// raw reading.
using Linearization = std::uint8_t;
inline constexpr Linearization linear = 0;
inline constexpr Linearization reciprocal = 7;

// Returns whether the code is reserved: nothing is known of the number then.
constexpr bool isReserved(Linearization code)
{
    constexpr Linearization cubeRoot = 11;
    return code > cubeRoot && code < 0x70;
}

// Returns whether the factors have to be requested for each raw reading.
constexpr bool needsFactors(Linearization code)
{
    return code >= 0x70;
}

// Returns nothing where there is no finite number: for 1/x of 0, for the logarithm of a negative
// number, for a sensor without an analog reading and for a reserved linearisation.
std::optional<double> convert(
    std::uint8_t raw, AnalogFormat format, const Factors& factors, Linearization linearization);

} // namespace Ipmi
