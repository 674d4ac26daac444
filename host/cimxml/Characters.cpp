// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Characters.h"

#include <array>

namespace Host::CimXml {

namespace {

constexpr char32_t replacement = 0xFFFD;

constexpr Character invalidCharacter{replacement, 1, false};

constexpr unsigned byteAt(std::string_view text, std::size_t at)
{
    return static_cast<unsigned char>(text[at]);
}

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

// For each byte whether it is printable ASCII without an entity: what nearly all texts consist of.
constexpr std::array<bool, 256> plainBytes = [] {
    std::array<bool, 256> plain{};
    for (unsigned byte = ' '; byte <= '~'; ++byte)
        plain[byte] = entityFor(static_cast<char>(byte)).empty();
    return plain;
}();

std::size_t countPlain(std::string_view text)
{
    std::size_t count = 0;
    while (count < text.size() && plainBytes[byteAt(text, count)])
        ++count;
    return count;
}

} // namespace

Character firstCharacter(std::string_view text)
{
    const unsigned lead = byteAt(text, 0);
    if (lead < 0x80)
        return {lead, 1, true};
    if (lead < 0xC2 || lead > 0xF4)
        return invalidCharacter;
    const std::size_t size = lead < 0xE0 ? 2 : lead < 0xF0 ? 3 : 4;
    if (text.size() < size)
        return invalidCharacter;
    char32_t code = lead & (0x7FU >> size);
    for (std::size_t at = 1; at < size; ++at) {
        if ((byteAt(text, at) & 0xC0U) != 0x80U)
            return invalidCharacter;
        code = code << 6U | (byteAt(text, at) & 0x3FU);
    }
    const bool isOverlong = (size == 3 && code < 0x800) || (size == 4 && code < 0x10000);
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    if (isOverlong || isSurrogate || code > 0x10FFFF)
        return invalidCharacter;
    return {code, size, true};
}

bool isXmlCharacter(char32_t code)
{
    if (code < 0x20)
        return code == '\t' || code == '\n' || code == '\r';
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    return !isSurrogate && code != 0xFFFE && code != 0xFFFF && code <= 0x10FFFF;
}

void appendUtf8(std::string& out, char32_t code)
{
    const auto put = [&out](char32_t byte) { out += static_cast<char>(byte); };
    const auto continuation = [&](unsigned shift) { put(0x80U | (code >> shift & 0x3FU)); };
    if (code < 0x80) {
        put(code);
    } else if (code < 0x800) {
        put(0xC0U | code >> 6U);
        continuation(0);
    } else if (code < 0x10000) {
        put(0xE0U | code >> 12U);
        continuation(6);
        continuation(0);
    } else {
        put(0xF0U | code >> 18U);
        continuation(12);
        continuation(6);
        continuation(0);
    }
}

void appendEscaped(std::string& out, std::string_view text)
{
    for (;;) {
        const std::size_t plain = countPlain(text);
        out += text.substr(0, plain);
        text.remove_prefix(plain);
        if (text.empty())
            return;
        const Character character = firstCharacter(text);
        const std::string_view entity = entityFor(text.front());
        if (!entity.empty())
            out += entity;
        else if (character.isValid && isXmlCharacter(character.code))
            out += text.substr(0, character.size);
        else
            appendUtf8(out, replacement);
        text.remove_prefix(character.size);
    }
}

std::string_view trimmed(std::string_view text)
{
    while (!text.empty() && isWhiteSpace(text.front()))
        text.remove_prefix(1);
    while (!text.empty() && isWhiteSpace(text.back()))
        text.remove_suffix(1);
    return text;
}

} // namespace Host::CimXml
