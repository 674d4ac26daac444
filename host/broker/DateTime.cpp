// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/DateTime.h"

#include "host/broker/Slot.h"
#include "host/broker/String.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>

namespace Host {

namespace {

using std::chrono::sys_days;

constexpr std::size_t textLength = 25;
constexpr std::uint64_t perSecond = 1'000'000;
constexpr std::uint64_t perDay = 86'400 * perSecond;
constexpr std::uint64_t intervalLimit = 100'000'000 * perDay;
constexpr std::uint64_t pointLimit = static_cast<std::uint64_t>(
    std::chrono::microseconds(sys_days(std::chrono::year(10000) / 1 / 1).time_since_epoch())
        .count());

[[noreturn]] void refuse(const std::string& what)
{
    throw Refusal(CMPI_RC_ERR_INVALID_PARAMETER, what);
}

// Reads fields of digits off a text from the left.
class Fields {
public:
    explicit Fields(std::string_view text) : text_(text), rest_(text) {}

    std::uint64_t number(std::size_t digits, std::uint64_t limit)
    {
        std::uint64_t value = 0;
        for (const char c : rest_.substr(0, digits)) {
            if (c < '0' || c > '9')
                fail();
            value = value * 10 + static_cast<std::uint64_t>(c - '0');
        }
        if (value >= limit)
            fail();
        rest_.remove_prefix(digits);
        return value;
    }

    char character(std::string_view allowed)
    {
        const char c = rest_.front();
        if (allowed.find(c) == std::string_view::npos)
            fail();
        rest_.remove_prefix(1);
        return c;
    }

    [[noreturn]] void fail() const { refuse("not a date-time: " + std::string(text_)); }

private:
    std::string_view text_;
    std::string_view rest_;
};

// hhmmss.mmmmmm
std::uint64_t timeOfDay(Fields& fields)
{
    const std::uint64_t hours = fields.number(2, 24);
    const std::uint64_t minutes = fields.number(2, 60);
    const std::uint64_t seconds = fields.number(2, 60);
    fields.character(".");
    return ((hours * 60 + minutes) * 60 + seconds) * perSecond + fields.number(6, perSecond);
}

std::uint64_t date(Fields& fields)
{
    const auto year = static_cast<int>(fields.number(4, 10000));
    const auto month = static_cast<unsigned>(fields.number(2, 13));
    const auto day = static_cast<unsigned>(fields.number(2, 32));
    const auto days = std::chrono::year(year) / std::chrono::month(month) / std::chrono::day(day);
    if (!days.ok() || days.year() < std::chrono::year(1970))
        fields.fail();
    return static_cast<std::uint64_t>(sys_days(days).time_since_epoch().count()) * perDay;
}

} // namespace

DateTime& DateTime::makeNow(Arena& arena)
{
    const auto now = std::chrono::system_clock::now().time_since_epoch();
    const auto count = std::chrono::duration_cast<std::chrono::microseconds>(now).count();
    return make(arena, static_cast<std::uint64_t>(std::max<std::int64_t>(count, 0)), false);
}

DateTime& DateTime::make(Arena& arena, std::uint64_t microseconds, bool isInterval)
{
    if (microseconds >= (isInterval ? intervalLimit : pointLimit))
        refuse(std::to_string(microseconds) + " microseconds are beyond a date-time's range");
    return arena.make<DateTime>(arena, microseconds, isInterval, 0);
}

DateTime& DateTime::parse(Arena& arena, std::string_view text)
{
    Fields fields(text);
    if (text.size() != textLength)
        fields.fail();
    if (text[21] == ':') {
        const std::uint64_t days = fields.number(8, 100'000'000);
        const std::uint64_t time = timeOfDay(fields);
        fields.character(":");
        fields.number(3, 1);
        return arena.make<DateTime>(arena, days * perDay + time, true, 0);
    }
    const std::uint64_t day = date(fields);
    const std::uint64_t time = timeOfDay(fields);
    const bool isEast = fields.character("+-") == '+';
    const std::uint64_t minutes = fields.number(3, 1000);
    const std::uint64_t offset = minutes * 60 * perSecond;
    const std::uint64_t local = day + time;
    if (isEast && offset > local)
        fields.fail();
    const int offsetMinutes = static_cast<int>(minutes) * (isEast ? 1 : -1);
    return arena.make<DateTime>(
        arena, isEast ? local - offset : local + offset, false, offsetMinutes);
}

std::string DateTime::toText() const
{
    const std::uint64_t local =
        microseconds_ + static_cast<std::uint64_t>(offsetMinutes_) * 60 * perSecond;
    const std::uint64_t days = local / perDay;
    const std::uint64_t seconds = local % perDay / perSecond;
    std::array<char, 16> time{};
    std::snprintf(time.data(), time.size(), "%02u%02u%02u.%06u",
        static_cast<unsigned>(seconds / 3600), static_cast<unsigned>(seconds / 60 % 60),
        static_cast<unsigned>(seconds % 60), static_cast<unsigned>(local % perSecond));
    std::array<char, 48> text{};
    if (isInterval_) {
        std::snprintf(text.data(), text.size(), "%08llu%s:000",
            static_cast<unsigned long long>(days), time.data());
    } else {
        const std::chrono::year_month_day date{
            sys_days(std::chrono::days(static_cast<std::int64_t>(days)))};
        std::snprintf(text.data(), text.size(), "%04d%02u%02u%s%+04d",
            static_cast<int>(date.year()), static_cast<unsigned>(date.month()),
            static_cast<unsigned>(date.day()), time.data(), offsetMinutes_);
    }
    return text.data();
}

DateTime& DateTime::copiedTo(Arena& arena) const
{
    if (home_ == &arena)
        return const_cast<DateTime&>(*this);
    return arena.make<DateTime>(arena, microseconds_, isInterval_, offsetMinutes_);
}

const CMPIDateTimeFT DateTime::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&DateTime::release>,
    .clone = slot<&DateTime::cloned>,
    .getBinaryFormat = slot<&DateTime::microseconds>,
    .getStringFormat = slot<+[](const DateTime& time) -> const String& {
        return String::make(Arena::required(), time.toText());
    }>,
    .isInterval = slot<&DateTime::isInterval>,
};

} // namespace Host
