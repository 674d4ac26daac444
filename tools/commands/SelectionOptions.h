// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The options that select sensors.

#pragma once

#include "tools/sensors/Selector.h"

#include <string>
#include <vector>

namespace CLI {
class App;
}

namespace Tools {

// The object must outlive the parser.
class SelectionOptions {
public:
    // Adds SELECTOR... and --kind.
    void addTo(CLI::App& parser);
    // Adds --kind.
    void addKind(CLI::App& parser);
    // Adds --problems.
    void addProblems(CLI::App& parser);

    const std::vector<std::string>& selectors() const { return selectors_; }
    const SensorFilter& filter() const { return filter_; }
    bool isGiven() const { return !selectors_.empty() || !filter_.isEmpty(); }
    // Returns what the other options select.
    SelectionOptions withoutSelectors() const;

    struct Selected {
        Sensors sensors;
        std::vector<std::string> complaints; // a sentence for each criterion that nothing meets
    };
    Selected select(Sensors all) const;

    // Returns whether the selectors and the kind select the sensor, whatever its state.
    bool isSelected(const Sensor& sensor) const;

private:
    std::vector<std::string> selectors_;
    SensorFilter filter_;
};

} // namespace Tools
