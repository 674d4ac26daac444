// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/SensorIndex.h"

#include <algorithm>
#include <bit>
#include <functional>
#include <utility>

namespace Vorn::SensorProfileProvider {

SensorIndex::SensorIndex(const std::vector<Sensor>& sensors)
{
    const auto count = static_cast<std::uint16_t>(sensors.size());
    slots_.resize(std::bit_ceil(std::size_t{2} * count + 1));
    for (std::uint16_t i = 0; i < count; ++i) {
        const Sensor*& slot = slots_[slotOf(sensors[i].deviceID())];
        size_ += slot == nullptr ? 1 : 0;
        slot = &sensors[i];
    }
}

const Sensor* SensorIndex::find(std::string_view deviceID) const
{
    return slots_.empty() ? nullptr : slots_[slotOf(deviceID)];
}

std::vector<const Sensor*> SensorIndex::inOrder() const
{
    std::vector<std::pair<std::string_view, const Sensor*>> byKey;
    byKey.reserve(size_);
    for (const Sensor* const sensor : slots_)
        if (sensor != nullptr)
            byKey.emplace_back(sensor->deviceID(), sensor);
    std::sort(byKey.begin(), byKey.end());
    std::vector<const Sensor*> ordered;
    ordered.reserve(size_);
    for (const auto& [deviceID, sensor] : byKey)
        ordered.push_back(sensor);
    return ordered;
}

// Returns the slot of the record with the identifier, or the free one where it belongs.
std::size_t SensorIndex::slotOf(std::string_view deviceID) const
{
    const std::size_t mask = slots_.size() - 1;
    std::size_t slot = std::hash<std::string_view>()(deviceID) & mask;
    while (slots_[slot] != nullptr && slots_[slot]->deviceID() != deviceID)
        slot = (slot + 1) & mask;
    return slot;
}

} // namespace Vorn::SensorProfileProvider
