// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/SensorView.h"

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "tools/cim/Units.h"

#include <algorithm>
#include <array>
#include <limits>

namespace Tools {

namespace {

// The value that the provider reports for a reading or limit that is not a number or does not fit.
constexpr std::int64_t unrepresentable = std::numeric_limits<std::int32_t>::min();

constexpr std::uint64_t noContact = 12;
constexpr std::uint64_t lostCommunication = 13;

constexpr std::int64_t disabled = 3;
constexpr std::int64_t offline = 6;

// Texts for the operational statuses that CurrentState has no label for.
struct Label {
    std::uint64_t status;
    std::string_view text;
};
constexpr std::array labels = {Label{5, "Pred. Failure"}, Label{8, "Starting"},
    Label{9, "Stopping"}, Label{10, "Stopped"}, Label{noContact, "No Contact"},
    Label{lostCommunication, "Lost Comm."}, Label{15, "Dormant"}};

// Returns an integer of any width and sign; nothing for a null, for another type and for what an
// int64 cannot hold.
std::optional<std::int64_t> integerOf(const Host::Value& value)
{
    if (const auto number = value.signedInteger())
        return number;
    const auto number = value.unsignedInteger();
    if (!number || *number > std::numeric_limits<std::int64_t>::max())
        return std::nullopt;
    return static_cast<std::int64_t>(*number);
}

} // namespace

std::string_view SensorView::text(std::string_view property) const
{
    const Host::Value* const value = instance_.property(property);
    return value == nullptr ? std::string_view{} : value->text().value_or(std::string_view{});
}

std::optional<std::int64_t> SensorView::number(std::string_view property) const
{
    const Host::Value* const value = instance_.property(property);
    return value == nullptr ? std::nullopt : integerOf(*value);
}

bool SensorView::hasOperationalStatus(std::uint64_t code) const
{
    const Host::Value* const value = instance_.property("OperationalStatus");
    const Host::Array* const array = value == nullptr ? nullptr : value->array();
    if (array == nullptr)
        return false;
    const auto& elements = array->elements();
    return std::any_of(elements.begin(), elements.end(),
        [&](const Host::Value& element) { return element.unsignedInteger() == code; });
}

bool SensorView::isSilent() const
{
    const auto enabledState = number("EnabledState");
    return hasOperationalStatus(noContact) || enabledState == disabled || enabledState == offline;
}

std::optional<std::string> SensorView::reading() const
{
    const auto value = number("CurrentReading");
    if (!value || *value == unrepresentable || hasOperationalStatus(lostCommunication))
        return std::nullopt;
    if (*value == 0 && isSilent())
        return std::nullopt;
    return scaled(*value, modifier());
}

std::int32_t SensorView::modifier() const
{
    return static_cast<std::int32_t>(number("UnitModifier").value_or(0));
}

std::string_view SensorView::unit() const
{
    return unitSymbol(static_cast<std::uint64_t>(number("BaseUnits").value_or(0)));
}

std::string_view SensorView::state() const
{
    const std::string_view current = text("CurrentState");
    if (!current.empty() && current != "Unknown")
        return current;
    const auto label = std::find_if(labels.begin(), labels.end(),
        [&](const Label& candidate) { return hasOperationalStatus(candidate.status); });
    return label == labels.end() ? current : label->text;
}

Health SensorView::health() const
{
    // The codes are those of CIM_ManagedSystemElement.HealthState.
    const std::int64_t state = number("HealthState").value_or(0);
    if (state >= 15)
        return Health::critical;
    if (state >= 10)
        return Health::warning;
    return state == 5 ? Health::ok : Health::unknown;
}

std::optional<std::int64_t> SensorView::limitValue(std::string_view property) const
{
    const auto value = number(property);
    return value == unrepresentable ? std::nullopt : value;
}

std::optional<std::string> SensorView::limit(std::string_view property) const
{
    const auto value = limitValue(property);
    if (!value)
        return std::nullopt;
    return withoutTrailingZeros(scaled(*value, modifier()));
}

std::optional<std::string> SensorView::roundedLimit(std::string_view property) const
{
    const auto value = limitValue(property);
    if (!value)
        return std::nullopt;
    return withoutTrailingZeros(scaledToHundredths(*value, modifier()));
}

} // namespace Tools
