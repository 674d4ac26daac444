// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A point in time or an interval, behind a CMPIDateTime. Immutable.

#pragma once

#include "host/broker/Object.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace Host {

class DateTime : public Encapsulated<DateTime, CMPIDateTime, Object::Kind::dateTime> {
public:
    static DateTime& makeNow(Arena& arena);
    // Microseconds: since 1970-01-01 00:00 UTC, or the length of the interval. Throws Refusal
    // (CMPI_RC_ERR_INVALID_PARAMETER) for what the text form cannot say: a point after the
    // year 9999, an interval of 10^8 days or more.
    static DateTime& make(Arena& arena, std::uint64_t microseconds, bool isInterval);
    // From yyyymmddhhmmss.mmmmmmsutc (s the sign of the offset from UTC, utc its minutes) or
    // ddddddddhhmmss.mmmmmm:000. Throws Refusal (CMPI_RC_ERR_INVALID_PARAMETER) for anything
    // else, asterisks and points before 1970 included.
    static DateTime& parse(Arena& arena, std::string_view text);

    std::uint64_t microseconds() const noexcept { return microseconds_; }
    bool isInterval() const noexcept { return isInterval_; }
    // The form parse reads, with the offset it was parsed with, else UTC.
    std::string toText() const;

    // Itself when it lives there already.
    DateTime& copiedTo(Arena& arena) const;

    static const CMPIDateTimeFT functions;

private:
    friend class Arena;
    DateTime(Arena& home, std::uint64_t microseconds, bool isInterval, int offsetMinutes)
        : Encapsulated(&home), microseconds_(microseconds), isInterval_(isInterval),
          offsetMinutes_(offsetMinutes)
    {
    }

    std::uint64_t microseconds_;
    bool isInterval_;
    int offsetMinutes_;
};

} // namespace Host
