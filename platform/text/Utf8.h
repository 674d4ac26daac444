// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// UTF-8 as RFC 3629 defines it: overlong forms, surrogates and numbers above U+10FFFF are not
// characters.

#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Text {

inline constexpr char32_t replacementCharacter = 0xFFFD;

struct Character {
    char32_t code = replacementCharacter;
    std::size_t size = 1; // in bytes
    bool isValid = false;
};

// Decodes the first character of a text that is not empty. A byte that begins no character counts
// as an invalid character of one byte, U+FFFD.
Character firstCharacter(std::string_view text);

// Appends a code point; U+FFFD for a number that is none.
void appendUtf8(std::string& out, char32_t code);

// Returns whether the character controls a terminal or the order of its neighbours: controls, line
// and paragraph separators, bidirectional controls.
bool isUnprintable(char32_t character);

// Returns the text with U+FFFD for each byte that belongs to no character.
std::string toValidUtf8(std::string_view text);

// Returns the beginning of the text in at most that many bytes, without part of a character at its
// end. It may be shorter still where the text is not valid UTF-8.
std::string_view cutAtCharacter(std::string_view text, std::size_t maximumBytes);

} // namespace Text
