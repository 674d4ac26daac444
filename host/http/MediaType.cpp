// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/MediaType.h"

#include "host/http/RequestHead.h"

namespace Host::Http {

namespace {

std::string_view withoutQuotes(std::string_view value)
{
    if (value.size() >= 2 && value.starts_with('"') && value.ends_with('"'))
        return value.substr(1, value.size() - 2);
    return value;
}

} // namespace

bool isXmlInUtf8(std::string_view contentType)
{
    const std::size_t typeEnd = contentType.find(';');
    const std::string_view type = withoutBlanks(contentType.substr(0, typeEnd));
    if (!equalIgnoringCase(type, "application/xml") && !equalIgnoringCase(type, "text/xml"))
        return false;
    std::string_view rest =
        typeEnd == std::string_view::npos ? "" : contentType.substr(typeEnd + 1);
    while (!rest.empty()) {
        const std::string_view parameter = rest.substr(0, rest.find(';'));
        rest.remove_prefix(parameter.size() == rest.size() ? rest.size() : parameter.size() + 1);
        const std::size_t equals = parameter.find('=');
        if (equals == std::string_view::npos ||
            !equalIgnoringCase(withoutBlanks(parameter.substr(0, equals)), "charset"))
            continue;
        if (!equalIgnoringCase(withoutQuotes(withoutBlanks(parameter.substr(equals + 1))), "utf-8"))
            return false;
    }
    return true;
}

} // namespace Host::Http
