// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// UTF-8 and the characters that XML can hold.

#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Host::CimXml {

struct Character {
    char32_t code = 0;
    std::size_t size = 0; // in bytes
    bool isValid = false;
};

// The first character of the text, which is not empty. Bytes that are no character count as an
// invalid one of one byte.
Character firstCharacter(std::string_view text);

// Whether XML 1.0 can hold the character.
bool isXmlCharacter(char32_t code);

void appendUtf8(std::string& out, char32_t code);

// As the content of an element or an attribute: with the five named entities, U+FFFD for what
// XML cannot hold and for bytes that are no UTF-8. Clients read a carriage return as the end of a
// line, since numeric references, which would keep it, are not understood by all of them.
void appendEscaped(std::string& out, std::string_view text);

// Without the white space of XML at its ends.
std::string_view trimmed(std::string_view text);

constexpr bool isWhiteSpace(char c)
{
    return c == ' ' || c == '\t' || c == '\n' || c == '\r';
}

} // namespace Host::CimXml
