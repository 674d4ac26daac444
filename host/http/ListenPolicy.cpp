// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/ListenPolicy.h"

#include <algorithm>
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

// Returns whether the first endpoint includes the other one.
bool covers(const Endpoint& first, const Endpoint& other)
{
    return first.isEncrypted == other.isEncrypted && first.address.port() == other.address.port() &&
           first.address.isIpv6() == other.address.isIpv6() &&
           (first.address.isAny() || first.address.host() == other.address.host());
}

// Adds an endpoint unless one of them includes it, and removes those that it includes: the system
// refuses to bind both.
void add(std::vector<Endpoint>& endpoints, const Endpoint& added)
{
    if (std::any_of(endpoints.begin(), endpoints.end(),
            [&](const Endpoint& each) { return covers(each, added); }))
        return;
    std::erase_if(endpoints, [&](const Endpoint& each) { return covers(added, each); });
    endpoints.push_back(added);
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
            add(endpoints, {plain, false, isOptional});
        else
            requireProtection(plain, wishes);
        if (wishes.hasCertificate)
            add(endpoints, {Address(host, wishes.tlsPort), true, isOptional});
    }
    return endpoints;
}

} // namespace Host::Http
