// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/JsonText.h"

#include "platform/text/Utf8.h"
#include "tools/output/PrintableText.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace Tools {

namespace {

void appendEscape(std::string& json, char32_t character)
{
    std::array<char, 16> escape{};
    std::snprintf(escape.data(), escape.size(), "\\u%04x", static_cast<unsigned>(character));
    json += escape.data();
}

// Returns the letter that stands for a control character in its short escape; 0 when it has none.
char shortEscape(char32_t character)
{
    switch (character) {
    case '\b':
        return 'b';
    case '\f':
        return 'f';
    case '\n':
        return 'n';
    case '\r':
        return 'r';
    case '\t':
        return 't';
    case '"':
    case '\\':
        return static_cast<char>(character);
    default:
        return 0;
    }
}

} // namespace

void appendString(std::string& json, std::string_view text)
{
    json += '"';
    // Most texts consist of printable ASCII only.
    const auto plain = std::find_if_not(text.begin(), text.end(),
        [](char c) { return c >= ' ' && c <= '~' && c != '"' && c != '\\'; });
    json.append(text.begin(), plain);
    text.remove_prefix(static_cast<std::size_t>(plain - text.begin()));
    while (!text.empty()) {
        const Text::Character character = Text::firstCharacter(text);
        if (const char letter = shortEscape(character.code))
            json.append({'\\', letter});
        else if (Text::isUnprintable(character.code))
            appendEscape(json, character.code);
        else if (character.isValid)
            json += text.substr(0, character.size);
        else
            Text::appendUtf8(json, Text::replacementCharacter);
        text.remove_prefix(character.size);
    }
    json += '"';
}

std::string escapeUnprintable(std::string_view json)
{
    constexpr char32_t lastOfAscii = 0x7E;
    std::string result;
    result.reserve(json.size());
    while (!json.empty()) {
        const Text::Character character = Text::firstCharacter(json);
        if (character.code <= lastOfAscii || !Text::isUnprintable(character.code))
            result += json.substr(0, character.size);
        else
            appendEscape(result, character.code);
        json.remove_prefix(character.size);
    }
    return result;
}

} // namespace Tools
