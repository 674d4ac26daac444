// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/PrintableText.h"

#include "platform/text/Escape.h"
#include "platform/text/Utf8.h"

#include <array>
#include <cstdio>

namespace Tools {

namespace {

// Both are one column wide.
constexpr std::string_view ellipsis = "\xE2\x80\xA6";
constexpr std::string_view asciiEllipsis = "~";

constexpr char32_t lastOfAscii = 0x7E; // the last printable one
constexpr char32_t degreeSign = 0xB0;

// Returns the escape of an unprintable character.
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

std::string printable(std::string_view text, bool isUtf8)
{
    if (Text::isPrintableAscii(text))
        return std::string(text);
    std::string result;
    result.reserve(text.size());
    while (!text.empty()) {
        const Text::Character character = Text::firstCharacter(text);
        const bool isForeign = !isUtf8 && character.code > lastOfAscii;
        if (Text::isUnprintable(character.code) || (isForeign && character.code != degreeSign))
            result += escapeOf(character.code);
        else if (!character.isValid)
            Text::appendUtf8(result, Text::replacementCharacter);
        else if (!isForeign)
            result += text.substr(0, character.size);
        text.remove_prefix(character.size);
    }
    return result;
}

std::size_t displayWidth(std::string_view text)
{
    if (Text::isPrintableAscii(text))
        return text.size();
    std::size_t width = 0;
    while (!text.empty()) {
        const Text::Character character = Text::firstCharacter(text);
        width += widthOf(character.code);
        text.remove_prefix(character.size);
    }
    return width;
}

std::string cutToWidth(std::string_view text, std::size_t width, bool isUtf8)
{
    if (displayWidth(text) <= width)
        return std::string(text);
    std::size_t used = 0;
    std::size_t fits = 0; // bytes that fit beside the ellipsis
    for (;;) {
        const Text::Character character = Text::firstCharacter(text.substr(fits));
        used += widthOf(character.code);
        if (used > width - 1)
            break;
        fits += character.size;
    }
    return std::string(text.substr(0, fits)).append(isUtf8 ? ellipsis : asciiEllipsis);
}

} // namespace Tools
