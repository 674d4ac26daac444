// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <sensors/sensors.h>

#include <map>
#include <set>
#include <string>
#include <string_view>

namespace Vorn::Hwmon {

// The features to which a `compute` line of a sensors configuration applies; libsensors computes
// their values. In doubt, a line counts for more features than it means: that costs only time.
class ComputeLines {
public:
    // Reads a configuration, whose syntax sensors.conf(5) describes; where libsensors found errors
    // in it, any feature may be computed. REQUIRES: libsensors has listed the chips with this
    // configuration and keeps the list during the object's lifetime.
    ComputeLines(std::string_view configuration, bool hasErrors);

    bool mayApplyTo(const sensors_chip_name& chip, const std::string& feature) const;

private:
    using Chips = std::set<const sensors_chip_name*>;

    // Return what a token of a statement names.
    std::string nameOf(std::string_view token);
    Chips chipsOf(std::string_view token);

    std::map<const sensors_chip_name*, std::set<std::string>> features_;
    bool isUnclear_; // any feature may be computed
};

} // namespace Vorn::Hwmon
