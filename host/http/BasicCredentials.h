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

// What the header field Authorization says; nothing when it is of another scheme or malformed.
std::optional<Credentials> basicCredentials(std::string_view authorization);

} // namespace Host::Http
