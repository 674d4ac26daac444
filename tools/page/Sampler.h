// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/sensors/Harvest.h"
#include "tools/serve/SingleFlight.h"

#include <chrono>
#include <cstdint>
#include <future>
#include <thread>

namespace Tools {

class ChangeFeed;
class SensorHistory;

// Reads the sensors on a thread of its own: every ten seconds for the history, and in the feed's
// period while somebody follows it.
class Sampler {
public:
    // The history is null where none is kept. All must outlive it.
    Sampler(SingleFlight<Harvest>& harvests, ChangeFeed& feed, SensorHistory* history);

    // Ends the sampling. Returns false where the sensors are still being read after the timeout:
    // the destructor would wait for that.
    bool stop(std::chrono::milliseconds timeout);

private:
    void run(const std::stop_token& stop);
    void sample();
    std::chrono::steady_clock::time_point nextTime() const;

    SingleFlight<Harvest>& harvests_;
    ChangeFeed& feed_;
    SensorHistory* const history_;
    std::chrono::steady_clock::time_point sampled_{};
    std::int64_t slot_ = -1; // of the last sample for the history
    std::promise<void> end_;
    std::jthread thread_; // last: it uses all of the above
};

} // namespace Tools
