// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Literal.h"

#include "host/broker/DateTime.h"
#include "host/broker/Names.h"
#include "host/broker/Refusal.h"
#include "host/broker/Types.h"
#include "host/cimxml/Characters.h"
#include "host/repository/TypeNames.h"
#include "platform/text/Trim.h"
#include "platform/text/Utf8.h"

#include <array>
#include <charconv>
#include <cmath>
#include <limits>

namespace Host::CimXml {

namespace {

struct Magnitude {
    bool isNegative = false;
    std::uint64_t value = 0;
};

template <typename Number, typename... Base>
bool readsWhole(std::string_view text, Number& number, Base... base)
{
    const char* const end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number, base...);
    return result.ec == std::errc() && result.ptr == end && !text.empty();
}

std::optional<Magnitude> magnitudeOf(std::string_view text)
{
    Magnitude number;
    number.isNegative = text.starts_with('-');
    if (text.starts_with('-') || text.starts_with('+'))
        text.remove_prefix(1);
    const bool isHexadecimal = text.starts_with("0x") || text.starts_with("0X");
    if (isHexadecimal)
        text.remove_prefix(2);
    if (!readsWhole(text, number.value, isHexadecimal ? 16 : 10))
        return std::nullopt;
    return number;
}

std::optional<Value> readInteger(CMPIType type, std::string_view text)
{
    const auto number = magnitudeOf(text);
    if (!number)
        return std::nullopt;
    const auto bits = static_cast<unsigned>(plainSize(type)) * 8;
    const std::uint64_t all = std::numeric_limits<std::uint64_t>::max() >> (64U - bits);
    const std::uint64_t half = all / 2;
    const std::uint64_t most = isUnsignedType(type) ? (number->isNegative ? 0 : all)
                                                    : (number->isNegative ? half + 1 : half);
    if (number->value > most)
        return std::nullopt;
    return Value::integer(type, number->isNegative ? 0 - number->value : number->value);
}

std::optional<Value> readReal(CMPIType type, std::string_view text)
{
    if (text.starts_with('+') && !text.starts_with("+-"))
        text.remove_prefix(1);
    double number = 0;
    if (!readsWhole(text, number))
        return std::nullopt;
    if (type == CMPI_real32 && std::isfinite(number) &&
        std::abs(number) > std::numeric_limits<float>::max())
        return std::nullopt;
    return Value::real(type, number);
}

std::optional<Value> readBoolean(std::string_view text)
{
    if (!equalNames(text, "true") && !equalNames(text, "false"))
        return std::nullopt;
    return Value::boolean(equalNames(text, "true"));
}

std::optional<Value> readCharacter(std::string_view text)
{
    if (text.empty())
        return std::nullopt;
    const Text::Character character = Text::firstCharacter(text);
    if (!character.isValid || character.size != text.size() || character.code > 0xFFFF)
        return std::nullopt;
    return Value::integer(CMPI_char16, character.code);
}

std::optional<Value> readDateTime(Arena& arena, std::string_view text)
{
    try {
        return Value::of(DateTime::parse(arena, text));
    } catch (const Refusal&) {
        return std::nullopt;
    }
}

void appendCharacter(std::string& out, char32_t code)
{
    std::string character;
    Text::appendUtf8(character, isXmlCharacter(code) ? code : Text::replacementCharacter);
    appendEscaped(out, character);
}

template <typename Number>
void appendNumber(std::string& out, Number number)
{
    std::array<char, 32> buffer{};
    const char* const end = std::to_chars(buffer.begin(), buffer.end(), number).ptr;
    out.append(buffer.data(), static_cast<std::size_t>(end - buffer.data()));
}

// Appends the shortest text that converts back to the same number, with the decimal point that
// DSP0004 requires.
template <typename Number>
void appendReal(std::string& out, Number number)
{
    if (std::isnan(number)) {
        out += "NaN";
    } else if (std::isinf(number)) {
        out += number < 0 ? "-INF" : "INF";
    } else {
        const std::size_t begin = out.size();
        appendNumber(out, number);
        if (out.find('.', begin) == std::string::npos)
            out.insert(std::min(out.find('e', begin), out.size()), ".0");
    }
}

} // namespace

std::optional<CMPIType> typeNamed(std::string_view word)
{
    if (equalNames(word, "reference"))
        return CMPI_ref;
    const CMPIType type = dataTypeNamed(word);
    return type == CMPI_null || type == CMPI_ref ? std::nullopt : std::optional(type);
}

std::string nameOf(CMPIType type)
{
    switch (elementType(type)) {
    case CMPI_ref:
        return "reference";
    case CMPI_null:
    case CMPI_instance:
        return "string";
    default:
        return nameOfType(elementType(type));
    }
}

std::optional<Value> readLiteral(Arena& arena, CMPIType type, std::string_view text)
{
    if (isTextType(type))
        return Value::text(arena, text);
    if (type == CMPI_char16)
        return readCharacter(text);
    text = Text::trimmed(text, xmlWhiteSpace);
    if (type == CMPI_boolean)
        return readBoolean(text);
    if (type == CMPI_dateTime)
        return readDateTime(arena, text);
    if (type == CMPI_real32 || type == CMPI_real64)
        return readReal(type, text);
    return readInteger(type, text);
}

std::optional<Value> readNumber(Arena& arena, std::string_view text)
{
    for (const CMPIType type :
        std::initializer_list<CMPIType>{CMPI_uint64, CMPI_sint64, CMPI_real64})
        if (const auto value = readLiteral(arena, type, text))
            return value;
    return std::nullopt;
}

void appendLiteral(std::string& out, const Value& value)
{
    if (value.isNull())
        return;
    switch (value.type()) {
    case CMPI_string:
        return appendEscaped(out, value.text().value_or(""));
    case CMPI_boolean:
        out += *value.boolean() ? "TRUE" : "FALSE";
        return;
    case CMPI_char16:
        return appendCharacter(out, static_cast<char32_t>(*value.unsignedInteger()));
    case CMPI_uint8:
    case CMPI_uint16:
    case CMPI_uint32:
    case CMPI_uint64:
        return appendNumber(out, *value.unsignedInteger());
    case CMPI_sint8:
    case CMPI_sint16:
    case CMPI_sint32:
    case CMPI_sint64:
        return appendNumber(out, *value.signedInteger());
    case CMPI_real32:
        return appendReal(out, static_cast<float>(*value.real()));
    case CMPI_real64:
        return appendReal(out, *value.real());
    case CMPI_dateTime:
        out += value.dateTime()->toText();
        return;
    default:
        return;
    }
}

} // namespace Host::CimXml
