// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// `sensorctl serve` as a process of its own, on the machine that the environment names.

#pragma once

#include <sys/types.h>

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string>

namespace Bench {

// Throws std::runtime_error when there is no such process or it says something else than expected.
class ServerProcess {
public:
    ServerProcess();
    ~ServerProcess();
    ServerProcess(const ServerProcess&) = delete;
    ServerProcess& operator=(const ServerProcess&) = delete;

    std::uint16_t port() const { return port_; }
    // From its making until it can be asked.
    std::chrono::nanoseconds startUp() const { return startUp_; }

    // In KiB, as the kernel counts them.
    std::size_t residentMemory() const { return memory("VmRSS:"); }
    std::size_t peakMemory() const { return memory("VmHWM:"); }

private:
    std::size_t memory(const std::string& entry) const;

    ::pid_t pid_ = -1;
    std::uint16_t port_ = 0;
    std::chrono::nanoseconds startUp_{};
};

} // namespace Bench
