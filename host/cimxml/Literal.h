// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The text form of values in DSP0201.

#pragma once

#include "host/broker/Value.h"

#include <optional>
#include <string>
#include <string_view>

namespace Host {
class Arena;
}

namespace Host::CimXml {

// Returns the type that an attribute TYPE names, in any letter case; nothing for another word.
std::optional<CMPIType> typeNamed(std::string_view word);

// Returns the name of a type, or of the elements of an array type. An embedded instance is a
// string.
std::string nameOf(CMPIType type);

// Reads a value of the type, without white space around it unless it is a text. Returns nothing
// when the text is no value of the type. REQUIRES: the type is simple, and neither reference nor
// instance.
std::optional<Value> readLiteral(Arena& arena, CMPIType type, std::string_view text);

// Reads a number without declared type as uint64, as sint64 where it is negative, as real64 where
// it is no integer. Returns nothing when it is no number.
std::optional<Value> readNumber(Arena& arena, std::string_view text);

// Appends the content of VALUE or KEYVALUE; nothing for a null, an array, a reference or an
// instance.
void appendLiteral(std::string& out, const Value& value);

} // namespace Host::CimXml
