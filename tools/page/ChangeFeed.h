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
#include <optional>
#include <set>
#include <stop_token>
#include <string>
#include <vector>

namespace Tools {

// Publishes the sensors, the sources that are lost, and their changes as server-sent events
// (https://html.spec.whatwg.org/multipage/server-sent-events.html). Thread-safe.
class ChangeFeed {
public:
    using Clock = std::chrono::steady_clock;

    // How often the sensors are published while somebody follows them.
    static constexpr std::chrono::seconds period{2};

    // A stream without changes has a heartbeat at these intervals, by which its client knows that
    // the sensors are still read.
    explicit ChangeFeed(std::chrono::milliseconds heartbeatInterval = std::chrono::seconds(15))
        : heartbeatInterval_(heartbeatInterval)
    {
    }

    // Creates a stream that begins with the list of the sensors and the lost sources. It ends where
    // the client fetches it too slowly, and where nothing was published between two heartbeats. The
    // feed must outlive it.
    std::unique_ptr<Host::Http::Stream> subscribe();
    bool hasSubscribers() const;

    // Blocks until the time, until a stop is requested, or until somebody subscribes. Returns
    // whether the sensors have to be published for a new stream.
    bool waitUntil(Clock::time_point time, const std::stop_token& stop);

    // Sends what has changed since the last call, and all to new streams. The sensors are in the
    // order of a list.
    void publish(const std::vector<const Sensor*>& sensors, std::vector<std::string> lostSources,
        std::time_t time);

private:
    class Subscription;
    using Event = std::shared_ptr<const std::string>;
    struct Known {
        std::string deviceId;
        std::string json;
    };

    // These require that the mutex is held.
    bool isPublishedWithin(std::chrono::milliseconds time) const;
    void begin(Subscription& subscription);
    Event listEvent();
    Event changesSince(const std::vector<Known>& before, std::time_t time) const;

    const std::chrono::milliseconds heartbeatInterval_;
    mutable std::mutex mutex_;
    std::condition_variable_any changed_;
    std::set<Subscription*> subscriptions_;
    std::vector<Known> known_; // what was published last
    Event list_;               // the event with known_; null until it is needed
    std::vector<std::string> lostSources_;
    Event sources_; // the event with lostSources_; null before they are published
    std::optional<Clock::time_point> published_;
    bool isAwaited_ = false; // whether publish() has to be called soon
    bool hasBegun_ = false;  // whether somebody has subscribed since the last waitUntil()
};

} // namespace Tools
