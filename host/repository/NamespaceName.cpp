// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/NamespaceName.h"

#include "platform/text/Trim.h"

namespace Host {

namespace {

constexpr bool isNameCharacter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_' ||
           c == '-' || c == '.';
}

} // namespace

std::string plainNamespaceName(std::string_view name)
{
    name = Text::trimmed(name, "/");
    char before = '/';
    for (const char c : name) {
        if (c == '/' ? before == '/' : !isNameCharacter(c))
            return {};
        before = c;
    }
    return std::string(name);
}

} // namespace Host
