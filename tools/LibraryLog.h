// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <vector>

namespace Tools {

// Keeps the libraries from writing to standard error, and collects what they log about the machine,
// unless RYNLOG_LOG says where the log goes.
class LibraryLog {
public:
    // Sets variables of the environment, which the libraries read at first use. REQUIRES: no
    // library has logged yet, and there are no other threads.
    LibraryLog();
    ~LibraryLog();
    LibraryLog(const LibraryLog&) = delete;
    LibraryLog& operator=(const LibraryLog&) = delete;

    // Returns the texts of the messages since the last call, each once in the lifetime of the log,
    // but for those that contain a text that is shown anyway: mistakes in the sensors
    // configuration, and sources that cannot be used.
    std::vector<std::string> takeMessages(const std::string& shown);

    // Writes these messages to standard error. Throws std::system_error.
    void printMessages(const std::string& shown);

private:
    int file_ = -1; // in memory; -1 where nothing is collected
    std::vector<std::string> taken_;
};

} // namespace Tools
