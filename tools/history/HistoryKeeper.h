// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/history/SensorHistory.h"

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

namespace Tools {

// Keeps a history in the file `history` of a folder: reads it when it is constructed, and replaces
// it at intervals, on a thread of its own, and when it is destroyed. Failures are reported to the
// log. A file that cannot be used is renamed to `history.bad`.
class HistoryKeeper {
public:
    // The history must outlive it. Throws std::runtime_error where the folder cannot be written or
    // another process keeps its history there.
    HistoryKeeper(SensorHistory& history, const std::string& folder,
        std::chrono::milliseconds interval = std::chrono::minutes(5));
    ~HistoryKeeper();
    HistoryKeeper(const HistoryKeeper&) = delete;
    HistoryKeeper& operator=(const HistoryKeeper&) = delete;

private:
    // An open folder that one process has locked.
    class LockedFolder {
    public:
        explicit LockedFolder(const std::string& folder);
        ~LockedFolder();
        LockedFolder(const LockedFolder&) = delete;
        LockedFolder& operator=(const LockedFolder&) = delete;

    private:
        int descriptor_;
    };

    void read();
    void write();

    const LockedFolder folder_;
    SensorHistory& history_;
    const std::string file_;
    std::mutex mutex_;
    std::condition_variable_any stopped_;
    bool hasFailed_ = false;
    std::jthread thread_; // last: it uses all of the above
};

} // namespace Tools
