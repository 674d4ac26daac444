// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Address.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Host::Http {

struct ListenWishes {
    std::vector<std::string> addresses{}; // empty for the loopback addresses
    std::uint16_t port = 5988;            // without TLS; 0 for any that is free
    std::uint16_t tlsPort = 5989;         // likewise
    bool hasCertificate = false;
    bool hasPasswords = false;
};

struct Endpoint {
    Address address;
    bool isEncrypted = false;
    // Whether it is a default, which is left out where the machine does not have the address.
    bool isOptional = false;
};

// Returns where the server listens. Loopback addresses are served without TLS, and with TLS too
// where there is a certificate; other addresses are served with TLS only, and only to clients that
// sign in. An endpoint that another one includes is left out. Throws std::invalid_argument when the
// certificate or the passwords for that are missing, and for a text that is no address.
std::vector<Endpoint> endpointsFor(const ListenWishes& wishes);

} // namespace Host::Http
