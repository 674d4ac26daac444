// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/history/SensorHistory.h"

#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

namespace Tools {

// Keeps a history in the file `history` of a folder: reads it when it is constructed, and replaces
// it every five minutes, on a thread of its own, and when it is destroyed. Failures are reported to
// the log; a damaged file is replaced.
class HistoryKeeper {
public:
    // The history must outlive it. Throws std::runtime_error where the folder cannot be written.
    HistoryKeeper(SensorHistory& history, const std::string& folder);
    ~HistoryKeeper();
    HistoryKeeper(const HistoryKeeper&) = delete;
    HistoryKeeper& operator=(const HistoryKeeper&) = delete;

private:
    void write();

    SensorHistory& history_;
    const std::string file_;
    std::mutex mutex_;
    std::condition_variable_any stopped_;
    bool hasFailed_ = false;
    std::jthread thread_; // last: it uses all of the above
};

} // namespace Tools
