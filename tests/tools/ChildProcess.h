// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs sensorctl, or another program, as a person or a script would.

#pragma once

#include <spawn.h>
#include <sys/types.h>

#include <map>
#include <optional>
#include <string>
#include <vector>

namespace Testing {

inline const std::string sensorctl = SENSOR_PROFILE_BINARY_DIR "/bin/sensorctl";
inline const std::string sensorLibrary =
    SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileProvider.so";
inline const std::string systemLibrary =
    SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileComputerSystem.so";

// How a program ended, and what it wrote.
struct Ended {
    int code = -1;  // its exit code; -1 when a signal ended it
    int signal = 0; // the signal
    std::string out;
    std::string err;
};

struct RunOptions {
    std::string program = sensorctl;
    // Beside LC_ALL=C and silent logs; no other setting of this process that matters to the
    // tool reaches it.
    std::map<std::string, std::string> environment = {};
    // Where standard output goes: into the result, to a file, nowhere because it is closed, or
    // into a pipe that nobody reads.
    enum class Out { captured, file, closed, abandonedPipe } out = Out::captured;
    std::string outFile = {};
};

Ended run(const std::vector<std::string>& arguments, const RunOptions& options = {});

// Starts a program with these variables and no others. Returns the number of the error, or 0.
int spawn(::pid_t& child, const std::string& program, const std::vector<std::string>& arguments,
    const std::map<std::string, std::string>& variables, const posix_spawn_file_actions_t& actions);

// On a terminal of so many columns, which is where `out` comes from; standard error goes there too.
Ended runOnTerminal(const std::vector<std::string>& arguments, unsigned short columns,
    const std::map<std::string, std::string>& environment = {{"TERM", "xterm"}});

} // namespace Testing
