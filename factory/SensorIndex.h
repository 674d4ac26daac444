// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "model/Sensor.h"

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace Vorn::SensorProfileProvider {

// Finds records by their device identifiers. Of records with one identifier, only the last counts.
// The records must outlive the index, at their place. Most requests look for one record, so that
// the index is a hash table, and the order of the identifiers is found when it is asked for.
class SensorIndex {
public:
    SensorIndex() = default;
    // Indexes as many records as their number, truncated to 16 bits.
    explicit SensorIndex(const std::vector<Sensor>& sensors);

    // Returns the number of identifiers.
    std::size_t size() const { return size_; }

    // Returns null where there is no record.
    const Sensor* find(std::string_view deviceID) const;

    // Returns the records in the order of their identifiers.
    std::vector<const Sensor*> inOrder() const;

private:
    std::size_t slotOf(std::string_view deviceID) const;

    // By hash; a collision takes the next free one. A power of two of them, at most half full.
    std::vector<const Sensor*> slots_;
    std::size_t size_ = 0;
};

} // namespace Vorn::SensorProfileProvider
