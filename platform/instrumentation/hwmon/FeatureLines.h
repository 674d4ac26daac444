// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <sensors/sensors.h>

#include <map>
#include <set>
#include <string>
#include <string_view>

namespace Vorn::Hwmon {

// The features to which a `compute` or a `label` line of a sensors configuration applies;
// libsensors computes their values and has their labels. In doubt, a line counts for more features
// than it means: that costs only time.
class FeatureLines {
public:
    // Reads a configuration, whose syntax sensors.conf(5) describes; where libsensors found errors
    // in it, a line may apply to any feature. REQUIRES: libsensors has listed the chips with this
    // configuration and keeps the list during the object's lifetime.
    FeatureLines(std::string_view configuration, bool hasErrors);

    // Return whether a line of the kind may apply to the feature.
    bool mayCompute(const sensors_chip_name& chip, const std::string& feature) const;
    bool mayLabel(const sensors_chip_name& chip, const std::string& feature) const;

private:
    using Chips = std::set<const sensors_chip_name*>;
    using Features = std::map<const sensors_chip_name*, std::set<std::string>>;

    // Return what a token of a statement names.
    std::string nameOf(std::string_view token);
    Chips chipsOf(std::string_view token);

    bool isNamedIn(
        const Features& features, const sensors_chip_name& chip, const std::string& feature) const;

    Features computed_;
    Features labelled_;
    bool isUnclear_; // a line may apply to any feature
};

} // namespace Vorn::Hwmon
