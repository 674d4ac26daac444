// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/Locale.h"

#include "platform/locale/CatalogName.h"

#include <cstdlib>
#include <string_view>

namespace Vorn {

namespace {

constexpr unsigned long sensorProfileComponent = 2;

std::string_view languageOfEnvironment()
{
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        const char* const value = ::secure_getenv(variable);
        if (value != nullptr && *value != '\0')
            return value;
    }
    return {};
}

} // namespace

std::string Locale::getLanguageId()
{
    const std::string_view locale = languageOfEnvironment();
    const std::string_view language = locale.substr(0, locale.find_first_of(".@"));
    if (language == "C" || language == "POSIX" || !isPlainName(language))
        return "en";
    return std::string(language);
}

std::wstring Locale::getResourceLibrary(unsigned long component, std::string language)
{
    const std::wstring domain = component == sensorProfileComponent
                                    ? L"sensor-profile"
                                    : L"component-" + std::to_wstring(component);
    return CatalogName::join(language, domain);
}

} // namespace Vorn
