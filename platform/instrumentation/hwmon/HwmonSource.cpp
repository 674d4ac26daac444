// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/HwmonSource.h"

#include "platform/instrumentation/hwmon/ChipList.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <chrono>
#include <future>
#include <utility>

namespace Vorn {

using NodeLexicon::NodeType;

namespace {

using Clock = std::chrono::steady_clock;

// When a chip took long last, for each type of nodes. Drivers may keep what they have read for a
// while, so that a chip which is slow takes long for the first type only, or for some requests.
std::array<std::atomic<Clock::time_point>, 3> slowAt;

std::size_t indexOf(NodeType type)
{
    return static_cast<std::size_t>(type) - static_cast<std::size_t>(NodeType::Tachometer);
}

} // namespace

const std::vector<Node>& HwmonSource::nodes(NodeType type)
{
    catalogue_ = Hwmon::ChipList::instance().present();
    reader_.emplace(catalogue_);
    ahead_.clear();
    nodes_.clear();
    for (const Hwmon::Feature& feature : catalogue_->features)
        if (feature.type == type)
            nodes_.push_back(feature.node);
    return nodes_;
}

const NodeReading& HwmonSource::read(const Node& node)
{
    const Hwmon::Feature& feature = catalogue_->features.at(node.token);
    if (order_ == Order::serial)
        return reading_ = reader_->read(feature);
    if (ahead_.empty())
        readAhead(feature.type);
    auto reading = std::exchange(ahead_[node.token], std::nullopt);
    return reading_ = reading ? std::move(*reading) : reader_->read(feature);
}

// Reads the nodes of the type, chip by chip. Where no chip has taken long for a while, this thread
// reads until one does, since starting a thread takes as long as reading some chips. A further
// thread starts whenever no chip was finished in an interval.
void HwmonSource::readAhead(NodeType type)
{
    constexpr std::size_t maximumThreads = 16;
    constexpr auto interval = std::chrono::milliseconds(2);
    constexpr auto memory = std::chrono::minutes(1); // of chips that took long
    ahead_.resize(catalogue_->features.size());
    std::atomic<std::size_t> next = 0;
    std::atomic<bool> isSlow = false; // whether a chip took longer
    const auto readChips = [&](bool isUntilSlow) {
        const auto& features = catalogue_->features;
        Hwmon::NodeReader reader(catalogue_);
        while (!(isUntilSlow && isSlow)) {
            const std::size_t chip = next++;
            if (chip >= catalogue_->chips.size())
                break;
            const auto begin = Clock::now();
            auto feature = std::ranges::lower_bound(features, chip, {}, &Hwmon::Feature::chip);
            for (; feature != features.end() && feature->chip == chip; ++feature)
                if (feature->type == type)
                    ahead_[feature->node.token] = reader.read(*feature);
            if (Clock::now() - begin > interval)
                isSlow = true;
        }
    };
    std::atomic<Clock::time_point>& lastSlow = slowAt.at(indexOf(type));
    if (Clock::now() - lastSlow.load() > memory)
        readChips(true);
    // Where no thread can be started, get() reads the chips.
    std::vector<std::future<void>> threads;
    bool isStuck = true;
    while (next < catalogue_->chips.size() && threads.size() < maximumThreads) {
        const std::size_t before = next;
        if (isStuck)
            threads.push_back(std::async(readChips, false));
        if (threads.back().wait_for(interval) != std::future_status::timeout)
            break;
        isStuck = next <= before + 1; // a thread that started takes one chip at once
    }
    for (auto& thread : threads)
        thread.get();
    if (isSlow)
        lastSlow = Clock::now();
}

} // namespace Vorn
