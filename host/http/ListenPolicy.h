// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where the server listens, and what it needs for that.

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
    // Nobody asked for it by name: it does no harm when the machine lacks it.
    bool isOptional = false;
};

// Loopback addresses are served without TLS, and with it too where there is a certificate; all
// others with TLS only, and only to clients that sign in. None is there twice, nor beside 0.0.0.0
// or
// :: that includes it. Throws std::invalid_argument saying
// what is missing for that, or what is no address.
std::vector<Endpoint> endpointsFor(const ListenWishes& wishes);

} // namespace Host::Http
