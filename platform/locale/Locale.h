// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Language and message catalogs of the process, found without touching its global locale.

#pragma once

#include <string>

namespace Vorn {

// May be called from any thread, as long as none changes the environment meanwhile.
class Locale {
public:
    // The language of messages: the first of LC_ALL, LC_MESSAGES and LANG that is set and not
    // empty, without its encoding and modifier ("de_DE" of "de_DE.UTF-8@euro"); "en" when it is
    // C or POSIX, when it is no language name at all and when none is set.
    static std::string getLanguageId();

    // The name of the message catalog of a component in a language, for ResourceString:
    // "de_DE/sensor-profile", the language and the gettext domain. Component 2 is the sensor
    // profile; for any other the name is that of a catalog that does not exist.
    static std::wstring getResourceLibrary(unsigned long component, std::string language);
};

} // namespace Vorn
