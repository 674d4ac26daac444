// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ProviderUtilities.h"

#include "platform/text/Trim.h"

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
    return std::string(Text::trimmed(text, " \t"));
}

bool isSameName(std::string_view a, std::string_view b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
        [](char x, char y) { return lowered(x) == lowered(y); });
}

} // namespace Vorn
