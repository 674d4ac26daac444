// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The language of the process, read from its environment; its global locale is neither used nor
// changed.

#pragma once

#include <string>

namespace Vorn {

// Thread-safe as long as no thread changes the environment.
class Locale {
public:
    // Returns the language of messages: the first of LC_ALL, LC_MESSAGES and LANG that is set and
    // not empty, without its encoding and modifier ("de_DE" for "de_DE.UTF-8@euro"); "en" for C and
    // POSIX and when none is set.
    static std::string getLanguageId();

    // Returns the name of a component's texts in a language, for ResourceString:
    // "de_DE/sensor-profile". Component 2 is the sensor profile; no other has texts.
    static std::wstring getResourceLibrary(unsigned long component, std::string language);
};

} // namespace Vorn
