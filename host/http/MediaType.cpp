// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/MediaType.h"

#include "host/broker/Names.h"
#include "host/http/RequestHead.h"

namespace Host::Http {

bool isXmlInUtf8(std::string_view contentType)
{
    const std::size_t typeEnd = contentType.find(';');
    const std::string_view type = withoutBlanks(contentType.substr(0, typeEnd));
    if (!equalNames(type, "application/xml") && !equalNames(type, "text/xml"))
        return false;
    std::string_view rest =
        typeEnd == std::string_view::npos ? "" : contentType.substr(typeEnd + 1);
    while (!rest.empty()) {
        const std::string_view parameter = rest.substr(0, rest.find(';'));
        rest.remove_prefix(parameter.size() == rest.size() ? rest.size() : parameter.size() + 1);
        const std::size_t equals = parameter.find('=');
        if (equals == std::string_view::npos ||
            !equalNames(withoutBlanks(parameter.substr(0, equals)), "charset"))
            continue;
        if (!equalNames(withoutQuotes(withoutBlanks(parameter.substr(equals + 1))), "utf-8"))
            return false;
    }
    return true;
}

} // namespace Host::Http
