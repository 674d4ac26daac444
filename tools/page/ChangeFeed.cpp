// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/page/ChangeFeed.h"

#include "tools/output/JsonText.h"
#include "tools/output/SensorJson.h"

#include <deque>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace Tools {

namespace {

// Events of a stream that its client has yet to fetch.
constexpr std::size_t maximumPending = 8;

std::shared_ptr<const std::string> eventOf(std::string_view name, std::string_view data)
{
    auto event = std::make_shared<std::string>("event: ");
    event->append(name).append("\ndata: ").append(data).append("\n\n");
    return event;
}

std::shared_ptr<const std::string> sourcesEvent(const std::vector<std::string>& lost)
{
    std::string names;
    for (const std::string& name : lost) {
        names += names.empty() ? "" : ", ";
        appendString(names, name);
    }
    return eventOf("sources", "{\"lost\": [" + names + "]}");
}

std::shared_ptr<const std::string> heartbeat()
{
    return eventOf("alive", "{\"time\": " + std::to_string(std::time(nullptr)) + "}");
}

} // namespace

// All members but the feed are guarded by its mutex.
class ChangeFeed::Subscription : public Host::Http::Stream {
public:
    explicit Subscription(ChangeFeed& feed) : feed_(feed) {}

    ~Subscription() override
    {
        const std::lock_guard lock(feed_.mutex_);
        feed_.subscriptions_.erase(this);
    }

    Event next() override
    {
        std::unique_lock lock(feed_.mutex_);
        const auto isReady = [this] { return isOver_ || !pending_.empty(); };
        if (isNew_) // a heartbeat must not come first
            feed_.changed_.wait(lock, isReady);
        else if (!feed_.changed_.wait_for(lock, feed_.heartbeatInterval_, isReady))
            return feed_.isPublishedWithin(feed_.heartbeatInterval_) ? heartbeat() : nullptr;
        if (isOver_)
            return nullptr;
        Event event = std::move(pending_.front());
        pending_.pop_front();
        return event;
    }

    void end() noexcept override
    {
        const std::lock_guard lock(feed_.mutex_);
        isOver_ = true;
        feed_.changed_.notify_all();
    }

    // These require that the mutex is held.
    bool isNew() const { return isNew_; }
    void add(Event event)
    {
        isNew_ = false;
        if (pending_.size() < maximumPending) {
            pending_.push_back(std::move(event));
        } else {
            pending_.clear();
            isOver_ = true;
        }
    }

private:
    ChangeFeed& feed_;
    std::deque<Event> pending_;
    bool isNew_ = true; // whether it has yet to get the list
    bool isOver_ = false;
};

std::unique_ptr<Host::Http::Stream> ChangeFeed::subscribe()
{
    auto subscription = std::make_unique<Subscription>(*this);
    const std::lock_guard lock(mutex_);
    if (isPublishedWithin(period))
        begin(*subscription);
    else
        isAwaited_ = true;
    hasBegun_ = true;
    changed_.notify_all();
    subscriptions_.insert(subscription.get());
    return subscription;
}

bool ChangeFeed::hasSubscribers() const
{
    const std::lock_guard lock(mutex_);
    return !subscriptions_.empty();
}

bool ChangeFeed::isPublishedWithin(std::chrono::milliseconds time) const
{
    return published_ && Clock::now() - *published_ < time;
}

bool ChangeFeed::waitUntil(Clock::time_point time, const std::stop_token& stop)
{
    std::unique_lock lock(mutex_);
    changed_.wait_until(lock, stop, time, [this] { return isAwaited_ || hasBegun_; });
    hasBegun_ = false;
    return std::exchange(isAwaited_, false);
}

void ChangeFeed::publish(const std::vector<const Sensor*>& sensors,
    std::vector<std::string> lostSources, std::time_t time)
{
    std::vector<Known> now;
    now.reserve(sensors.size());
    for (const Sensor* const sensor : sensors) {
        Known& known = now.emplace_back(Known{sensor->deviceId, {}});
        appendSensorJson(known.json, *sensor);
    }
    const std::lock_guard lock(mutex_);
    std::swap(known_, now);
    const Event changes = changesSince(now, time);
    if (changes)
        list_ = nullptr;
    const bool areOthersLost = !sources_ || lostSources != lostSources_;
    if (areOthersLost) {
        lostSources_ = std::move(lostSources);
        sources_ = sourcesEvent(lostSources_);
    }
    published_ = Clock::now();
    isAwaited_ = false;
    for (Subscription* const each : subscriptions_) {
        if (each->isNew()) {
            begin(*each);
            continue;
        }
        if (changes)
            each->add(changes);
        if (areOthersLost)
            each->add(sources_);
    }
    changed_.notify_all();
}

void ChangeFeed::begin(Subscription& subscription)
{
    subscription.add(listEvent());
    subscription.add(sources_);
}

ChangeFeed::Event ChangeFeed::listEvent()
{
    if (!list_) {
        std::string list = "[";
        for (const Known& each : known_)
            list.append(list.size() > 1 ? ", " : "").append(each.json);
        list_ = eventOf("sensors", list + "]");
    }
    return list_;
}

// Returns null where nothing has changed.
ChangeFeed::Event ChangeFeed::changesSince(const std::vector<Known>& before, std::time_t time) const
{
    std::unordered_map<std::string_view, const Known*> gone;
    for (const Known& each : before)
        gone.emplace(each.deviceId, &each);
    std::string sensors;
    for (const Known& each : known_) {
        const auto old = gone.find(each.deviceId);
        if (old == gone.end() || old->second->json != each.json)
            sensors.append(sensors.empty() ? "" : ", ").append(each.json);
        if (old != gone.end())
            gone.erase(old);
    }
    if (sensors.empty() && gone.empty())
        return nullptr;
    std::string identifiers;
    for (const auto& [deviceId, known] : gone) {
        identifiers += identifiers.empty() ? "" : ", ";
        appendString(identifiers, deviceId);
    }
    return eventOf("changes", "{\"time\": " + std::to_string(time) + ", \"sensors\": [" + sensors +
                                  "], \"gone\": [" + identifiers + "]}");
}

} // namespace Tools
