// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/BasicCredentials.h"

#include "host/broker/Names.h"
#include "platform/text/Trim.h"

#include <gnutls/gnutls.h>

#include <memory>

namespace Host::Http {

namespace {

std::optional<std::string> fromBase64(std::string_view text)
{
    std::string encoded(text);
    const ::gnutls_datum_t source{
        reinterpret_cast<unsigned char*>(encoded.data()), static_cast<unsigned>(encoded.size())};
    ::gnutls_datum_t decoded{};
    if (::gnutls_base64_decode2(&source, &decoded) != 0)
        return std::nullopt;
    const std::unique_ptr<unsigned char, decltype(::gnutls_free)> owner(
        decoded.data, ::gnutls_free);
    return std::string(reinterpret_cast<const char*>(decoded.data), decoded.size);
}

} // namespace

std::optional<Credentials> basicCredentials(std::string_view authorization)
{
    const std::size_t schemeEnd = authorization.find(' ');
    if (schemeEnd == std::string_view::npos ||
        !equalNames(authorization.substr(0, schemeEnd), "Basic"))
        return std::nullopt;
    const auto text = fromBase64(Text::trimmed(authorization.substr(schemeEnd), " \t"));
    if (!text || text->find('\0') != std::string::npos)
        return std::nullopt;
    const std::size_t colon = text->find(':');
    if (colon == std::string::npos || colon == 0)
        return std::nullopt;
    return Credentials{text->substr(0, colon), text->substr(colon + 1)};
}

} // namespace Host::Http
