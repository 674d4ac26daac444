// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/SignIns.h"

#include "host/http/EventLog.h"

#include <utility>

namespace Host::Http {

bool SignIns::areDemanded() const
{
    return passwords() != nullptr;
}

void SignIns::replacePasswords(std::shared_ptr<const Passwords> passwords)
{
    {
        const std::lock_guard lock(mutex_);
        passwords_ = std::move(passwords);
    }
    memory_.forgetAll();
}

std::optional<SignIns::Time> SignIns::tryPassword(const Credentials& credentials,
    const std::string& address, const std::string& neighbourhood, Time now)
{
    const auto current = passwords();
    if (!current)
        return std::nullopt;
    if (!current->matches(credentials.user, credentials.password)) {
        report({"tryPassword", "SignIns", __LINE__},
            "wrong password for \"" + credentials.user + "\" from " + address);
        return delays_.failed(neighbourhood, now);
    }
    if (remember(credentials, address, current))
        report({"tryPassword", "SignIns", __LINE__},
            "\"" + credentials.user + "\" signed in from " + address);
    return std::nullopt;
}

bool SignIns::remember(const Credentials& credentials, const std::string& address,
    const std::shared_ptr<const Passwords>& tried)
{
    const std::lock_guard lock(mutex_);
    return passwords_ != tried ||
           memory_.remember(credentials, address, std::chrono::steady_clock::now());
}

std::shared_ptr<const Passwords> SignIns::passwords() const
{
    const std::lock_guard lock(mutex_);
    return passwords_;
}

} // namespace Host::Http
