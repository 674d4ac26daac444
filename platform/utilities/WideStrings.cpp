// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/text/Utf8.h"
#include "platform/utilities/ProviderUtilities.h"

#include <string_view>

namespace Vorn {

static_assert(sizeof(wchar_t) == sizeof(char32_t), "a wide character holds a code point");

std::string make_string(const std::wstring& text)
{
    std::string narrow;
    narrow.reserve(text.size());
    for (const wchar_t character : text)
        if (character >= 0 && character < 0x80) // nearly all are, and this takes a fraction
            narrow += static_cast<char>(character);
        else
            Text::appendUtf8(narrow, static_cast<char32_t>(character));
    return narrow;
}

std::wstring make_wstring(const std::string& text)
{
    std::wstring wide;
    wide.reserve(text.size());
    for (std::string_view rest = text; !rest.empty();) {
        const Text::Character character = Text::firstCharacter(rest);
        wide += static_cast<wchar_t>(character.code);
        rest.remove_prefix(character.size);
    }
    return wide;
}

} // namespace Vorn
