// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/LiteralReader.h"

#include "host/repository/MofError.h"

#include <charconv>
#include <limits>
#include <optional>
#include <system_error>

namespace Host {

namespace {

constexpr bool isHighSurrogate(char32_t unit)
{
    return unit >= 0xD800 && unit < 0xDC00;
}

constexpr bool isLowSurrogate(char32_t unit)
{
    return unit >= 0xDC00 && unit < 0xE000;
}

constexpr char byte(char32_t bits)
{
    return static_cast<char>(static_cast<unsigned char>(bits));
}

void appendUtf8(std::string& text, char32_t character)
{
    if (character < 0x80) {
        text += byte(character);
    } else if (character < 0x800) {
        text += byte(0xC0U | (character >> 6U));
        text += byte(0x80U | (character & 0x3FU));
    } else if (character < 0x10000) {
        text += byte(0xE0U | (character >> 12U));
        text += byte(0x80U | ((character >> 6U) & 0x3FU));
        text += byte(0x80U | (character & 0x3FU));
    } else {
        text += byte(0xF0U | (character >> 18U));
        text += byte(0x80U | ((character >> 12U) & 0x3FU));
        text += byte(0x80U | ((character >> 6U) & 0x3FU));
        text += byte(0x80U | (character & 0x3FU));
    }
}

// Reads a quoted text from its beginning to its end.
class TextScanner {
public:
    explicit TextScanner(const QuotedText& quote) : quote_(quote) {}

    bool isAtEnd() const { return at_ == quote_.text.size(); }

    // Appends the next character, which may be two escapes.
    void copyTo(std::string& text)
    {
        if (quote_.text[at_] != '\\') {
            text += quote_.text[at_++];
            return;
        }
        const std::size_t begin = at_;
        char32_t unit = escape();
        if (isHighSurrogate(unit)) {
            const char32_t low = quote_.text.substr(at_, 1) == "\\" ? escape() : 0;
            if (!isLowSurrogate(low))
                fail(begin, "half of a surrogate pair is no character");
            unit = 0x10000 + ((unit - 0xD800) << 10U) + (low - 0xDC00);
        } else if (isLowSurrogate(unit)) {
            fail(begin, "half of a surrogate pair is no character");
        }
        appendUtf8(text, unit);
    }

    // The next UTF-16 unit; nothing when the character takes two.
    std::optional<char16_t> unit()
    {
        if (quote_.text[at_] == '\\')
            return static_cast<char16_t>(escape());
        const auto lead = static_cast<unsigned char>(quote_.text[at_++]);
        if (lead < 0x80)
            return lead;
        if (lead >= 0xF0)
            return std::nullopt;
        char32_t value = lead < 0xE0 ? lead & 0x1FU : lead & 0x0FU;
        for (unsigned more = lead < 0xE0 ? 1 : 2; more > 0; --more)
            value = (value << 6U) | (static_cast<unsigned char>(quote_.text[at_++]) & 0x3FU);
        return static_cast<char16_t>(value);
    }

private:
    [[noreturn]] void fail(std::size_t at, const char* reason) const
    {
        SourcePosition position = quote_.position;
        position.column += static_cast<std::uint32_t>(at);
        throw MofError(position, reason);
    }

    char32_t escape()
    {
        const std::size_t begin = at_++;
        switch (const char code = quote_.text[at_++]) {
        case 'b':
            return '\b';
        case 't':
            return '\t';
        case 'n':
            return '\n';
        case 'f':
            return '\f';
        case 'r':
            return '\r';
        case 'x':
        case 'X':
            return hexadecimal(begin);
        default:
            return static_cast<unsigned char>(code);
        }
    }

    char32_t hexadecimal(std::size_t begin)
    {
        constexpr std::size_t maximumDigits = 4;
        const std::string_view digits = quote_.text.substr(at_, maximumDigits);
        unsigned unit = 0;
        const auto end =
            std::from_chars(digits.data(), digits.data() + digits.size(), unit, 16).ptr;
        at_ += static_cast<std::size_t>(end - digits.data());
        if (unit == 0)
            fail(begin, "the character \\x0 cannot be kept");
        return unit;
    }

    const QuotedText& quote_;
    std::size_t at_ = 0;
};

} // namespace

std::string readText(const std::vector<QuotedText>& pieces)
{
    std::string text;
    for (const QuotedText& piece : pieces)
        for (TextScanner scanner(piece); !scanner.isAtEnd();)
            scanner.copyTo(text);
    return text;
}

Syntax::Character readCharacter(const QuotedText& quote)
{
    const auto unit = TextScanner(quote).unit();
    if (!unit)
        throw MofError(quote.position, "the character does not fit into 16 bits");
    return {*unit};
}

Syntax::Integer readInteger(
    std::string_view signAndDigits, unsigned base, const SourcePosition& position)
{
    Syntax::Integer integer;
    std::string_view digits = signAndDigits;
    if (digits.front() == '+' || digits.front() == '-') {
        integer.isNegative = digits.front() == '-';
        digits.remove_prefix(1);
    }
    const auto result = std::from_chars(
        digits.data(), digits.data() + digits.size(), integer.magnitude, static_cast<int>(base));
    if (result.ec != std::errc())
        throw MofError(position, "the number does not fit into 64 bits");
    return integer;
}

double readReal(std::string_view text, const SourcePosition& position)
{
    if (text.front() == '+')
        text.remove_prefix(1);
    double value = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), value);
    if (result.ec != std::errc())
        throw MofError(position, "the number is too large or too small for a real");
    return value;
}

std::uint32_t readArraySize(std::string_view digits, const SourcePosition& position)
{
    std::uint32_t size = 0;
    const auto result = std::from_chars(digits.data(), digits.data() + digits.size(), size);
    if (result.ec != std::errc() || size == 0)
        throw MofError(position, "an array's size is at least 1 and fits into 32 bits");
    return size;
}

} // namespace Host
