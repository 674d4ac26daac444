// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Any head and body yield a valid call or an error with an HTTP status, and any password file and
// credentials are read within bounds.

#include "host/cimxml/Message.h"
#include "host/cimxml/RequestError.h"
#include "host/http/BasicCredentials.h"
#include "host/http/HeaderCheck.h"
#include "host/http/Passwords.h"
#include "host/http/ResourceCheck.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>

namespace {

using Host::Http::HttpError;
using Host::Http::RequestHead;

struct Request {
    RequestHead head;
    std::string_view body;
};

// Splits a request into head and body, without the checks of a server.
Request split(std::string_view text)
{
    const auto next = [&text] {
        const std::string_view line = text.substr(0, text.find('\n'));
        text.remove_prefix(std::min(line.size() + 1, text.size()));
        return line;
    };
    Request request;
    const std::string_view first = next();
    const std::size_t space = first.find(' ');
    const std::size_t second = first.find(' ', space + 1);
    request.head.method = first.substr(0, space);
    if (space != std::string_view::npos)
        request.head.target = first.substr(space + 1, second - space - 1);
    request.head.version = second == std::string_view::npos ? "HTTP/1.1" : first.substr(second + 1);
    for (std::string_view line = next(); !line.empty(); line = next()) {
        const std::size_t colon = line.find(':');
        request.head.fields.push_back({std::string(line.substr(0, colon)),
            std::string(colon == std::string_view::npos ? "" : line.substr(colon + 1))});
    }
    request.body = text;
    return request;
}

void requireSense(const HttpError& error)
{
    const bool isError = error.status() >= 400 && error.status() < 600;
    const auto isOfHeader = [](char c) { return c == '-' || (c >= 'a' && c <= 'z'); };
    if (!isError || std::string_view(error.what()).empty() ||
        !std::all_of(error.cimError().begin(), error.cimError().end(), isOfHeader))
        std::abort();
}

void check(const Request& request)
{
    const Host::Http::Limits limits;
    try {
        const auto size = Host::Http::bodySizeOf(request.head);
        const double weight = weightOf(request.head, "text/plain", "0.0.4");
        if (!(weight >= 0 && weight <= 1))
            std::abort();
        if (Host::Http::pathOf(request.head) == "/metrics")
            return checkResourceRequest(request.head, true);
        const auto call = Host::Http::checkHead(request.head, size, limits);
        if (call.extension && call.extension->size() != 2)
            std::abort();
        if (size.bytes.value_or(0) > limits.maximumBody)
            std::abort();
        if (const auto field = request.head.find("Authorization"))
            if (const auto given = Host::Http::basicCredentials(*field))
                if (given->user.empty() || given->user.find(':') != std::string::npos)
                    std::abort();
        requireMatch(call, Host::CimXml::Message(request.body));
        if (answerFieldsFor(call).empty())
            std::abort();
    } catch (const HttpError& error) {
        requireSense(error);
    } catch (const Host::CimXml::RequestError& error) {
        requireSense(HttpError(error));
    }
}

void readPasswords(std::string_view text)
{
    try {
        const Host::Http::Passwords passwords(text, "file");
    } catch (const std::runtime_error& error) {
        if (!std::string_view(error.what()).starts_with("file:"))
            std::abort();
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    check(split(text));
    readPasswords(text);
    return 0;
}
