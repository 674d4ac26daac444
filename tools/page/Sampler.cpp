// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/page/Sampler.h"

#include "host/http/EventLog.h"
#include "tools/history/SensorHistory.h"
#include "tools/page/ChangeFeed.h"

#include <algorithm>
#include <exception>
#include <string>
#include <utility>

namespace Tools {

namespace {

using SteadyClock = std::chrono::steady_clock;
using SystemClock = std::chrono::system_clock;

} // namespace

Sampler::Sampler(SingleFlight<Harvest>& harvests, ChangeFeed& feed, SensorHistory* history)
    : harvests_(harvests), feed_(feed), history_(history),
      thread_([this](const std::stop_token& stop) {
          run(stop);
          end_.set_value();
      })
{
}

bool Sampler::stop(std::chrono::milliseconds timeout)
{
    thread_.request_stop();
    if (end_.get_future().wait_for(timeout) != std::future_status::ready)
        return false;
    thread_.join();
    return true;
}

void Sampler::run(const std::stop_token& stop)
{
    if (history_ != nullptr)
        sample();
    for (;;) {
        const auto next = nextTime();
        const bool isAwaited = feed_.waitUntil(next, stop);
        if (stop.stop_requested())
            return;
        if (isAwaited || SteadyClock::now() >= next)
            sample();
    }
}

// Without subscribers and history, a sample once in a day has no user and does no harm.
SteadyClock::time_point Sampler::nextTime() const
{
    const auto now = SteadyClock::now();
    auto next = now + std::chrono::hours(24);
    if (feed_.hasSubscribers())
        next = sampled_ + ChangeFeed::period;
    if (history_ != nullptr) {
        constexpr std::chrono::seconds slot{secondsOfSlot};
        next = std::min(next, now + slot - SystemClock::now().time_since_epoch() % slot);
    }
    return next;
}

void Sampler::sample()
{
    sampled_ = SteadyClock::now();
    try {
        const auto harvest = harvests_.get();
        const auto sensors = inListOrder(harvest->sensors);
        const auto now = SystemClock::now();
        const SlotNumber slot = SensorHistory::slotOf(now);
        if (history_ != nullptr && std::exchange(slot_, slot) != slot)
            history_->add(sensors, now);
        if (feed_.hasSubscribers())
            feed_.publish(sensors, harvest->lostSources(), SystemClock::to_time_t(now));
    } catch (const std::exception& error) {
        Host::Http::report({"sample", "Sampler", __LINE__},
            std::string("the sensors were not read: ") + error.what());
    }
}

} // namespace Tools
