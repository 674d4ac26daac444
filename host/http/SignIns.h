// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whether a client may go on.

#pragma once

#include "host/http/Passwords.h"
#include "host/http/SignInDelays.h"
#include "host/http/SignInMemory.h"

#include <memory>
#include <mutex>
#include <optional>
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

    // Quick. Who signed in lately from this address.
    bool isKnown(const Credentials& credentials, const std::string& address, Time now)
    {
        return memory_.knows(credentials, address, now);
    }
    // When a password from the neighbourhood may be tried.
    Time admission(const std::string& neighbourhood, Time now)
    {
        return delays_.admission(neighbourhood, now);
    }
    // The same for one that is tried now if it may be.
    Time admit(const std::string& neighbourhood, Time now)
    {
        return delays_.admit(neighbourhood, now);
    }
    // Takes long. Nothing when the password is right, or none is demanded any more; for a wrong
    // one, when the client may hear of it. Both go to the log with the address, the right one when
    // it was not known. The time is counted from now, the beginning, so that it does not tell how
    // long the user's hash took.
    std::optional<Time> tryPassword(const Credentials& credentials, const std::string& address,
        const std::string& neighbourhood, Time now);

private:
    // Whether they were not known. Does not remember them when the passwords have changed
    // meanwhile.
    bool remember(const Credentials& credentials, const std::string& address,
        const std::shared_ptr<const Passwords>& tried);
    std::shared_ptr<const Passwords> passwords() const;

    mutable std::mutex mutex_;
    std::shared_ptr<const Passwords> passwords_; // null when nobody needs to sign in
    SignInMemory memory_;
    SignInDelays delays_;
};

} // namespace Host::Http
