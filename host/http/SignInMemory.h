// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Who signed in lately, so that not every request costs a password hash.

#pragma once

#include "host/http/BasicCredentials.h"

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <map>
#include <mutex>
#include <string>

namespace Host::Http {

// Keeps no password: only a hash under a key that lives in this process's memory. What is known of
// one address says nothing of others, so that whoever comes from elsewhere is told to the log, too.
// Thread-safe.
class SignInMemory {
public:
    using Time = std::chrono::steady_clock::time_point;

    static constexpr std::size_t capacity = 256;
    static constexpr std::chrono::minutes lifetime{5};

    // Throws std::runtime_error when there is no randomness for a key.
    SignInMemory();

    bool knows(const Credentials& credentials, const std::string& address, Time now);
    // Whether they were not known.
    bool remember(const Credentials& credentials, const std::string& address, Time now);
    void forgetAll();

private:
    using Digest = std::array<std::uint8_t, 32>;

    // REQUIRES: the mutex is held.
    Digest digestOf(const Credentials& credentials, const std::string& address) const;

    std::mutex mutex_;
    std::array<std::uint8_t, 32> key_{};
    std::map<Digest, Time> until_;
};

} // namespace Host::Http
