// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <chrono>
#include <mutex>

namespace Host::Http {

// Limits reports of what clients can cause at will to one a minute. Thread-safe.
class ReportInterval {
public:
    // Returns whether a report may be written now, and counts it as written.
    bool allowsReport()
    {
        const std::lock_guard lock(mutex_);
        const auto now = std::chrono::steady_clock::now();
        if (now < next_)
            return false;
        next_ = now + std::chrono::minutes(1);
        return true;
    }

private:
    std::mutex mutex_;
    std::chrono::steady_clock::time_point next_ = std::chrono::steady_clock::time_point::min();
};

} // namespace Host::Http
