// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/RequestTexts.h"

#include "platform/locale/FormatText.h"
#include "platform/locale/Locale.h"
#include "platform/locale/ResourceString.h"

namespace Vorn::SensorProfileProvider {

namespace {

// The component number of this library in the localised texts.
constexpr unsigned long resourceComponent = 2;

// Captions and descriptions are truncated to one character less.
constexpr std::size_t localisedTextSize = 512;

std::string filledIn(const std::wstring& format, const std::string& elementName)
{
    return make_string(formatText(format, elementName, localisedTextSize));
}

} // namespace

RequestTexts::RequestTexts()
{
    const std::wstring library =
        Locale::getResourceLibrary(resourceComponent, Locale::getLanguageId());
    captionFormat_ = ResourceString(library, L"MSGID_SENSOR_CAPTION").text();
    descriptionFormat_ = ResourceString(library, L"MSGID_SENSOR_DESCRIPTION").text();
}

std::string RequestTexts::caption(const std::string& elementName) const
{
    return filledIn(captionFormat_, elementName);
}

std::string RequestTexts::description(const std::string& elementName) const
{
    return filledIn(descriptionFormat_, elementName);
}

} // namespace Vorn::SensorProfileProvider
