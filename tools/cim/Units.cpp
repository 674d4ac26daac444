// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/Units.h"

#include <array>

namespace Tools {

namespace {

constexpr std::int32_t largestShift = 18; // digits a 64-bit number can have

// The index of each is its code in the value map of CIM_NumericSensor.BaseUnits. It has the map's
// text where there is no common symbol.
constexpr std::array<std::string_view, 67> units = {"", "", "°C", "°F", "K", "V", "A", "W", "J",
    "C", "VA", "Nits", "Lumens", "Lux", "Candelas", "kPa", "PSI", "Newtons", "CFM", "RPM", "Hz",
    "s", "Minutes", "Hours", "Days", "Weeks", "Mils", "Inches", "Feet", "Cubic Inches",
    "Cubic Feet", "Meters", "Cubic Centimeters", "Cubic Meters", "Liters", "Fluid Ounces",
    "Radians", "Steradians", "Revolutions", "Cycles", "Gravities", "Ounces", "Pounds",
    "Foot-Pounds", "Ounce-Inches", "Gauss", "Gilberts", "Henries", "Farads", "Ohms", "Siemens",
    "Moles", "Becquerels", "PPM (parts/million)", "Decibels", "DbA", "DbC", "Grays", "Sieverts",
    "Color Temperature Degrees K", "Bits", "Bytes", "Words (data)", "DoubleWords", "QuadWords", "%",
    "Pa"};

} // namespace

std::string scaled(std::int64_t value, std::int32_t modifier)
{
    if (modifier > largestShift || modifier < -largestShift)
        return std::to_string(value) + "e" + std::to_string(modifier);
    std::string digits = std::to_string(value);
    if (modifier >= 0)
        return value == 0 ? digits : digits.append(static_cast<std::size_t>(modifier), '0');
    const std::size_t sign = value < 0 ? 1 : 0;
    const auto decimals = static_cast<std::size_t>(-modifier);
    if (digits.size() - sign <= decimals)
        digits.insert(sign, decimals + 1 - (digits.size() - sign), '0');
    return digits.insert(digits.size() - decimals, 1, '.');
}

std::string scaledToHundredths(std::int64_t value, std::int32_t modifier)
{
    std::int64_t rounded = value;
    std::int32_t power = modifier;
    std::int64_t rest = 0; // the digit that was dropped last
    for (; power < -2 && rounded != 0; ++power) {
        rest = rounded % 10;
        rounded /= 10;
    }
    const bool isBelowOne = rounded > -100 && rounded < 100;
    if (modifier >= -2 || modifier < -largestShift || isBelowOne)
        return scaled(value, modifier);
    return scaled(rounded + (rest >= 5 ? 1 : rest <= -5 ? -1 : 0), power);
}

std::string withoutTrailingZeros(std::string number)
{
    if (number.find('.') == std::string::npos || number.find('e') != std::string::npos)
        return number;
    number.erase(number.find_last_not_of('0') + 1);
    if (number.back() == '.')
        number.pop_back();
    return number;
}

std::string_view unitSymbol(std::uint64_t baseUnits)
{
    return baseUnits < units.size() ? units.at(static_cast<std::size_t>(baseUnits)) : "";
}

} // namespace Tools
