// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/RequestHead.h"

#include "host/broker/Names.h"
#include "platform/text/Trim.h"

#include <microhttpd.h>

#include <algorithm>

namespace Host::Http {

namespace {

// Returns the text up to the first separator outside of quoted strings, without white space, and
// removes both.
std::string_view takeUntil(char separator, std::string_view& text)
{
    bool isQuoted = false;
    std::size_t size = 0;
    for (; size < text.size() && (isQuoted || text[size] != separator); ++size) {
        if (text[size] == '"')
            isQuoted = !isQuoted;
        else if (isQuoted && text[size] == '\\')
            ++size; // RFC 9110, 5.6.4: what follows is part of the string
    }
    const std::string_view part = text.substr(0, size);
    text.remove_prefix(std::min(part.size() + 1, text.size()));
    return Text::trimmed(part, " \t");
}

} // namespace

std::optional<std::string_view> RequestHead::find(std::string_view name) const
{
    std::optional<std::string_view> value;
    for (const HeaderField& field : fields) {
        if (!equalNames(field.name, name))
            continue;
        if (value)
            throw HttpError::closing(
                MHD_HTTP_BAD_REQUEST, "the header field " + std::string(name) + " is there twice");
        value = Text::trimmed(field.value, " \t");
    }
    return value;
}

std::vector<std::string_view> parseList(std::string_view text)
{
    std::vector<std::string_view> elements;
    while (!text.empty())
        if (const std::string_view element = takeUntil(',', text); !element.empty())
            elements.push_back(element);
    return elements;
}

ParameterizedValue parseParameters(std::string_view text)
{
    ParameterizedValue result{takeUntil(';', text), {}};
    while (!text.empty()) {
        std::string_view parameter = takeUntil(';', text);
        if (parameter.find('=') == std::string_view::npos)
            continue;
        const std::string_view name = takeUntil('=', parameter);
        result.parameters.push_back({name, Text::trimmed(parameter, " \t")});
    }
    return result;
}

std::string_view withoutQuotes(std::string_view text)
{
    if (text.size() >= 2 && text.starts_with('"') && text.ends_with('"'))
        return text.substr(1, text.size() - 2);
    return text;
}

} // namespace Host::Http
