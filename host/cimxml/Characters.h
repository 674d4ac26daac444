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

// Appends the text as the content of an element or an attribute: with the five predefined entities,
// and U+FFFD for characters that XML does not permit and bytes that are not UTF-8. A carriage
// return is written as it is, which parsers normalise to a line feed, since not all clients support
// the numeric reference that would preserve it.
void appendEscaped(std::string& out, std::string_view text);

} // namespace Host::CimXml
