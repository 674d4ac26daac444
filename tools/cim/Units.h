// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Readings and limits in decimal notation, and symbols of units.

#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace Tools {

// Returns value times ten to the power of modifier, exactly: 12345 with -3 is "12.345", with 2
// "1234500". Beyond 18 digits the power is written as in "12345e40".
std::string scaled(std::int64_t value, std::int32_t modifier);

// Does the same, rounded to hundredths (halves away from zero) unless it is less than 1.
std::string scaledToHundredths(std::int64_t value, std::int32_t modifier);

// Removes the zeros that end a fraction: "12.500" becomes "12.5", "12.000" "12".
std::string withoutTrailingZeros(std::string number);

// Returns the symbol of a code of CIM_NumericSensor.BaseUnits, such as "°C"; for a code without a
// common symbol the text of the value map; an empty text for 0, 1 and unknown codes.
std::string_view unitSymbol(std::uint64_t baseUnits);

} // namespace Tools
