// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/RequestHead.h"

#include <algorithm>

namespace Host::Http {

namespace {

constexpr char lowerCase(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

} // namespace

bool isToken(std::string_view text)
{
    constexpr std::string_view punctuation = "!#$%&'*+-.^_`|~";
    return !text.empty() && std::all_of(text.begin(), text.end(), [&](char c) {
        return (c >= '0' && c <= '9') || (lowerCase(c) >= 'a' && lowerCase(c) <= 'z') ||
               punctuation.find(c) != std::string_view::npos;
    });
}

bool equalIgnoringCase(std::string_view a, std::string_view b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
        [](char one, char other) { return lowerCase(one) == lowerCase(other); });
}

std::string_view withoutBlanks(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(" \t");
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

std::optional<std::string_view> RequestHead::find(std::string_view name) const
{
    std::optional<std::string_view> value;
    for (const HeaderField& field : fields) {
        if (!equalIgnoringCase(field.name, name))
            continue;
        if (value)
            throw HttpError::closing(
                Status::badRequest, "the header field " + std::string(name) + " is there twice");
        value = withoutBlanks(field.value);
    }
    return value;
}

} // namespace Host::Http
