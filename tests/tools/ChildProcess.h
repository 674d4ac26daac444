// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs sensorctl or another program as a child process.

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

// How a program ended, and its output.
struct Ended {
    int code = -1;  // its exit code; -1 when a signal ended it
    int signal = 0; // the signal
    std::string out;
    std::string err;
};

struct RunOptions {
    std::string program = sensorctl;
    // The variables beside LC_ALL=C and those that turn the logs off. The tool inherits no other
    // variable that affects it.
    std::map<std::string, std::string> environment = {};
    // Standard output is captured, written to a file, closed, or a pipe without a reader.
    enum class Out { captured, file, closed, abandonedPipe } out = Out::captured;
    std::string outFile = {};
};

Ended run(const std::vector<std::string>& arguments, const RunOptions& options = {});

// Starts a program with exactly these environment variables. Returns an error number, or 0.
int spawn(::pid_t& child, const std::string& program, const std::vector<std::string>& arguments,
    const std::map<std::string, std::string>& variables, const posix_spawn_file_actions_t& actions);

// Runs sensorctl on a pseudo-terminal of that width. `out` holds what it writes there, to standard
// error, too.
Ended runOnTerminal(const std::vector<std::string>& arguments, unsigned short columns,
    const std::map<std::string, std::string>& environment = {{"TERM", "xterm"}});

} // namespace Testing
