// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/Units.h"

#include "tools/cim/ValueMaps.h"

#include <algorithm>
#include <array>

namespace Tools {

namespace {

constexpr std::int32_t largestShift = 18; // digits a 64-bit number can have

struct Symbol {
    std::uint64_t code;
    std::string_view text;
};

constexpr std::array symbols = {Symbol{2, "°C"}, Symbol{3, "°F"}, Symbol{4, "K"}, Symbol{5, "V"},
    Symbol{6, "A"}, Symbol{7, "W"}, Symbol{8, "J"}, Symbol{9, "C"}, Symbol{10, "VA"},
    Symbol{15, "kPa"}, Symbol{19, "RPM"}, Symbol{20, "Hz"}, Symbol{21, "s"}, Symbol{65, "%"},
    Symbol{66, "Pa"}};

constexpr std::uint64_t firstNamedUnit = 2; // 0 is "Unknown", 1 is "Other"

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
    const auto symbol = std::find_if(symbols.begin(), symbols.end(),
        [&](const Symbol& candidate) { return candidate.code == baseUnits; });
    if (symbol != symbols.end())
        return symbol->text;
    return baseUnits < firstNamedUnit ? std::string_view{} : meaningOf("BaseUnits", baseUnits);
}

} // namespace Tools
