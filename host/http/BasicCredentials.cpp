// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/BasicCredentials.h"

#include "host/broker/Names.h"
#include "host/http/RequestHead.h"

#include <cstddef>
#include <cstdint>

namespace Host::Http {

namespace {

constexpr std::string_view alphabet =
    "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";

std::optional<std::string> fromBase64(std::string_view text)
{
    if (text.size() % 4 != 0)
        return std::nullopt;
    std::size_t padding = 0;
    while (padding < 2 && text.ends_with('=')) {
        text.remove_suffix(1);
        ++padding;
    }
    std::string bytes;
    std::uint32_t bits = 0;
    unsigned count = 0;
    for (const char c : text) {
        const std::size_t value = alphabet.find(c);
        if (value == std::string_view::npos)
            return std::nullopt;
        bits = (bits << 6 | static_cast<std::uint32_t>(value)) & 0xFFFFU;
        count += 6;
        if (count >= 8) {
            count -= 8;
            bytes += static_cast<char>(bits >> count & 0xFFU);
        }
    }
    return bytes;
}

} // namespace

std::optional<Credentials> basicCredentials(std::string_view authorization)
{
    const std::size_t schemeEnd = authorization.find(' ');
    if (schemeEnd == std::string_view::npos ||
        !equalNames(authorization.substr(0, schemeEnd), "Basic"))
        return std::nullopt;
    const auto text = fromBase64(withoutBlanks(authorization.substr(schemeEnd)));
    if (!text || text->find('\0') != std::string::npos)
        return std::nullopt;
    const std::size_t colon = text->find(':');
    if (colon == std::string::npos || colon == 0)
        return std::nullopt;
    return Credentials{text->substr(0, colon), text->substr(colon + 1)};
}

} // namespace Host::Http
