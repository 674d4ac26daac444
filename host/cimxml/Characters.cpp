// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Characters.h"

#include "platform/text/Utf8.h"

#include <array>

namespace Host::CimXml {

namespace {

constexpr std::string_view entityFor(char c)
{
    switch (c) {
    case '&':
        return "&amp;";
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '"':
        return "&quot;";
    case '\'':
        return "&apos;";
    default:
        return {};
    }
}

// Holds for each byte whether it is printable ASCII that needs no entity, as nearly all bytes are.
constexpr std::array<bool, 256> plainBytes = [] {
    std::array<bool, 256> plain{};
    for (unsigned byte = ' '; byte <= '~'; ++byte)
        plain[byte] = entityFor(static_cast<char>(byte)).empty();
    return plain;
}();

std::size_t countPlain(std::string_view text)
{
    std::size_t count = 0;
    while (count < text.size() && plainBytes[static_cast<unsigned char>(text[count])])
        ++count;
    return count;
}

} // namespace

void appendEscaped(std::string& out, std::string_view text)
{
    for (;;) {
        const std::size_t plain = countPlain(text);
        out += text.substr(0, plain);
        text.remove_prefix(plain);
        if (text.empty())
            return;
        const Text::Character character = Text::firstCharacter(text);
        const std::string_view entity = entityFor(text.front());
        if (!entity.empty())
            out += entity;
        else if (character.isValid && isXmlCharacter(character.code))
            out += text.substr(0, character.size);
        else
            Text::appendUtf8(out, Text::replacementCharacter);
        text.remove_prefix(character.size);
    }
}

} // namespace Host::CimXml
