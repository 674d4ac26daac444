// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Why a request is not carried out, as HTTP tells it.

#pragma once

#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace Host::CimXml {
class RequestError;
}

namespace Host::Http {

namespace Status {

inline constexpr unsigned ok = 200;
inline constexpr unsigned badRequest = 400;
inline constexpr unsigned unauthorized = 401;
inline constexpr unsigned notFound = 404;
inline constexpr unsigned methodNotAllowed = 405;
inline constexpr unsigned lengthRequired = 411;
inline constexpr unsigned contentTooLarge = 413;
inline constexpr unsigned unsupportedMediaType = 415;
inline constexpr unsigned expectationFailed = 417;
inline constexpr unsigned headerTooLarge = 431;
inline constexpr unsigned internalError = 500;
inline constexpr unsigned notImplemented = 501;
inline constexpr unsigned unavailable = 503;
inline constexpr unsigned notExtended = 510;

} // namespace Status

struct HeaderField {
    std::string name;
    std::string value;
};

// what() is the reason in words, for the client.
class HttpError : public std::runtime_error {
public:
    // The CIMError is what the header of that name says; empty for none.
    HttpError(unsigned status, const std::string& reason, std::string_view cimError = {},
        std::vector<HeaderField> fields = {});
    explicit HttpError(const CimXml::RequestError& error);

    unsigned status() const noexcept { return status_; }
    const std::string& cimError() const noexcept { return cimError_; }
    // More for the head of the answer.
    const std::vector<HeaderField>& fields() const noexcept { return fields_; }
    // Whether the connection is closed behind the answer.
    bool endsConnection() const noexcept { return endsConnection_; }

    // One that ends the connection: where the request ends is in doubt, or the client shall go.
    static HttpError closing(
        unsigned status, const std::string& reason, std::vector<HeaderField> fields = {});

private:
    unsigned status_;
    std::string cimError_;
    std::vector<HeaderField> fields_;
    bool endsConnection_ = false;
};

} // namespace Host::Http
