// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/ListenPolicy.h"

#include <stdexcept>

namespace Host::Http {

namespace {

void requireProtection(const Address& address, const ListenWishes& wishes)
{
    if (wishes.hasCertificate && wishes.hasPasswords)
        return;
    std::string missing;
    if (!wishes.hasCertificate)
        missing = "a certificate with its key (--certificate, --key)";
    if (!wishes.hasPasswords)
        missing += std::string(missing.empty() ? "" : " and ") + "a password file (--passwords)";
    throw std::invalid_argument("other machines can reach " + address.host() +
                                ", which needs TLS and sign-in; what is missing: " + missing);
}

} // namespace

std::vector<Endpoint> endpointsFor(const ListenWishes& wishes)
{
    const bool areDefaults = wishes.addresses.empty();
    const std::vector<std::string> hosts =
        areDefaults ? std::vector<std::string>{"127.0.0.1", "::1"} : wishes.addresses;
    std::vector<Endpoint> endpoints;
    for (const std::string& host : hosts) {
        const Address plain(host, wishes.port);
        const bool isOptional = areDefaults && plain.isIpv6();
        if (plain.isLoopback())
            endpoints.push_back({plain, false, isOptional});
        else
            requireProtection(plain, wishes);
        if (wishes.hasCertificate)
            endpoints.push_back({Address(host, wishes.tlsPort), true, isOptional});
    }
    return endpoints;
}

} // namespace Host::Http
