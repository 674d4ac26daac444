// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// One ZUMLO_NumericSensor instance, read by meaning instead of by property.

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

// Looks at an instance that must outlive it. Texts come as the provider sent them, not yet fit
// for a terminal; numbers come scaled to the base unit, such as "12.345".
class SensorView {
public:
    explicit SensorView(const Host::Instance& instance) : instance_(instance) {}

    std::string_view name() const { return text("ElementName"); }
    std::string_view deviceId() const { return text("DeviceID"); }

    // Nothing when the sensor delivers no value. CurrentReading is there even then, as 0, and
    // has to be told from a true 0: it means nothing when the sensor has lost communication
    // (OperationalStatus 13), nor when it is 0 and the sensor is out of contact
    // (OperationalStatus 12), disabled or offline (EnabledState 3 or 6).
    std::optional<std::string> reading() const;

    // Empty when the unit is not known.
    std::string_view unit() const;

    // CurrentState; where that says nothing, what OperationalStatus says. Empty when neither
    // does.
    std::string_view state() const;

    Health health() const;

    // The limit of that property, exactly or rounded to hundredths; nothing when the sensor has
    // none.
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
