// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A ZUMLO_NumericSensor instance, interpreted.

#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace Host {
class Instance;
}

namespace Tools {

enum class Health { unknown, ok, warning, critical };

// Refers to an instance that must outlive it. Texts are returned as the provider spells them, not
// yet printable; numbers are scaled to the base unit, such as "12.345".
class SensorView {
public:
    explicit SensorView(const Host::Instance& instance) : instance_(instance) {}

    std::string_view name() const { return text("ElementName"); }
    std::string_view deviceId() const { return text("DeviceID"); }

    // Returns nothing when the sensor has no reading: when CurrentReading is missing or out of
    // range, when communication is lost (OperationalStatus 13), and when CurrentReading is 0 and
    // the sensor is out of contact (OperationalStatus 12), disabled or offline (EnabledState 3 or
    // 6).
    std::optional<std::string> reading() const;

    // Returns an empty text for an unknown unit.
    std::string_view unit() const;

    // Returns CurrentState; where that is empty or unknown, a text for OperationalStatus if there
    // is one.
    std::string_view state() const;

    Health health() const;

    // Return the limit in that property, exactly or rounded to hundredths; nothing when the sensor
    // has none.
    std::optional<std::string> limit(std::string_view property) const;
    std::optional<std::string> roundedLimit(std::string_view property) const;

private:
    std::string_view text(std::string_view property) const;
    std::optional<std::int64_t> limitValue(std::string_view property) const;
    std::optional<std::int64_t> number(std::string_view property) const;
    bool hasOperationalStatus(std::uint64_t code) const;
    std::int32_t modifier() const;
    bool isSilent() const;

    const Host::Instance& instance_;
};

} // namespace Tools
