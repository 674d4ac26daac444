// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <condition_variable>
#include <exception>
#include <functional>
#include <memory>
#include <mutex>
#include <utility>

namespace Tools {

// Runs a function one call at a time. Callers that wait while a call runs share the result of the
// next one, so that none gets a result that is older than its request. Keeps no result.
// Thread-safe.
template <typename Result>
class SingleFlight {
public:
    using Shared = std::shared_ptr<const Result>;

    explicit SingleFlight(std::function<Shared()> function) : function_(std::move(function)) {}

    // Returns the result of a call that begins after this one. Throws what the function throws.
    Shared get()
    {
        std::unique_lock lock(mutex_);
        if (!next_)
            next_ = std::make_shared<Flight>();
        const auto own = next_;
        while (!own->isOver)
            if (isRunning_)
                changed_.wait(lock);
            else
                runNext(lock);
        if (own->failure)
            std::rethrow_exception(own->failure);
        return own->result;
    }

private:
    struct Flight {
        Shared result;
        std::exception_ptr failure;
        bool isOver = false;
    };

    void runNext(std::unique_lock<std::mutex>& lock)
    {
        const auto flight = std::exchange(next_, nullptr);
        isRunning_ = true;
        lock.unlock();
        try {
            flight->result = function_();
        } catch (...) {
            flight->failure = std::current_exception();
        }
        lock.lock();
        isRunning_ = false;
        flight->isOver = true;
        changed_.notify_all();
    }

    const std::function<Shared()> function_;
    std::mutex mutex_;
    std::condition_variable changed_; // a flight is over
    std::shared_ptr<Flight> next_;    // which has not begun
    bool isRunning_ = false;
};

} // namespace Tools
