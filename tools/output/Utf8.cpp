// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/Utf8.h"

#include <array>
#include <cstdio>

namespace Tools {

namespace {

constexpr char32_t replacement = 0xFFFD;
constexpr std::string_view replacementBytes = "\xEF\xBF\xBD";
constexpr std::string_view ellipsis = "\xE2\x80\xA6"; // one column wide

// Bytes of the character that begins with this one; 0 for a byte that begins none.
constexpr std::size_t lengthFrom(unsigned char first)
{
    if (first < 0x80)
        return 1;
    if (first >= 0xC2 && first < 0xE0)
        return 2;
    if (first >= 0xE0 && first < 0xF0)
        return 3;
    if (first >= 0xF0 && first < 0xF5)
        return 4;
    return 0;
}

constexpr std::array<char32_t, 5> smallestOfLength = {0, 0, 0x80, 0x800, 0x10000};
constexpr std::array<unsigned, 5> firstByteMask = {0, 0x7F, 0x1F, 0x0F, 0x07};

constexpr bool isCharacter(char32_t value, std::size_t length)
{
    const bool isSurrogate = value >= 0xD800 && value <= 0xDFFF;
    return value >= smallestOfLength[length] && value <= 0x10FFFF && !isSurrogate;
}

// The escape of an unprintable character.
std::string escapeOf(char32_t character)
{
    switch (character) {
    case U'\n':
        return "\\n";
    case U'\r':
        return "\\r";
    case U'\t':
        return "\\t";
    default:
        break;
    }
    std::array<char, 16> text{};
    std::snprintf(text.data(), text.size(), character < 0x80 ? "\\x%02X" : "\\u%04X",
        static_cast<unsigned>(character));
    return text.data();
}

} // namespace

char32_t takeCharacter(std::string_view& text)
{
    const auto byte = [&](std::size_t at) { return static_cast<unsigned char>(text[at]); };
    const std::size_t length = lengthFrom(byte(0));
    char32_t value = length == 0 ? replacement : byte(0) & firstByteMask[length];
    std::size_t taken = 1;
    for (; taken < length && taken < text.size() && (byte(taken) & 0xC0) == 0x80; ++taken)
        value = value << 6 | (byte(taken) & 0x3F);
    if (length == 0 || taken < length || !isCharacter(value, length)) {
        text.remove_prefix(1);
        return replacement;
    }
    text.remove_prefix(length);
    return value;
}

bool isUnprintable(char32_t character)
{
    const auto isWithin = [&](char32_t first, char32_t last) {
        return character >= first && character <= last;
    };
    const bool isControl = character < 0x20 || isWithin(0x7F, 0x9F);
    const bool isSeparator = character == 0x2028 || character == 0x2029;
    const bool isBidirectional = character == 0x061C || isWithin(0x200E, 0x200F) ||
                                 isWithin(0x202A, 0x202E) || isWithin(0x2066, 0x2069);
    return isControl || isSeparator || isBidirectional;
}

std::string printable(std::string_view text)
{
    std::string result;
    result.reserve(text.size());
    while (!text.empty()) {
        const std::string_view before = text;
        const char32_t character = takeCharacter(text);
        if (character == replacement)
            result += replacementBytes;
        else if (isUnprintable(character))
            result += escapeOf(character);
        else
            result += before.substr(0, before.size() - text.size());
    }
    return result;
}

std::size_t displayWidth(std::string_view text)
{
    std::size_t width = 0;
    while (!text.empty())
        width += widthOf(takeCharacter(text));
    return width;
}

std::string cutToWidth(std::string_view text, std::size_t width)
{
    if (displayWidth(text) <= width)
        return std::string(text);
    std::string_view rest = text;
    std::size_t used = 0;
    std::size_t fits = 0; // bytes that fit beside the ellipsis
    while (!rest.empty()) {
        used += widthOf(takeCharacter(rest));
        if (used > width - 1)
            break;
        fits = text.size() - rest.size();
    }
    return std::string(text.substr(0, fits)).append(ellipsis);
}

} // namespace Tools
