// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <csignal>
#include <optional>

namespace Tools {

// Blocks SIGTERM, SIGINT and SIGHUP while it exists, so that they are received here only, and
// ignores SIGPIPE and SIGXFSZ, so that writing to a closed pipe or beyond a file's limit returns an
// error. REQUIRES: there are no other threads; those that start later inherit the mask.
class Signals {
public:
    Signals();
    ~Signals();
    Signals(const Signals&) = delete;
    Signals& operator=(const Signals&) = delete;

    // Blocks until a signal arrives. Returns its number.
    int wait() const;
    // Does the same for at most the timeout. Returns nothing where no signal arrives.
    std::optional<int> waitFor(std::chrono::milliseconds timeout) const;

private:
    sigset_t signals_{};
    sigset_t before_{};
    struct sigaction pipeBefore_ {};
    struct sigaction fileBefore_ {};
};

// Ends the process by the signal's default action.
[[noreturn]] void endBySignal(int number);

} // namespace Tools
