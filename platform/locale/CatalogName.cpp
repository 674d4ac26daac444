// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/CatalogName.h"

#include "platform/utilities/ProviderUtilities.h"

#include <algorithm>

namespace Vorn {

namespace {

constexpr std::size_t longestName = 64;

bool isPlain(char character)
{
    return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
           (character >= '0' && character <= '9') || character == '_' || character == '-';
}

} // namespace

bool isPlainName(std::string_view name)
{
    return !name.empty() && name.size() <= longestName &&
           std::all_of(name.begin(), name.end(), isPlain);
}

std::wstring CatalogName::join(const std::string& language, const std::wstring& domain)
{
    return make_wstring(language) + L'/' + domain;
}

std::optional<CatalogName> CatalogName::split(const std::wstring& name)
{
    const auto slash = name.find(L'/');
    if (slash == std::wstring::npos)
        return std::nullopt;
    CatalogName parts{make_string(name.substr(0, slash)), make_string(name.substr(slash + 1))};
    if (!isPlainName(parts.language) || !isPlainName(parts.domain))
        return std::nullopt;
    return parts;
}

} // namespace Vorn
