// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// `sensorctl serve` as a process of its own, which is killed where a test leaves it running.

#pragma once

#include "tests/support/TemporaryFolder.h"
#include "tests/tools/ChildProcess.h"

#include <sys/types.h>

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace Testing {

class ServerProcess {
public:
    // Serves on any port unless the arguments name one, as the user who runs the tests unless they
    // name another. The program may be another way to start the tool. Returns when clients can
    // connect; throws std::runtime_error with what it said on standard error when it ends instead.
    explicit ServerProcess(std::vector<std::string> arguments,
        const std::map<std::string, std::string>& environment = {},
        const std::string& program = sensorctl);
    ~ServerProcess();
    ServerProcess(const ServerProcess&) = delete;
    ServerProcess& operator=(const ServerProcess&) = delete;

    std::string output() const;
    std::string log() const;
    // Of the first address it told of; with TLS, or without.
    std::uint16_t port(const std::string& scheme = "http") const;
    ::pid_t id() const { return process_; }

    void signal(int number) const;
    // Waits until the log holds the text; false when it does not for long.
    bool waitForLog(const std::string& text) const;
    // How it ended; throws std::runtime_error when that takes long. `out` and `err` are filled.
    Ended wait();
    Ended end(int number)
    {
        signal(number);
        return wait();
    }

private:
    bool hasEnded();

    TemporaryFolder folder_;
    ::pid_t process_ = -1; // -1 when it has ended
    Ended ended_;
};

} // namespace Testing
