// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/history/HistoryKeeper.h"

#include "host/http/EventLog.h"
#include "tools/history/HistoryFile.h"

#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Tools {

namespace {

using Host::Http::report;

constexpr std::chrono::minutes interval{5};

void requireWritable(const std::string& folder)
{
    if (::access(folder.c_str(), W_OK | X_OK) != 0)
        throw std::runtime_error(
            "cannot keep the history in " + folder + ": " + std::generic_category().message(errno));
}

} // namespace

HistoryKeeper::HistoryKeeper(SensorHistory& history, const std::string& folder)
    : history_(history), file_(folder + "/history")
{
    requireWritable(folder);
    try {
        readHistoryFile(file_, history_);
    } catch (const std::exception& error) {
        report({"HistoryKeeper", "HistoryKeeper", __LINE__},
            std::string("the history begins anew: ") + error.what());
    }
    thread_ = std::jthread([this](const std::stop_token& stop) {
        std::unique_lock lock(mutex_);
        while (!stopped_.wait_for(lock, stop, interval, [&] { return stop.stop_requested(); }))
            write();
    });
}

HistoryKeeper::~HistoryKeeper()
{
    thread_.request_stop();
    thread_.join();
    write();
}

// Reports the first failure in a row only.
void HistoryKeeper::write()
{
    try {
        writeHistoryFile(file_, history_);
        hasFailed_ = false;
    } catch (const std::exception& error) {
        if (!std::exchange(hasFailed_, true))
            report({"write", "HistoryKeeper", __LINE__},
                std::string("the history is not kept: ") + error.what());
    }
}

} // namespace Tools
