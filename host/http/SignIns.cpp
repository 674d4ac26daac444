// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/SignIns.h"

#include "host/http/EventLog.h"

#include <gnutls/crypto.h>
#include <gnutls/gnutls.h>

#include <stdexcept>
#include <utility>

namespace Host::Http {

namespace {

// Removes the entries that are outdated and, where there are still too many, the first one by the
// order.
template <typename Map, typename IsOutdated, typename Order>
void makeRoom(Map& map, std::size_t capacity, IsOutdated isOutdated, Order order)
{
    if (map.size() < capacity)
        return;
    std::erase_if(map, [&](const auto& each) { return isOutdated(each.second); });
    if (map.size() >= capacity)
        map.erase(std::min_element(map.begin(), map.end(),
            [&](const auto& one, const auto& other) { return order(one.second, other.second); }));
}

} // namespace

SignInMemory::SignInMemory()
{
    if (::gnutls_rnd(GNUTLS_RND_KEY, key_.data(), key_.size()) != 0)
        throw std::runtime_error("the system gives no random numbers");
}

bool SignInMemory::contains(
    const Credentials& credentials, const std::string& address, Time now) const
{
    const auto found = until_.find(digestOf(credentials, address));
    return found != until_.end() && now < found->second;
}

bool SignInMemory::remember(const Credentials& credentials, const std::string& address, Time now)
{
    const bool wasKnown = contains(credentials, address, now);
    makeRoom(
        until_, capacity, [now](Time until) { return until <= now; }, std::less<>());
    until_.insert_or_assign(digestOf(credentials, address), now + lifetime);
    return !wasKnown;
}

SignInMemory::Digest SignInMemory::digestOf(
    const Credentials& credentials, const std::string& address) const
{
    // None of the parts contains a zero.
    const std::string text = credentials.user + '\0' + credentials.password + '\0' + address;
    Digest digest{};
    if (::gnutls_hmac_fast(GNUTLS_MAC_SHA256, key_.data(), key_.size(), text.data(), text.size(),
            digest.data()) != 0)
        throw std::runtime_error("a keyed hash cannot be made");
    return digest;
}

SignInDelays::Time SignInDelays::admit(const std::string& address, Time now)
{
    const auto found = failures_.find(address);
    if (found == failures_.end() || isOld(found->second, now))
        return now;
    Failures& failures = found->second;
    if (failures.notBefore > now)
        return failures.notBefore;
    failures.notBefore = now + delayAfter(failures);
    return now;
}

SignInDelays::Time SignInDelays::fail(const std::string& address, Time now)
{
    if (!failures_.contains(address))
        makeRoom(
            failures_, capacity, [now](const Failures& each) { return isOld(each, now); },
            [](const Failures& one, const Failures& other) { return one.last < other.last; });
    Failures& failures = failures_[address];
    if (failures.count > 0 && isOld(failures, now))
        failures = {};
    const Duration delay = delayAfter(failures);
    ++failures.count;
    failures.last = now;
    failures.notBefore = std::max(failures.notBefore, now + delay);
    return failures.notBefore;
}

void SignIns::replacePasswords(std::shared_ptr<const Passwords> passwords)
{
    const std::lock_guard lock(mutex_);
    passwords_ = std::move(passwords);
    memory_.forgetAll();
}

bool SignIns::isKnown(const Credentials& credentials, const std::string& address, Time now) const
{
    const std::lock_guard lock(mutex_);
    return memory_.contains(credentials, address, now);
}

SignIns::Time SignIns::admit(const std::string& network, Time now)
{
    const std::lock_guard lock(mutex_);
    return delays_.admit(network, now);
}

std::optional<SignIns::Time> SignIns::tryPassword(const Credentials& credentials,
    const std::string& address, const std::string& network, Time now)
{
    const auto current = passwords();
    if (!current)
        return std::nullopt;
    const bool isRight = current->matches(credentials.user, credentials.password);
    if (!isRight)
        report({"tryPassword", "SignIns", __LINE__},
            "wrong password for \"" + credentials.user + "\" from " + address);
    std::unique_lock lock(mutex_);
    if (!isRight)
        return delays_.fail(network, now);
    // A password of a file that was replaced meanwhile is not remembered.
    const bool isNew = passwords_ != current ||
                       memory_.remember(credentials, address, std::chrono::steady_clock::now());
    lock.unlock();
    if (isNew)
        report({"tryPassword", "SignIns", __LINE__},
            "\"" + credentials.user + "\" signed in from " + address, Severity::information);
    return std::nullopt;
}

std::shared_ptr<const Passwords> SignIns::passwords() const
{
    const std::lock_guard lock(mutex_);
    return passwords_;
}

} // namespace Host::Http
