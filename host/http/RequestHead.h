// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/HttpError.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Host::Http {

// The request line and the header fields.
struct RequestHead {
    std::string method;
    std::string target;  // as the client spells it, such as /cimom
    std::string version; // such as HTTP/1.1
    std::vector<HeaderField> fields;

    // Returns the value of a field without white space at its ends. The letter case of the name
    // does not matter. Throws HttpError when there are several fields of that name.
    std::optional<std::string_view> find(std::string_view name) const;
};

// A value with parameters, such as `text/xml; charset=utf-8` (RFC 9110, 5.6.6). Refers to the text
// that it was parsed from.
struct ParameterizedValue {
    struct Parameter {
        std::string_view name;
        std::string_view value;
    };

    std::string_view value;
    std::vector<Parameter> parameters;
};

// Returns the elements of a list with commas between them (RFC 9110, 5.6.1).
std::vector<std::string_view> parseList(std::string_view text);

// Ignores parameters without an equals sign.
ParameterizedValue parseParameters(std::string_view text);

// Returns the content of a quoted string, and any other text as it is.
std::string_view withoutQuotes(std::string_view text);

} // namespace Host::Http
