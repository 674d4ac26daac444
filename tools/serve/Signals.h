// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <csignal>
#include <optional>

namespace Tools {

// While it lives, SIGTERM, SIGINT and SIGHUP reach nobody but who asks here, and neither a reader
// that is gone nor a file that is too large ends the process. To be made before there are other
// threads, which inherit that.
class Signals {
public:
    Signals();
    ~Signals();
    Signals(const Signals&) = delete;
    Signals& operator=(const Signals&) = delete;

    // The next signal's number.
    int wait() const;
    // Nothing when none comes within the time.
    std::optional<int> waitFor(std::chrono::milliseconds time) const;

private:
    sigset_t signals_{};
    sigset_t before_{};
    struct sigaction pipeBefore_ {};
    struct sigaction fileBefore_ {};
};

// Ends the process as the signal does where nobody handles it.
[[noreturn]] void endBySignal(int number);

} // namespace Tools
