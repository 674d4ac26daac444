// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A point in time or an interval as DSP0004 writes it, behind a CMPIDateTime. It is immutable.

#pragma once

#include "host/broker/Object.h"

#include <string>
#include <string_view>

namespace Host {

class DateTime : public Encapsulated<DateTime, CMPIDateTime, Object::Kind::dateTime> {
public:
    // Reads yyyymmddhhmmss.mmmmmmsutc (s the sign of the offset from UTC, utc its minutes) or
    // ddddddddhhmmss.mmmmmm:000. Throws Refusal (CMPI_RC_ERR_INVALID_PARAMETER) for anything
    // else, fields of asterisks included.
    static DateTime& parse(Arena& arena, std::string_view text);

    std::string toText() const { return std::string(text_); }

    static const CMPIDateTimeFT functions;

private:
    friend class Arena;
    explicit DateTime(std::string_view text) : text_(text) {}

    std::string_view text_;
};

} // namespace Host
