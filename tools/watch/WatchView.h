// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The lines of a screen that shows watched sensors.

#pragma once

#include "tools/output/Table.h"
#include "tools/watch/History.h"

#include <deque>
#include <string>
#include <vector>

namespace Tools {

enum class Order { byChip, byUrgency, byName };

class WatchView {
public:
    // Adds changes to the log.
    void add(const std::vector<Change>& changes);
    // Sets what is shown in place of the summary; an empty text for nothing.
    void setFailure(const std::string& failure) { failure_ = failure; }

    void toggleProblems();
    void nextOrder();
    // Scrolls the sensors by a number of lines; lines() keeps the first one in range.
    void scroll(int lines);

    // Returns as many lines as the height.
    std::vector<Line> lines(
        const History& history, const std::string& interval, std::size_t height, TextStyle style);

private:
    std::vector<const WatchedSensor*> shown(const History& history) const;
    Table table(const std::vector<const WatchedSensor*>& sensors, const TextStyle& style) const;
    Line title(const std::string& interval) const;

    Order order_ = Order::byChip;
    bool onlyProblems_ = false;
    int firstLine_ = 0;
    std::string failure_;
    std::deque<Change> log_; // the latest last
};

} // namespace Tools
