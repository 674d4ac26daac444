// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Values as the protocol spells them.

#pragma once

#include "host/broker/Value.h"

#include <optional>
#include <string>
#include <string_view>

namespace Host {
class Arena;
}

namespace Host::CimXml {

// The type that an attribute TYPE or PARAMTYPE names, without regard to letter case; nothing for
// a word that is none.
std::optional<CMPIType> typeNamed(std::string_view word);

// The word for a type or its elements. An embedded instance is a string.
std::string nameOf(CMPIType type);

// White space around a value that is no text counts for nothing. Nothing when the text is no
// value of the type. REQUIRES: the type is simple, and neither reference nor instance.
std::optional<Value> readLiteral(Arena& arena, CMPIType type, std::string_view text);

// The least wide type that says what a number without declared type says: uint64, sint64 where
// it is negative, real64 where it is no integer. Nothing when it is no number.
std::optional<Value> readNumber(Arena& arena, std::string_view text);

// As the content of VALUE or KEYVALUE. Nothing for a null, an array, a reference or an instance.
void appendLiteral(std::string& out, const Value& value);

} // namespace Host::CimXml
