// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cstddef>
#include <memory>
#include <mutex>

namespace Host::Http {

// How many objects are in memory because clients have yet to fetch the answers they are in.
// Thread-safe.
class UnsentObjects {
public:
    explicit UnsentObjects(std::size_t maximum) : maximum_(maximum) {}

    struct Release {
        std::size_t count;
        void operator()(UnsentObjects* all) const { all->release(count); }
    };
    // They count until it goes, which must be before this object.
    using Share = std::unique_ptr<UnsentObjects, Release>;

    // Null where there would be too many. An answer that is larger than all of them may be finds
    // room when there is no other, or nobody would ever get it.
    Share hold(std::size_t count)
    {
        const std::lock_guard lock(mutex_);
        const bool isMuch = held_ > 0 && count > 0 && held_ + count > maximum_;
        held_ += isMuch ? 0 : count;
        return Share(isMuch ? nullptr : this, Release{count});
    }

private:
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
