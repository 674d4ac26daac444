// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/SignInMemory.h"

#include <gnutls/crypto.h>
#include <gnutls/gnutls.h>

#include <algorithm>
#include <stdexcept>

namespace Host::Http {

SignInMemory::SignInMemory()
{
    if (::gnutls_rnd(GNUTLS_RND_KEY, key_.data(), key_.size()) != 0)
        throw std::runtime_error("the system gives no random numbers");
}

bool SignInMemory::knows(const Credentials& credentials, const std::string& address, Time now)
{
    const std::lock_guard lock(mutex_);
    const auto found = until_.find(digestOf(credentials, address));
    return found != until_.end() && now < found->second;
}

bool SignInMemory::remember(const Credentials& credentials, const std::string& address, Time now)
{
    const std::lock_guard lock(mutex_);
    std::erase_if(until_, [now](const auto& each) { return each.second <= now; });
    if (until_.size() >= capacity)
        until_.erase(std::min_element(until_.begin(), until_.end(),
            [](const auto& one, const auto& other) { return one.second < other.second; }));
    return until_.insert_or_assign(digestOf(credentials, address), now + lifetime).second;
}

void SignInMemory::forgetAll()
{
    const std::lock_guard lock(mutex_);
    until_.clear();
}

SignInMemory::Digest SignInMemory::digestOf(
    const Credentials& credentials, const std::string& address) const
{
    // No part holds a zero.
    const std::string text = credentials.user + '\0' + credentials.password + '\0' + address;
    Digest digest{};
    if (::gnutls_hmac_fast(GNUTLS_MAC_SHA256, key_.data(), key_.size(), text.data(), text.size(),
            digest.data()) != 0)
        throw std::runtime_error("a keyed hash cannot be made");
    return digest;
}

} // namespace Host::Http
