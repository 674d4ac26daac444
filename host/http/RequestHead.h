// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The first line of a request and its header fields.

#pragma once

#include "host/http/HttpError.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Host::Http {

struct RequestHead {
    std::string method;
    std::string target;  // as the client spells it, such as /cimom
    std::string version; // such as HTTP/1.1
    std::vector<HeaderField> fields;

    // The value without white space at its ends. Names know no letter case. Throws HttpError
    // when the field is there more than once.
    std::optional<std::string_view> find(std::string_view name) const;
};

// Whether the text can be the name of a header field.
bool isToken(std::string_view text);

// Without spaces and tabs at its ends.
std::string_view withoutBlanks(std::string_view text);

// Without the quotation marks, where there is one at each end.
std::string_view withoutQuotes(std::string_view text);

} // namespace Host::Http
