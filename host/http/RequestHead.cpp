// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/RequestHead.h"

#include "host/broker/Names.h"

#include <algorithm>

namespace Host::Http {

bool isToken(std::string_view text)
{
    constexpr std::string_view punctuation = "!#$%&'*+-.^_`|~";
    return !text.empty() && std::all_of(text.begin(), text.end(), [&](char c) {
        return (c >= '0' && c <= '9') || (foldCase(c) >= 'a' && foldCase(c) <= 'z') ||
               punctuation.find(c) != std::string_view::npos;
    });
}

std::string_view withoutBlanks(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(" \t");
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

std::string_view withoutQuotes(std::string_view text)
{
    if (text.size() >= 2 && text.starts_with('"') && text.ends_with('"'))
        return text.substr(1, text.size() - 2);
    return text;
}

std::optional<std::string_view> RequestHead::find(std::string_view name) const
{
    std::optional<std::string_view> value;
    for (const HeaderField& field : fields) {
        if (!equalNames(field.name, name))
            continue;
        if (value)
            throw HttpError::closing(
                Status::badRequest, "the header field " + std::string(name) + " is there twice");
        value = withoutBlanks(field.value);
    }
    return value;
}

} // namespace Host::Http
