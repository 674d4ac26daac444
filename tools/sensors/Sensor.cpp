// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Sensor.h"

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "platform/text/Escape.h"
#include "platform/text/Utf8.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tools/cim/Units.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

namespace Tools {

namespace {

// The value that the provider reports for a reading or limit that is not a number or does not fit.
constexpr std::int64_t unrepresentable = std::numeric_limits<std::int32_t>::min();

// Codes of OperationalStatus and EnabledState.
constexpr unsigned noContact = 12;
constexpr unsigned lostCommunication = 13;
constexpr std::int64_t disabled = 3;
constexpr std::int64_t offline = 6;

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

std::string_view textIn(const Host::Instance& instance, std::string_view property)
{
    const Host::Value* const value = instance.property(property);
    return value == nullptr ? std::string_view{} : value->text().value_or(std::string_view{});
}

std::optional<std::int64_t> numberIn(const Host::Instance& instance, std::string_view property)
{
    const Host::Value* const value = instance.property(property);
    return value == nullptr ? std::nullopt : integerOf(*value);
}

std::vector<unsigned> operationalStatusesOf(const Host::Instance& instance)
{
    std::vector<unsigned> statuses;
    const Host::Value* const value = instance.property("OperationalStatus");
    if (const Host::Array* const array = value == nullptr ? nullptr : value->array())
        for (const Host::Value& element : array->elements())
            if (const auto status = element.unsignedInteger())
                statuses.push_back(static_cast<unsigned>(*status));
    return statuses;
}

// Returns the words of the possible states that can be a CurrentState.
std::vector<std::string_view> possibleStatesOf(const Host::Instance& instance)
{
    std::vector<std::string_view> words;
    const Host::Value* const value = instance.property("PossibleStates");
    if (const Host::Array* const array = value == nullptr ? nullptr : value->array())
        for (const Host::Value& element : array->elements())
            if (const auto word = wordOfState(element.text().value_or("")))
                words.push_back(*word);
    return words;
}

// Returns the name for a code of SensorType.
std::string_view kindOf(std::int64_t sensorType)
{
    switch (sensorType) {
    case 2:
        return sensorKinds[0];
    case 3:
        return sensorKinds[1];
    case 5:
        return sensorKinds[2];
    default:
        return "";
    }
}

std::optional<Quantity> quantityIn(
    const Host::Instance& instance, std::string_view property, std::int32_t modifier)
{
    const auto value = numberIn(instance, property);
    if (!value || value == unrepresentable)
        return std::nullopt;
    return Quantity{*value, modifier};
}

} // namespace

double Quantity::number() const
{
    // The quotient is the double nearest to the decimal number, which a product may miss.
    return modifier < 0 ? static_cast<double>(value) / std::pow(10, -modifier)
                        : static_cast<double>(value) * std::pow(10, modifier);
}

std::string Quantity::text() const
{
    return withoutTrailingZeros(scaled(value, modifier));
}

std::string Quantity::rounded() const
{
    return scaledToHundredths(value, modifier);
}

Sensor::Sensor(const Host::Instance& from)
    : kind(kindOf(numberIn(from, "SensorType").value_or(0))),
      unit(unitSymbol(static_cast<std::uint64_t>(numberIn(from, "BaseUnits").value_or(0)))),
      instance(&from)
{
    identify(textIn(from, "ElementName"), textIn(from, "DeviceID"));
    const std::vector<unsigned> statuses = operationalStatusesOf(from);
    const auto has = [&](unsigned status) {
        return std::find(statuses.begin(), statuses.end(), status) != statuses.end();
    };
    state = stateOf(textIn(from, "CurrentState"), statuses);
    possibleStates = possibleStatesOf(from);
    health = static_cast<unsigned>(numberIn(from, "HealthState").value_or(0));
    const auto enabledState = numberIn(from, "EnabledState");
    const bool isSilent = has(noContact) || enabledState == disabled || enabledState == offline;
    const auto modifier = static_cast<std::int32_t>(numberIn(from, "UnitModifier").value_or(0));
    reading = quantityIn(from, "CurrentReading", modifier);
    if (reading && (has(lostCommunication) || (reading->value == 0 && isSilent)))
        reading.reset();
    for (std::size_t i = 0; i < limits.size(); ++i)
        limits.at(i) = quantityIn(from, limitKinds.at(i).property, modifier);
}

std::string deviceIdOf(const std::string& description, std::string_view path)
{
    return Vorn::stripSpaces(description + ":" + Text::escapeControls(Text::toValidUtf8(path)));
}

void Sensor::setNames(const std::string& description, std::string_view itsPath)
{
    identify(Vorn::stripSpaces(description), deviceIdOf(description, itsPath));
}

// The identifier consists of the description, which the name is without blanks at its ends, and the
// path.
void Sensor::identify(std::string_view elementName, std::string_view id)
{
    label = elementName;
    deviceId = id;
    const std::string_view more = id.starts_with(label) ? id.substr(label.size()) : "";
    const auto colon = more.find_first_not_of(" \t");
    const bool isNamed = colon != std::string_view::npos && more[colon] == ':';
    path = isNamed ? more.substr(colon + 1) : id;
    constexpr std::string_view hwmon = "/hwmon/";
    std::string_view rest = path;
    rest.remove_prefix(rest.starts_with(hwmon) ? hwmon.size() : rest.starts_with('/') ? 1 : 0);
    // The rest of the path of a management controller's sensor is an address in several parts.
    const auto slash = rest.starts_with("ipmi/") ? rest.find('/') : rest.rfind('/');
    chip = slash == std::string_view::npos ? "/" : rest.substr(0, slash);
    feature = slash == std::string_view::npos ? rest : rest.substr(slash + 1);
}

} // namespace Tools
