// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/ResourceCheck.h"

#include "host/broker/Names.h"
#include "host/http/Address.h"

#include <microhttpd.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <charconv>
#include <climits>
#include <cstddef>
#include <stdexcept>
#include <string>

namespace Host::Http {

namespace {

std::string ownName()
{
    std::array<char, HOST_NAME_MAX + 1> name{};
    ::gethostname(name.data(), name.size() - 1);
    return name.data();
}

// Returns the host of a Host field, without the brackets of an IPv6 address (RFC 9110, 7.2).
std::string_view hostIn(std::string_view field)
{
    const std::size_t bracket = field.starts_with('[') ? field.find(']') : std::string_view::npos;
    return bracket == std::string_view::npos ? field.substr(0, field.rfind(':'))
                                             : field.substr(1, bracket - 1);
}

bool isThisMachine(std::string_view host)
{
    if (equalNames(host, "localhost") || equalNames(host, ownName()))
        return true;
    try {
        return Address(std::string(host), 0).isLoopback();
    } catch (const std::invalid_argument&) {
        return false; // another name
    }
}

std::string formDecoded(std::string_view text)
{
    std::string result(text);
    std::replace(result.begin(), result.end(), '+', ' ');
    result.resize(::MHD_http_unescape(result.data()));
    return result;
}

double weightIn(const ParameterizedValue& range)
{
    double weight = 1;
    for (const auto& [name, value] : range.parameters)
        if (equalNames(name, "q") &&
            std::from_chars(value.data(), value.data() + value.size(), weight).ec != std::errc{})
            return 0;
    return weight >= 0 && weight <= 1 ? weight : 0;
}

bool isOfVersion(const ParameterizedValue& range, std::string_view version)
{
    return std::none_of(range.parameters.begin(), range.parameters.end(), [&](const auto& each) {
        return equalNames(each.name, "version") && withoutQuotes(each.value) != version;
    });
}

} // namespace

void checkResourceRequest(const RequestHead& head, bool isLoopback)
{
    if (head.method != "GET" && head.method != "HEAD")
        throw HttpError(MHD_HTTP_METHOD_NOT_ALLOWED, "the resource is read by GET or HEAD", {},
            {{"Allow", "GET, HEAD"}});
    // Pages of other sites may only lead here.
    if (head.find("Sec-Fetch-Site") == "cross-site" && head.find("Sec-Fetch-Mode") != "navigate")
        throw HttpError(MHD_HTTP_FORBIDDEN, "pages of other sites must not read the resource");
    const auto host = head.find("Host");
    if (isLoopback && host && !isThisMachine(hostIn(*host)))
        throw HttpError(MHD_HTTP_MISDIRECTED_REQUEST,
            "through a loopback address, the Host must be localhost, a loopback address or " +
                ownName());
}

std::vector<WeightedElement> weightedElements(const RequestHead& head, std::string_view field)
{
    std::vector<WeightedElement> elements;
    for (const HeaderField& each : head.fields)
        if (equalNames(each.name, field))
            for (const std::string_view element : parseList(each.value)) {
                const ParameterizedValue parsed = parseParameters(element);
                elements.push_back({parsed.value, weightIn(parsed)});
            }
    return elements;
}

std::vector<std::pair<std::string, std::string>> queryOf(const RequestHead& head)
{
    std::vector<std::pair<std::string, std::string>> query;
    const std::size_t begin = head.target.find('?');
    std::string_view rest =
        begin == std::string::npos ? "" : std::string_view(head.target).substr(begin + 1);
    while (!rest.empty()) {
        const std::string_view argument = rest.substr(0, rest.find('&'));
        rest.remove_prefix(std::min(argument.size() + 1, rest.size()));
        const std::size_t equals = std::min(argument.find('='), argument.size());
        query.emplace_back(formDecoded(argument.substr(0, equals)),
            formDecoded(argument.substr(std::min(equals + 1, argument.size()))));
    }
    return query;
}

double weightOf(const RequestHead& head, std::string_view mediaType, std::string_view version)
{
    double greatest = 0;
    for (const HeaderField& field : head.fields) {
        if (!equalNames(field.name, "Accept"))
            continue;
        for (const std::string_view element : parseList(field.value)) {
            const ParameterizedValue range = parseParameters(element);
            if (equalNames(range.value, mediaType) && isOfVersion(range, version))
                greatest = std::max(greatest, weightIn(range));
        }
    }
    return greatest;
}

} // namespace Host::Http
