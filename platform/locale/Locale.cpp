// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/Locale.h"

#include "platform/utilities/ProviderUtilities.h"

#include <cstdlib>
#include <string_view>

namespace Vorn {

namespace {

constexpr unsigned long sensorProfileComponent = 2;

std::string_view localeOfEnvironment()
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
    const std::string_view locale = localeOfEnvironment();
    const std::string_view language = locale.substr(0, locale.find_first_of(".@"));
    const bool isUnset = language.empty() || language == "C" || language == "POSIX";
    return isUnset ? "en" : std::string(language);
}

std::wstring Locale::getResourceLibrary(unsigned long component, std::string language)
{
    return make_wstring(language) + (component == sensorProfileComponent
                                            ? L"/sensor-profile"
                                            : L"/component-" + std::to_wstring(component));
}

} // namespace Vorn
