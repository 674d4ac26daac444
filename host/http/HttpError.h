// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace Host::CimXml {
class RequestError;
}

namespace Host::Http {

struct HeaderField {
    std::string name;
    std::string value;
};

// An answer that says why a request is refused or failed. The body of the answer is what().
class HttpError : public std::runtime_error {
public:
    // The CIMError is the value of the header field of that name; empty for none.
    HttpError(unsigned status, const std::string& reason, std::string_view cimError = {},
        std::vector<HeaderField> fields = {});
    explicit HttpError(const CimXml::RequestError& error);

    unsigned status() const noexcept { return status_; }
    const std::string& cimError() const noexcept { return cimError_; }
    // Further header fields of the answer.
    const std::vector<HeaderField>& fields() const noexcept { return fields_; }
    // Returns whether the connection is closed after the answer.
    bool endsConnection() const noexcept { return endsConnection_; }

    // Creates one that closes the connection: the end of the request is in doubt, or the connection
    // should make room.
    static HttpError closing(
        unsigned status, const std::string& reason, std::vector<HeaderField> fields = {});

private:
    unsigned status_;
    std::string cimError_;
    std::vector<HeaderField> fields_;
    bool endsConnection_ = false;
};

} // namespace Host::Http
