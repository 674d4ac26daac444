// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/DateTime.h"

#include "host/broker/Slot.h"
#include "host/broker/String.h"

#include <charconv>
#include <chrono>

namespace Host {

namespace {

// Returns whether digits and separators stand where DSP0004, section 5.2.4, has them. A colon in
// place of the sign marks an interval.
bool hasForm(std::string_view text)
{
    constexpr std::string_view form = "00000000000000.000000+000";
    if (text.size() != form.size())
        return false;
    for (std::size_t i = 0; i < form.size(); ++i) {
        const bool isDigit = text[i] >= '0' && text[i] <= '9';
        const bool isSign = text[i] == '+' || text[i] == '-' || text[i] == ':';
        if (form[i] == '0' ? !isDigit : form[i] == '+' ? !isSign : text[i] != form[i])
            return false;
    }
    return true;
}

// Returns the number at the position. REQUIRES: its characters are digits.
int number(std::string_view text, std::size_t position, std::size_t digits)
{
    int value = 0;
    std::from_chars(text.data() + position, text.data() + position + digits, value);
    return value;
}

bool isDateTime(std::string_view text)
{
    if (!hasForm(text))
        return false;
    if (number(text, 8, 2) > 23 || number(text, 10, 2) > 59 || number(text, 12, 2) > 59)
        return false;
    if (text[21] == ':')
        return number(text, 22, 3) == 0;
    const std::chrono::year_month_day date{std::chrono::year(number(text, 0, 4)),
        std::chrono::month(static_cast<unsigned>(number(text, 4, 2))),
        std::chrono::day(static_cast<unsigned>(number(text, 6, 2)))};
    return date.ok();
}

} // namespace

DateTime& DateTime::parse(Arena& arena, std::string_view text)
{
    if (!isDateTime(text))
        throw Refusal(CMPI_RC_ERR_INVALID_PARAMETER, "not a date-time: " + std::string(text));
    return arena.make<DateTime>(arena.text(text));
}

const CMPIDateTimeFT DateTime::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .getBinaryFormat = notOffered,
    .getStringFormat = slot<+[](const DateTime& time) -> const String& {
        return String::make(Arena::required(), time.text_);
    }>,
    .isInterval = notOffered,
};

} // namespace Host
