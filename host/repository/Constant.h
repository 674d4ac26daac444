// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A value written in MOF: of a qualifier, or the default of a property.

#pragma once

#include <cstdint>
#include <string>
#include <variant>
#include <vector>

namespace Host {

// Null, boolean, signed integer, unsigned integer or string.
using Scalar = std::variant<std::monostate, bool, std::int64_t, std::uint64_t, std::string>;

// Fits the CIM type of the declaration it belongs to: a list exactly when that is an array,
// or a null instead.
using Constant = std::variant<Scalar, std::vector<Scalar>>;

inline bool isNull(const Scalar& value) noexcept
{
    return std::holds_alternative<std::monostate>(value);
}

inline bool isNull(const Constant& value) noexcept
{
    const Scalar* const scalar = std::get_if<Scalar>(&value);
    return scalar != nullptr && isNull(*scalar);
}

} // namespace Host
