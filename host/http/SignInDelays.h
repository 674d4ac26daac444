// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// How long those who guess passwords wait.

#pragma once

#include <algorithm>
#include <chrono>
#include <cstddef>
#include <map>
#include <mutex>
#include <string>

namespace Host::Http {

// For each address, the time before which no password from it is tried, however many connections
// it has. Each failure moves that time further on. Thread-safe.
class SignInDelays {
public:
    using Time = std::chrono::steady_clock::time_point;
    using Duration = std::chrono::steady_clock::duration;

    static constexpr std::size_t capacity = 4096;     // addresses
    static constexpr std::chrono::minutes memory{15}; // of an address without further failures
    static constexpr unsigned maximumDoublings = 5;

    explicit SignInDelays(Duration first) : first_(first) {}

    // When a password from the address may be tried.
    Time admission(const std::string& address, Time now);
    // The same. Where that is now, and there were failures before, the next one must wait as if
    // this one had failed already: many at a time are no faster.
    Time admit(const std::string& address, Time now);
    // Counts a failure; the time when the client may hear of it.
    Time failed(const std::string& address, Time now);

    std::size_t size();

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
    void makeRoom(Time now);

    const Duration first_;
    std::mutex mutex_;
    std::map<std::string, Failures> failures_; // by address
};

} // namespace Host::Http
