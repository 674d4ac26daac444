// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"

#include <algorithm>

#include <sys/utsname.h>

namespace Vorn {

namespace {

char lowered(char character)
{
    return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a')
                                                : character;
}

} // namespace

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

bool isSameName(std::string_view a, std::string_view b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
        [](char x, char y) { return lowered(x) == lowered(y); });
}

} // namespace Vorn
