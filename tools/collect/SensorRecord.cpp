// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/SensorRecord.h"

#include "tools/collect/SensorName.h"

#include <algorithm>

namespace Ipmi {

std::optional<SensorRecord> readSensorRecord(std::span<const std::uint8_t> record)
{
    constexpr std::size_t nameAt = 47;
    constexpr std::size_t factorsAt = 24;
    constexpr std::size_t thresholdsAt = 36;
    if (record.size() <= nameAt || record[3] != fullSensorRecord)
        return std::nullopt;
    SensorRecord sensor;
    sensor.address = {.channel = static_cast<std::uint8_t>(record[6] >> 4U),
        .owner = record[5],
        .lun = static_cast<std::uint8_t>(record[6] & 3U),
        .number = record[7]};
    sensor.entity = record[8];
    sensor.entityInstance = record[9];
    sensor.access = static_cast<ThresholdAccess>(record[11] >> 2U & 3U);
    sensor.sensorType = record[12];
    sensor.eventType = record[13];
    sensor.reported = (record[15] >> 4U & 7U) | (record[17] >> 4U & 7U) << 3U;
    sensor.readable = record[18];
    sensor.format = static_cast<AnalogFormat>(record[20] >> 6U);
    sensor.units = {.base = record[21],
        .rate = static_cast<std::uint8_t>(record[20] >> 3U & 7U),
        .isModified = (record[20] & 7U) != 0};
    sensor.linearization = record[23] & 0x7FU;
    sensor.factors = factorsOf(record.subspan<factorsAt, factorBytes>());
    // The record has them from the upper non-recoverable to the lower non-critical one.
    std::reverse_copy(record.begin() + thresholdsAt, record.begin() + thresholdsAt + thresholdCount,
        sensor.thresholds.begin());
    sensor.name = decodeName(record.subspan(nameAt));
    return sensor;
}

} // namespace Ipmi
