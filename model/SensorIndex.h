// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "model/Sensor.h"

#include <cstddef>
#include <span>
#include <string_view>
#include <vector>

namespace Vorn::SensorProfileProvider {

// Records by their device identifiers; of records with the same identifier, the last one. It is a
// hash table with open addressing: a map would allocate an entry for each sensor of the machine, of
// which most requests look for one.
class SensorIndex {
public:
    // Constructs an empty index.
    SensorIndex() = default;
    // The records must outlive the index and not change.
    explicit SensorIndex(std::span<const Sensor> sensors);

    // Returns the number of identifiers.
    std::size_t size() const { return size_; }

    // Returns null when there is no record with exactly this identifier.
    const Sensor* find(std::string_view deviceID) const { return slots_[slotOf(deviceID)]; }

    // Returns the records in the order of their identifiers.
    std::vector<const Sensor*> inOrder() const;

private:
    // Returns the slot of the record with the identifier; the empty slot for it when there is none.
    std::size_t slotOf(std::string_view deviceID) const;

    std::vector<const Sensor*> slots_{nullptr}; // a power of two, more than half of them empty
    std::size_t size_ = 0;
};

} // namespace Vorn::SensorProfileProvider
