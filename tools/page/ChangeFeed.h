// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Resource.h"
#include "tools/sensors/Sensor.h"

#include <chrono>
#include <condition_variable>
#include <cstddef>
#include <ctime>
#include <memory>
#include <mutex>
#include <set>
#include <stop_token>
#include <string>
#include <vector>

namespace Tools {

// Has the sensors and their changes sent to all that follow them, as server-sent events
// (https://html.spec.whatwg.org/multipage/server-sent-events.html). Thread-safe.
class ChangeFeed {
public:
    using Clock = std::chrono::steady_clock;

    // Creates a stream whose first event is the list of the sensors. One that the client fetches
    // too slowly ends. The feed must outlive it.
    std::unique_ptr<Host::Http::Stream> subscribe();
    bool hasSubscribers() const;

    // Blocks until the time, but no longer than until a stop is requested or the sensors have to be
    // published for a new stream.
    void waitUntil(Clock::time_point time, const std::stop_token& stop);

    // Sends what has changed since the last call, and the list to new streams. The sensors are in
    // the order of a list.
    void publish(const std::vector<const Sensor*>& sensors, std::time_t time);

private:
    class Subscription;
    using Event = std::shared_ptr<const std::string>;
    struct Known {
        std::string deviceId;
        std::string json;
    };

    // These require that the mutex is held.
    Event listEvent();
    Event changesSince(const std::vector<Known>& before, std::time_t time) const;

    mutable std::mutex mutex_;
    std::condition_variable_any changed_;
    std::set<Subscription*> subscriptions_;
    std::vector<Known> known_; // what was published last
    Event list_;               // of it, made when it is needed
    Clock::time_point published_ = Clock::time_point::min();
    bool isAwaited_ = false; // whether publish() has to be called soon
};

} // namespace Tools
