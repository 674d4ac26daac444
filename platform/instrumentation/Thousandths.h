// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmath>
#include <limits>

namespace Vorn {

// Returns a number whose thousandths, truncated, are the whole number that the hardware reported.
// Of some numbers the nearest double lies below: 1200 mV divided by 1000 would be truncated to
// 1199. For these it returns the next double away from zero, for all others, such as computed ones,
// the argument. REQUIRES: the argument is finite.
inline double keepingThousandths(double number)
{
    const double thousandths = std::round(number * 1000.0);
    const bool isNearest = thousandths / 1000.0 == number;
    // Records multiply with this precision.
    const bool fallsShort = std::fabs(number * 1000.0L) < std::fabs(thousandths);
    if (!isNearest || !fallsShort)
        return number;
    return std::nextafter(number, std::copysign(std::numeric_limits<double>::infinity(), number));
}

// Returns the nearest double of whole thousandths for which keepingThousandths() returns the
// argument; the argument if there is none.
inline double plainThousandths(double number)
{
    const double plain = std::round(number * 1000.0) / 1000.0;
    return keepingThousandths(plain) == number ? plain : number;
}

} // namespace Vorn
