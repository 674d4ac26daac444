// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Who may sign in, who did so lately, and how long those who fail wait.

#pragma once

#include "host/http/BasicCredentials.h"
#include "host/http/Passwords.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

namespace Host::Http {

// The sign-ins that succeeded lately, since a password hash is too costly for every request. Keeps
// no password, but a hash under a key that exists in this process's memory only. A sign-in from one
// address does not count for others, so that the log names every address.
class SignInMemory {
public:
    using Time = std::chrono::steady_clock::time_point;

    static constexpr std::size_t capacity = 256;
    static constexpr std::chrono::minutes lifetime{5};

    // Throws std::runtime_error when the system provides no random key.
    SignInMemory();

    bool contains(const Credentials& credentials, const std::string& address, Time now) const;
    // Returns whether the sign-in was not yet in the memory.
    bool remember(const Credentials& credentials, const std::string& address, Time now);
    void forgetAll() { until_.clear(); }

private:
    using Digest = std::array<std::uint8_t, 32>;

    Digest digestOf(const Credentials& credentials, const std::string& address) const;

    std::array<std::uint8_t, 32> key_{};
    std::map<Digest, Time> until_;
};

// The time before which no password is tried, for each address, however many connections it has.
// Each failure postpones it, and doubles the delay of the next.
class SignInDelays {
public:
    using Time = std::chrono::steady_clock::time_point;
    using Duration = std::chrono::steady_clock::duration;

    static constexpr std::size_t capacity = 4096;     // addresses
    static constexpr std::chrono::minutes memory{15}; // of an address without further failures
    static constexpr unsigned maximumDoublings = 5;

    explicit SignInDelays(Duration first) : first_(first) {}

    // Returns when a password from the address may be tried. Where that is now, and there were
    // failures before, the next password waits as if this one had failed already: several
    // connections guess no faster than one.
    Time admit(const std::string& address, Time now);
    // Counts a failure. Returns when it may be answered.
    Time fail(const std::string& address, Time now);

private:
    struct Failures {
        unsigned count = 0;
        Time notBefore{};
        Time last{};
    };

    static bool isOld(const Failures& failures, Time now) { return now - failures.last > memory; }
    Duration delayAfter(const Failures& failures) const
    {
        return first_ * (1U << std::min(failures.count, maximumDoublings));
    }

    Duration first_;
    std::map<std::string, Failures> failures_; // by address
};

// The passwords, the memory and the delays of a server. Thread-safe.
class SignIns {
public:
    using Time = std::chrono::steady_clock::time_point;

    // Without passwords no client must sign in.
    SignIns(std::shared_ptr<const Passwords> passwords, SignInDelays::Duration firstDelay)
        : passwords_(std::move(passwords)), delays_(firstDelay)
    {
    }

    bool areDemanded() const { return passwords() != nullptr; }
    // Forgets who signed in.
    void replacePasswords(std::shared_ptr<const Passwords> passwords);

    // Returns whether the client signed in lately from this address. Takes no hash.
    bool isKnown(const Credentials& credentials, const std::string& address, Time now) const;
    // Returns when a password from the network may be tried (see SignInDelays).
    Time admit(const std::string& network, Time now);
    // Checks the password against its hash, which takes long. Returns nothing when it is right or
    // none is demanded any more. For a wrong one, returns when it may be answered: that time counts
    // from the beginning of the check and so does not reveal the cost of the user's hash. The log
    // names the user and the address, once for a right password that stays in the memory.
    std::optional<Time> tryPassword(const Credentials& credentials, const std::string& address,
        const std::string& network, Time now);

private:
    std::shared_ptr<const Passwords> passwords() const;

    mutable std::mutex mutex_;
    std::shared_ptr<const Passwords> passwords_; // null when no client must sign in
    SignInMemory memory_;
    SignInDelays delays_;
};

} // namespace Host::Http
