// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstdint>
#include <map>
#include <mutex>

namespace Host::Http {

// Counts the responses of a server by their status. Thread-safe.
class ResponseCounts {
public:
    void add(unsigned status)
    {
        const std::lock_guard lock(mutex_);
        ++counts_[status];
    }

    std::map<unsigned, std::uint64_t> get() const
    {
        const std::lock_guard lock(mutex_);
        return counts_;
    }

private:
    mutable std::mutex mutex_;
    std::map<unsigned, std::uint64_t> counts_;
};

} // namespace Host::Http
