// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <condition_variable>
#include <cstddef>
#include <memory>
#include <mutex>

namespace Host::Http {

// A counting semaphore with a bounded queue: limits how many connections work at a time, and how
// many wait for that. Thread-safe.
class WorkSlots {
public:
    WorkSlots(std::size_t slots, std::size_t maximumQueue)
        : maximumQueue_(maximumQueue), free_(slots)
    {
    }

    struct Release {
        void operator()(WorkSlots* slots) const { slots->release(); }
    };
    // Occupies a slot until it is destroyed, which must be before the WorkSlots are.
    using Slot = std::unique_ptr<WorkSlots, Release>;

    // Blocks until a slot is free. Returns null at once where the queue is full.
    Slot take()
    {
        std::unique_lock lock(mutex_);
        if (free_ > 0) {
            --free_;
            return Slot(this);
        }
        if (waiting_ == maximumQueue_)
            return nullptr;
        ++waiting_;
        handedOver_.wait(lock, [this] { return handovers_ > 0; });
        --handovers_;
        return Slot(this);
    }

private:
    // Hands the slot to a waiting thread directly: were it free meanwhile, another thread could
    // take it.
    void release()
    {
        const std::lock_guard lock(mutex_);
        if (waiting_ == 0) {
            ++free_;
            return;
        }
        --waiting_;
        ++handovers_;
        handedOver_.notify_one();
    }

    const std::size_t maximumQueue_;
    std::mutex mutex_;
    std::condition_variable handedOver_;
    std::size_t free_;
    std::size_t waiting_ = 0;   // threads to which no slot was handed over
    std::size_t handovers_ = 0; // slots on their way to a thread that waited
};

} // namespace Host::Http
