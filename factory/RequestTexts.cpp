// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/RequestTexts.h"

#include "platform/locale/FormatText.h"
#include "platform/locale/Locale.h"
#include "platform/locale/ResourceString.h"

#include <algorithm>
#include <string_view>

namespace Vorn::SensorProfileProvider {

namespace {

// The component number of this library in the localised texts.
constexpr unsigned long resourceComponent = 2;

// Captions and descriptions are truncated to one character less.
constexpr std::size_t localisedTextSize = 512;

constexpr std::wstring_view insert = L"%s";

} // namespace

// The search compares character by character: valgrind reports wmemcmp(), which reads 32 bytes at
// once.
RequestTexts::Format::Format(const std::wstring& text) : wide(text)
{
    const auto at = std::search(text.begin(), text.end(), insert.begin(), insert.end());
    before = make_string({text.begin(), at});
    if (at != text.end())
        after = make_string({at + insert.size(), text.end()});
}

RequestTexts::RequestTexts()
    : RequestTexts(Locale::getResourceLibrary(resourceComponent, Locale::getLanguageId()))
{
}

RequestTexts::RequestTexts(const std::wstring& library)
    : caption_(ResourceString(library, L"MSGID_SENSOR_CAPTION").text()),
      description_(ResourceString(library, L"MSGID_SENSOR_DESCRIPTION").text())
{
}

std::string RequestTexts::caption(const std::string& elementName) const
{
    return filledIn(caption_, elementName);
}

std::string RequestTexts::description(const std::string& elementName) const
{
    return filledIn(description_, elementName);
}

std::string RequestTexts::filledIn(const Format& format, const std::string& elementName)
{
    // Most names are short and of ASCII, where the conversions would change nothing.
    const bool isAscii = std::all_of(elementName.begin(), elementName.end(),
        [](char character) { return static_cast<unsigned char>(character) < 0x80; });
    if (isAscii && format.wide.size() - insert.size() + elementName.size() < localisedTextSize)
        return format.before + elementName + format.after;
    return make_string(formatText(format.wide, elementName, localisedTextSize));
}

} // namespace Vorn::SensorProfileProvider
