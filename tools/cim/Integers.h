// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// CIM integers of any width and sign as one type.

#pragma once

#include "host/broker/Value.h"

#include <cstdint>
#include <limits>
#include <optional>

namespace Tools {

// Nothing for a null, for what is no integer, and for what an int64 cannot hold.
inline std::optional<std::int64_t> integerOf(const Host::Value& value)
{
    if (const auto number = value.signedInteger())
        return number;
    const auto number = value.unsignedInteger();
    if (!number || *number > std::numeric_limits<std::int64_t>::max())
        return std::nullopt;
    return static_cast<std::int64_t>(*number);
}

} // namespace Tools
