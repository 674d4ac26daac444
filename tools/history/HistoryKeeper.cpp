// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/history/HistoryKeeper.h"

#include "host/http/EventLog.h"
#include "tools/history/HistoryFile.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Tools {

namespace {

using Host::Http::report;

[[noreturn]] void refuse(const std::string& folder, const std::string& reason)
{
    throw std::runtime_error("cannot keep the history in " + folder + ": " + reason);
}

} // namespace

HistoryKeeper::LockedFolder::LockedFolder(const std::string& folder)
    : descriptor_(::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC))
{
    if (descriptor_ == -1 || ::access(folder.c_str(), W_OK | X_OK) != 0) {
        const int number = errno;
        if (descriptor_ != -1)
            ::close(descriptor_);
        refuse(folder, std::generic_category().message(number));
    }
    if (::flock(descriptor_, LOCK_EX | LOCK_NB) != 0) {
        ::close(descriptor_);
        refuse(folder, "another process keeps its history there");
    }
}

HistoryKeeper::LockedFolder::~LockedFolder()
{
    ::close(descriptor_);
}

HistoryKeeper::HistoryKeeper(
    SensorHistory& history, const std::string& folder, std::chrono::milliseconds interval)
    : folder_(folder), history_(history), file_(folder + "/history")
{
    read();
    thread_ = std::jthread([this, interval](const std::stop_token& stop) {
        std::unique_lock lock(mutex_);
        while (!stopped_.wait_for(lock, stop, interval, [&] { return stop.stop_requested(); }))
            write();
    });
}

// A file of something else, or of another version, is not lost.
void HistoryKeeper::read()
{
    try {
        readHistoryFile(file_, history_);
    } catch (const std::exception& error) {
        const std::string kept = file_ + ".bad";
        const bool isKept = ::rename(file_.c_str(), kept.c_str()) == 0;
        report({"read", "HistoryKeeper", __LINE__}, std::string("the history begins anew: ") +
                                                        error.what() +
                                                        (isKept ? "; it is kept as " + kept : ""));
    }
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
