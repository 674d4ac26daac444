// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Words.h"

#include "host/broker/Names.h"
#include "host/broker/Types.h"

#include <array>

namespace Host {

namespace {

template <typename Meaning>
struct Word {
    std::string_view text;
    Meaning meaning;
};

constexpr std::array<Word<CMPIType>, 15> dataTypeWords = {{
    {"uint8", CMPI_uint8},
    {"uint16", CMPI_uint16},
    {"uint32", CMPI_uint32},
    {"uint64", CMPI_uint64},
    {"sint8", CMPI_sint8},
    {"sint16", CMPI_sint16},
    {"sint32", CMPI_sint32},
    {"sint64", CMPI_sint64},
    {"real32", CMPI_real32},
    {"real64", CMPI_real64},
    {"boolean", CMPI_boolean},
    {"string", CMPI_string},
    {"char16", CMPI_char16},
    {"datetime", CMPI_dateTime},
    {"ref", CMPI_ref},
}};

constexpr std::array<Word<Scope>, 10> scopeWords = {{
    {"schema", Scope::schema},
    {"class", Scope::classes},
    {"association", Scope::association},
    {"indication", Scope::indication},
    {"qualifier", Scope::qualifier},
    {"property", Scope::property},
    {"reference", Scope::reference},
    {"method", Scope::method},
    {"parameter", Scope::parameter},
    {"any", Scope::any},
}};

constexpr std::array<Word<FlavorChange>, 5> flavorWords = {{
    {"EnableOverride", FlavorChange::enableOverride},
    {"DisableOverride", FlavorChange::disableOverride},
    {"ToSubclass", FlavorChange::toSubclass},
    {"Restricted", FlavorChange::restricted},
    {"Translatable", FlavorChange::translatable},
}};

template <typename Words, typename Meaning>
Meaning meaningOf(const Words& words, std::string_view text, Meaning otherwise)
{
    for (const auto& word : words)
        if (equalNames(word.text, text))
            return word.meaning;
    return otherwise;
}

template <typename Words, typename Meaning>
std::string_view textOf(const Words& words, Meaning meaning)
{
    for (const auto& word : words)
        if (word.meaning == meaning)
            return word.text;
    return "unknown";
}

} // namespace

CMPIType dataTypeNamed(std::string_view word)
{
    return meaningOf(dataTypeWords, word, CMPIType{CMPI_null});
}

Scope scopeNamed(std::string_view word)
{
    return meaningOf(scopeWords, word, Scope::any);
}

FlavorChange flavorNamed(std::string_view word)
{
    return meaningOf(flavorWords, word, FlavorChange::enableOverride);
}

std::string nameOfType(CMPIType type)
{
    const std::string_view name = textOf(dataTypeWords, elementType(type));
    return std::string(name) + (isArrayType(type) ? "[]" : "");
}

std::string_view nameOfScope(Scope scope)
{
    return textOf(scopeWords, scope);
}

} // namespace Host
