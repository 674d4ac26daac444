// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/ResourceString.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <string_view>

namespace Vorn {

namespace {

// The columns of the table of messages; the first is the fallback.
constexpr std::array<std::wstring_view, 5> languages = {L"en", L"de", L"fr", L"es", L"ja"};

struct MessageTexts {
    std::wstring_view id;
    std::array<std::wstring_view, languages.size()> texts;
};

// The insert is the sensor's name, such as "CPU 1 Temp".
constexpr std::array messages = {
    MessageTexts{L"MSGID_SENSOR_CAPTION",
        {L"Sensor %s", L"Sensor %s", L"Capteur %s", L"Sensor %s", L"センサー %s"}},
    MessageTexts{L"MSGID_SENSOR_DESCRIPTION",
        {L"Numeric sensor %s, read from this computer's hardware",
            L"Numerischer Sensor %s, ausgelesen aus der Hardware dieses Computers",
            L"Capteur numérique %s, lu sur le matériel de cet ordinateur",
            L"Sensor numérico %s, leído del hardware de este equipo",
            L"このコンピューターのハードウェアから読み取る数値センサー %s"}},
};

constexpr bool hasOneInsert(std::wstring_view text)
{
    const std::size_t percent = text.find(L'%');
    return text.substr(std::min(percent, text.size()), 2) == L"%s" &&
           text.find(L'%', percent + 1) == std::wstring_view::npos;
}
static_assert(std::all_of(messages.begin(), messages.end(), [](const MessageTexts& message) {
    return std::all_of(message.texts.begin(), message.texts.end(), hasOneInsert);
}));

// Returns the column of a resource library, such as "de_AT/sensor-profile".
std::size_t columnOf(std::wstring_view library)
{
    const std::size_t slash = library.rfind(L'/');
    if (slash == std::wstring_view::npos || library.substr(slash) != L"/sensor-profile")
        return 0;
    const std::wstring_view locale = library.substr(0, slash);
    const std::wstring_view language = locale.substr(0, locale.find(L'_'));
    const auto* const found = std::find(languages.begin(), languages.end(), language);
    return found == languages.end() ? 0 : static_cast<std::size_t>(found - languages.begin());
}

std::wstring_view textOf(std::wstring_view library, std::wstring_view messageId)
{
    for (const MessageTexts& message : messages)
        if (message.id == messageId)
            return message.texts[columnOf(library)];
    return L"%s";
}

} // namespace

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
    : text_(textOf(library, messageId))
{
}

} // namespace Vorn
