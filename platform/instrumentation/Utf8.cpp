// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Utf8.h"

#include <array>
#include <cstddef>

namespace Vorn {

namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD"; // U+FFFD

// Well-formed sequences by their first byte, with the range of the second byte, which rules
// out overlong forms, surrogates and code points that do not exist (Unicode, table 3-7).
struct Sequence {
    unsigned char firstLow, firstHigh, secondLow, secondHigh;
    std::size_t length;
};
constexpr std::array<Sequence, 8> sequences{{
    {0xC2, 0xDF, 0x80, 0xBF, 2},
    {0xE0, 0xE0, 0xA0, 0xBF, 3},
    {0xE1, 0xEC, 0x80, 0xBF, 3},
    {0xED, 0xED, 0x80, 0x9F, 3},
    {0xEE, 0xEF, 0x80, 0xBF, 3},
    {0xF0, 0xF0, 0x90, 0xBF, 4},
    {0xF1, 0xF3, 0x80, 0xBF, 4},
    {0xF4, 0xF4, 0x80, 0x8F, 4},
}};

unsigned char byteAt(std::string_view text, std::size_t at)
{
    return static_cast<unsigned char>(text[at]);
}

bool fits(std::string_view text, const Sequence& sequence)
{
    if (text.size() < sequence.length || byteAt(text, 1) < sequence.secondLow ||
        byteAt(text, 1) > sequence.secondHigh)
        return false;
    for (std::size_t at = 2; at < sequence.length; ++at)
        if ((byteAt(text, at) & 0xC0U) != 0x80U)
            return false;
    return true;
}

// The length of the character that the text begins with; 0 when it begins with none.
std::size_t characterLength(std::string_view text)
{
    const unsigned char first = byteAt(text, 0);
    if (first < 0x80)
        return 1;
    for (const Sequence& sequence : sequences)
        if (first >= sequence.firstLow && first <= sequence.firstHigh)
            return fits(text, sequence) ? sequence.length : 0;
    return 0;
}

} // namespace

std::string toValidUtf8(std::string_view text)
{
    std::string valid;
    valid.reserve(text.size());
    while (!text.empty()) {
        const std::size_t length = characterLength(text);
        valid += length == 0 ? replacement : text.substr(0, length);
        text.remove_prefix(length == 0 ? 1 : length);
    }
    return valid;
}

std::string_view trimBlanks(std::string_view text)
{
    constexpr std::string_view blanks = " \t\n\v\f\r";
    const std::size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

std::string escapeControls(std::string_view text)
{
    constexpr std::string_view digits = "0123456789abcdef";
    std::string printable;
    printable.reserve(text.size());
    for (const char character : text) {
        const auto code = static_cast<unsigned char>(character);
        if (code >= 0x20 && code != 0x7F)
            printable += character;
        else
            printable.append("\\x").append(1, digits[code >> 4U]).append(1, digits[code & 0xFU]);
    }
    return printable;
}

} // namespace Vorn
