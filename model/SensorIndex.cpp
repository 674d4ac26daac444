// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/SensorIndex.h"

#include <algorithm>
#include <bit>
#include <functional>
#include <utility>

namespace Vorn::SensorProfileProvider {

SensorIndex::SensorIndex(std::span<const Sensor> sensors)
    : slots_(std::bit_ceil(2 * sensors.size() + 1), nullptr)
{
    for (const Sensor& sensor : sensors) {
        const Sensor*& slot = slots_[slotOf(sensor.deviceID())];
        size_ += slot == nullptr ? 1 : 0;
        slot = &sensor;
    }
}

std::size_t SensorIndex::slotOf(std::string_view deviceID) const
{
    const std::size_t last = slots_.size() - 1;
    std::size_t at = std::hash<std::string_view>()(deviceID) & last;
    while (slots_[at] != nullptr && slots_[at]->deviceID() != deviceID)
        at = (at + 1) & last;
    return at;
}

std::vector<const Sensor*> SensorIndex::inOrder() const
{
    std::vector<std::pair<std::string_view, const Sensor*>> byDeviceID;
    byDeviceID.reserve(size_);
    for (const Sensor* const sensor : slots_)
        if (sensor != nullptr)
            byDeviceID.emplace_back(sensor->deviceID(), sensor);
    std::sort(byDeviceID.begin(), byDeviceID.end());
    std::vector<const Sensor*> ordered;
    ordered.reserve(size_);
    for (const auto& [deviceID, sensor] : byDeviceID)
        ordered.push_back(sensor);
    return ordered;
}

} // namespace Vorn::SensorProfileProvider
