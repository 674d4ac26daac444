// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Ranges in the notation of monitoring plugins:
// https://www.monitoring-plugins.org/doc/guidelines.html

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace Tools {

// The ends belong to the range; one that is absent is infinite.
struct Range {
    std::optional<double> low;
    std::optional<double> high;
    bool isInverted = false; // the range is where readings raise an alert
    std::string text;

    bool raisesAlert(double reading) const;
};

// Reads END, START:, START:END, ~:END or one of them after an @. Throws std::invalid_argument for
// another text.
Range readRange(std::string_view text);

} // namespace Tools
