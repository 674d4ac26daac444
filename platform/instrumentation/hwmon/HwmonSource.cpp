// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/HwmonSource.h"

#include "platform/instrumentation/hwmon/ChipList.h"

#include <algorithm>
#include <atomic>
#include <chrono>
#include <future>
#include <utility>

namespace Vorn {

using NodeLexicon::NodeType;

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

// Reads the nodes of the type, chip by chip. A further thread starts only when no chip was finished
// in an interval: where all chips are fast, more threads would only cost time.
void HwmonSource::readAhead(NodeType type)
{
    constexpr std::size_t maximumThreads = 16;
    constexpr auto interval = std::chrono::milliseconds(2);
    ahead_.resize(catalogue_->features.size());
    std::atomic<std::size_t> next = 0;
    const auto readChips = [&] {
        const auto& features = catalogue_->features;
        Hwmon::NodeReader reader(catalogue_);
        for (std::size_t chip = next++; chip < catalogue_->chips.size(); chip = next++) {
            auto feature = std::ranges::lower_bound(features, chip, {}, &Hwmon::Feature::chip);
            for (; feature != features.end() && feature->chip == chip; ++feature)
                if (feature->type == type)
                    ahead_[feature->node.token] = reader.read(*feature);
        }
    };
    // Where no thread can be started, get() reads the chips.
    std::vector<std::future<void>> threads;
    bool isStuck = true;
    while (next < catalogue_->chips.size() && threads.size() < maximumThreads) {
        const std::size_t before = next;
        if (isStuck)
            threads.push_back(std::async(readChips));
        if (threads.back().wait_for(interval) != std::future_status::timeout)
            break;
        isStuck = next <= before + 1; // a thread that started takes one chip at once
    }
    for (auto& thread : threads)
        thread.get();
}

} // namespace Vorn
