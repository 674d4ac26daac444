// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <memory>
#include <mutex>

namespace Host::Http {

// Counts the objects that are in memory because clients have yet to fetch the answers with them.
// Thread-safe.
class UnsentObjects {
public:
    explicit UnsentObjects(std::size_t maximum) : maximum_(maximum) {}

    struct Release {
        std::size_t count;
        void operator()(UnsentObjects* all) const { all->release(count); }
    };
    // The objects count until it is destroyed, which must be before the UnsentObjects are.
    using Share = std::unique_ptr<UnsentObjects, Release>;

    // Returns null where the objects would exceed the maximum. A single answer may exceed it, since
    // no client would ever get it otherwise.
    Share hold(std::size_t count)
    {
        const std::lock_guard lock(mutex_);
        const bool areTooMany = areTooManyWith(count);
        held_ += areTooMany ? 0 : count;
        return Share(areTooMany ? nullptr : this, Release{count});
    }

    // Returns whether hold() would return a share now.
    bool hasRoomFor(std::size_t count)
    {
        const std::lock_guard lock(mutex_);
        return !areTooManyWith(count);
    }

private:
    bool areTooManyWith(std::size_t count) const
    {
        return held_ > 0 && count > 0 && held_ + count > maximum_;
    }
    void release(std::size_t count)
    {
        const std::lock_guard lock(mutex_);
        held_ -= count;
    }

    const std::size_t maximum_;
    std::mutex mutex_;
    std::size_t held_ = 0;
};

} // namespace Host::Http
