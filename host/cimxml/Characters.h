// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <string_view>

namespace Host::CimXml {

inline constexpr std::string_view xmlWhiteSpace = " \t\n\r";

// Returns whether the code point is a Char of XML 1.0.
constexpr bool isXmlCharacter(char32_t code)
{
    if (code < 0x20)
        return code == '\t' || code == '\n' || code == '\r';
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    return !isSurrogate && code != 0xFFFE && code != 0xFFFF && code <= 0x10FFFF;
}

// Appends the text as the content of an element or an attribute: with the five predefined
// entities, and U+FFFD for what XML cannot hold and for bytes that are no UTF-8. Clients read a
// carriage return as the end of a line, since not all of them understand the numeric reference
// that would keep it.
void appendEscaped(std::string& out, std::string_view text);

} // namespace Host::CimXml
