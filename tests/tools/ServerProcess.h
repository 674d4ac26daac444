// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs `sensorctl serve` as a child process, which the destructor kills if it still runs.

#pragma once

#include "tests/support/TemporaryFolder.h"
#include "tests/tools/ChildProcess.h"

#include <sys/types.h>

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace Testing {

class ServerProcess {
public:
    // Serves on any port unless the arguments name one, as the user who runs the tests unless they
    // name another. The program may be another one that starts the tool. Returns when clients can
    // connect; throws std::runtime_error with its standard error when it ends instead.
    explicit ServerProcess(std::vector<std::string> arguments,
        const std::map<std::string, std::string>& environment = {},
        const std::string& program = sensorctl);
    ~ServerProcess();
    ServerProcess(const ServerProcess&) = delete;
    ServerProcess& operator=(const ServerProcess&) = delete;

    std::string output() const;
    std::string log() const;
    // Returns the port of the first address of the scheme that it printed.
    std::uint16_t port(const std::string& scheme = "http") const;
    ::pid_t id() const { return process_; }
    std::size_t residentKilobytes() const;

    void signal(int number) const;
    // Waits until the log contains the text. Returns false after a timeout.
    bool waitForLog(const std::string& text) const;
    // Waits for the end of the process. Returns its exit code and output; throws std::runtime_error
    // after a timeout.
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
