// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/LetterCase.h"

#include "host/broker/Names.h"
#include "platform/text/Utf8.h"

#include <fnmatch.h>

#include <clocale>
#include <cwctype>
#include <memory>
#include <type_traits>

namespace Tools {

namespace {

constexpr char32_t endOfAscii = 0x80;

// Returns null where there is no such locale.
locale_t utf8Locale()
{
    using Locale = std::unique_ptr<std::remove_pointer_t<locale_t>, decltype(&::freelocale)>;
    static const Locale locale(::newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr), &::freelocale);
    return locale.get();
}

char32_t lowerCaseBeyondAscii(char32_t character)
{
    const locale_t locale = utf8Locale();
    return locale == nullptr ? character : static_cast<char32_t>(::towlower_l(character, locale));
}

} // namespace

char32_t lowerCase(char32_t character)
{
    return character < endOfAscii
               ? static_cast<char32_t>(Host::foldCase(static_cast<char>(character)))
               : lowerCaseBeyondAscii(character);
}

std::string toLowerCase(std::string_view text)
{
    std::string lower;
    lower.reserve(text.size());
    while (!text.empty()) {
        const Text::Character character = Text::firstCharacter(text);
        Text::appendUtf8(lower, lowerCase(character.code));
        text.remove_prefix(character.size);
    }
    return lower;
}

bool matchesPattern(const std::string& pattern, const std::string& text)
{
    const locale_t former = ::uselocale(utf8Locale()); // of this thread; null changes nothing
    const bool isMatch = ::fnmatch(pattern.c_str(), text.c_str(), FNM_NOESCAPE) == 0;
    ::uselocale(former);
    return isMatch;
}

} // namespace Tools
