// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whether a client may go on.

#pragma once

#include "host/http/Passwords.h"
#include "host/http/SignInDelays.h"
#include "host/http/SignInMemory.h"

#include <memory>
#include <mutex>
#include <string>

namespace Host::Http {

// Thread-safe.
class SignIns {
public:
    using Time = SignInMemory::Time;

    // Without passwords nobody needs to sign in.
    SignIns(std::shared_ptr<const Passwords> passwords, SignInDelays::Duration firstDelay)
        : passwords_(std::move(passwords)), delays_(firstDelay)
    {
    }

    bool areDemanded() const;
    // Who signed in before must do so again.
    void replacePasswords(std::shared_ptr<const Passwords> passwords);

    // Quick. A client that signed in lately.
    bool isKnown(const Credentials& credentials, Time now)
    {
        return memory_.knows(credentials, now);
    }
    // When try() may be called for a client at the address.
    Time admission(const std::string& address, Time now) { return delays_.admission(address, now); }
    // Takes long. A failure goes to the log. REQUIRES: areDemanded().
    bool tryPassword(const Credentials& credentials, const std::string& address);
    // After a failure: when the client may hear of it.
    Time delayFailure(const std::string& address, Time now) { return delays_.failed(address, now); }

private:
    std::shared_ptr<const Passwords> passwords() const;

    mutable std::mutex mutex_;
    std::shared_ptr<const Passwords> passwords_; // null when nobody needs to sign in
    SignInMemory memory_;
    SignInDelays delays_;
};

} // namespace Host::Http
