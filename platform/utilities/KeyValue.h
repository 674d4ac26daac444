// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The value of an object path's key, free of the many ways in which a broker can hand it over.

#pragma once

#include <cmpidt.h>

#include <cstdint>
#include <string_view>
#include <variant>

namespace Vorn {

// An integer of any width and signedness.
struct KeyInteger {
    bool isNegative;
    std::uint64_t bits; // of a negative one in two's complement

    bool operator==(const KeyInteger&) const = default;
};

// There is no value.
struct KeyAbsent {};

// There is one, of a type that no key can have, or one the broker marked as bad.
struct KeyUnusable {};

// Texts and paths belong to the broker and live as long as the value they were taken from.
using KeyValue = std::variant<KeyAbsent, KeyUnusable, bool, char16_t, KeyInteger, double,
    std::string_view, const CMPIObjectPath*>;

// Follows no pointer that the value's type and state do not vouch for.
KeyValue keyValue(const CMPIData& data);

// The characters of a broker's string; an empty view with a null pointer when there are none.
std::string_view textOf(CMPIString* string);

} // namespace Vorn
