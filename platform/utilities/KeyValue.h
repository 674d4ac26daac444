// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The value of an object path's key, whatever CMPI type the broker represents it by.

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

// The key has no value.
struct KeyAbsent {};

// The key has a value of a type that no key can have, or one that the broker marked as bad.
struct KeyUnusable {};

// Texts and paths belong to the broker and live as long as the CMPIData they were read from.
using KeyValue = std::variant<KeyAbsent, KeyUnusable, bool, char16_t, KeyInteger, double,
    std::string_view, const CMPIObjectPath*>;

// Converts a key's value. Dereferences a pointer only where the type and the state of the value say
// that there is one.
KeyValue keyValue(const CMPIData& data);

// Returns the characters of a broker's string; an empty view with a null pointer when there are
// none.
std::string_view textOf(CMPIString* string);

} // namespace Vorn
