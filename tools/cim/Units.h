// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Readings and limits as people write them.

#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace Tools {

// value times ten to the power of modifier, exactly: 12345 with -3 is "12.345", with 2
// "1234500". Powers that would fill the line with zeros are written as "12345e40".
std::string scaled(std::int64_t value, std::int32_t modifier);

// The same, rounded to hundredths (halves away from zero) unless it is less than 1.
std::string scaledToHundredths(std::int64_t value, std::int32_t modifier);

// Without the zeros that end a fraction: "12.500" becomes "12.5", "12.000" "12".
std::string withoutTrailingZeros(std::string number);

// The symbol of a code of CIM_NumericSensor.BaseUnits, such as "°C"; of a code without a common
// symbol the value map's own text; empty for 0, 1 and unknown codes.
std::string_view unitSymbol(std::uint64_t baseUnits);

} // namespace Tools
