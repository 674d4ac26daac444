// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace Host::Http {

struct Credentials {
    std::string user;
    std::string password;
};

// Returns the credentials in the value of an Authorization field (RFC 7617); nothing for another
// scheme and for a malformed value.
std::optional<Credentials> basicCredentials(std::string_view authorization);

} // namespace Host::Http
