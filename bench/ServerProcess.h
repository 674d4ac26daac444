// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs `sensorctl serve` as a child process, for the machine that VORN_INSTRUMENTATION selects. It
// waits for the first line in a pipe, so that the measured start is exact: the tests' class of this
// name looks into a file every few milliseconds.

#pragma once

#include <sys/types.h>

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string>

namespace Bench {

// Throws std::runtime_error when the process does not start or its output is not the expected one.
class ServerProcess {
public:
    ServerProcess();
    ~ServerProcess();
    ServerProcess(const ServerProcess&) = delete;
    ServerProcess& operator=(const ServerProcess&) = delete;

    ::pid_t id() const { return pid_; }
    std::uint16_t port() const { return port_; }
    // Returns the time from the start of the process until it accepts requests.
    std::chrono::nanoseconds startUp() const { return startUp_; }

    // Both return KiB, as /proc shows them.
    std::size_t residentMemory() const { return memory("VmRSS:"); }
    std::size_t peakMemory() const { return memory("VmHWM:"); }

private:
    std::size_t memory(const std::string& entry) const;

    ::pid_t pid_ = -1;
    std::uint16_t port_ = 0;
    std::chrono::nanoseconds startUp_{};
};

} // namespace Bench
