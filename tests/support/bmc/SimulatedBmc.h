// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A management controller, simulated by ipmi_sim on the loopback addresses.

#pragma once

#include "tests/support/TemporaryFolder.h"

#include <sys/types.h>

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace Testing {

class SimulatedBmc {
public:
    // Starts a machine that these commands make. Returns when readers can connect; throws
    // std::runtime_error with the simulator's output when it does not start.
    explicit SimulatedBmc(const std::string& emulation);
    // Ends the simulator.
    ~SimulatedBmc();
    SimulatedBmc(const SimulatedBmc&) = delete;
    SimulatedBmc& operator=(const SimulatedBmc&) = delete;

    // Returns the environment of a process whose /dev/ipmi0 is this controller.
    std::map<std::string, std::string> environment() const;

    // Executes a command of ipmi_sim_cmd(5). Throws std::runtime_error with the simulator's error.
    void command(const std::string& line) const;

    // Replaces the faults that SimulatorPreload.cpp describes.
    void setFaults(const std::string& lines) const;

    // Returns the commands that were answered, a line for each.
    std::vector<std::string> answered() const;

    void suspend() const;
    void resume() const;
    void stop();
    void start();

private:
    TemporaryFolder folder_;
    std::uint16_t systemPort_;
    std::uint16_t consolePort_;
    ::pid_t process_ = -1;
};

} // namespace Testing
