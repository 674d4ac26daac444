// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"

#include <sys/utsname.h>

namespace Vorn {

std::string getSystemName()
{
    utsname system{};
    return ::uname(&system) == 0 ? system.nodename : "";
}

std::string stripSpaces(const std::string& text)
{
    constexpr const char* blanks = " \t";
    const auto first = text.find_first_not_of(blanks);
    if (first == std::string::npos)
        return {};
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

} // namespace Vorn
