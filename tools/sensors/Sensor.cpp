// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Sensor.h"

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "host/broker/String.h"
#include "model/Sensor.h"
#include "platform/text/Escape.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tools/cim/Units.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <limits>
#include <utility>
#include <vector>

namespace Tools {

namespace {

// The value that the provider reports for a reading or limit that is not a number or does not fit.
constexpr std::int64_t unrepresentable = std::numeric_limits<std::int32_t>::min();

// Codes of OperationalStatus and EnabledState.
constexpr unsigned noContact = 12;
constexpr unsigned lostCommunication = 13;
constexpr unsigned disabled = 3;
constexpr unsigned offline = 6;

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

// The properties of an instance. They are found fast when they are requested in the order in which
// the provider sets them.
class PropertyLookup {
public:
    explicit PropertyLookup(const Host::Instance& instance)
        : instance_(instance), next_(instance.properties().begin())
    {
    }

    // Returns a null value when there is no such property.
    Host::Value operator[](std::string_view name)
    {
        for (auto each = next_; each != instance_.properties().end(); ++each)
            if (*(*each).name->text() == name) {
                const Host::Value& value = (*each).value;
                next_ = ++each;
                return value;
            }
        const Host::Value* const value = instance_.property(name);
        return value == nullptr ? Host::Value() : *value;
    }

    std::string_view text(std::string_view name) { return (*this)[name].text().value_or(""); }

    std::optional<std::int64_t> number(std::string_view name) { return integerOf((*this)[name]); }

private:
    const Host::Instance& instance_;
    decltype(std::declval<const Host::NamedValues&>().begin()) next_;
};

// Returns the code of an integer property; 0, which is unknown, for a null and for what is no code.
unsigned codeOf(std::optional<std::int64_t> number)
{
    return number && std::in_range<unsigned>(*number) ? static_cast<unsigned>(*number) : 0;
}

std::vector<unsigned> codesIn(const Host::Value& value)
{
    std::vector<unsigned> codes;
    if (const Host::Array* const array = value.array())
        for (const Host::Value& element : array->elements())
            if (const auto code = element.unsignedInteger())
                codes.push_back(static_cast<unsigned>(*code));
    return codes;
}

// Returns the words of those labels of PossibleStates that can be a CurrentState. textOf() returns
// the text of a label.
template <typename Labels, typename TextOf>
std::vector<std::string_view> wordsOf(const Labels& labels, TextOf textOf)
{
    std::vector<std::string_view> words;
    words.reserve(labels.size());
    for (const auto& label : labels)
        if (const auto word = wordOfState(textOf(label)))
            words.push_back(*word);
    return words;
}

// Returns the name for a code of SensorType.
std::string_view kindOf(unsigned sensorType)
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

std::optional<Quantity> quantityOf(std::optional<std::int64_t> value, std::int32_t modifier)
{
    if (!value || *value == unrepresentable)
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

Sensor::Sensor(const Host::Instance& from) : instance(&from)
{
    PropertyLookup properties(from);
    const std::string_view id = properties.text("DeviceID");
    identify(properties.text("ElementName"), id);
    const std::string_view currentState = properties.text("CurrentState");
    if (const Host::Array* const states = properties["PossibleStates"].array())
        possibleStates = wordsOf(
            states->elements(), [](const Host::Value& value) { return value.text().value_or(""); });
    unit = unitSymbol(codeOf(properties.number("BaseUnits")));
    kind = kindOf(codeOf(properties.number("SensorType")));
    const unsigned enabledState = codeOf(properties.number("EnabledState"));
    health = codeOf(properties.number("HealthState"));
    const std::vector<unsigned> statuses = codesIn(properties["OperationalStatus"]);
    state = stateOf(currentState, statuses);
    const auto current = properties.number("CurrentReading");
    const auto modifier = static_cast<std::int32_t>(properties.number("UnitModifier").value_or(0));
    setReading(quantityOf(current, modifier), enabledState, statuses);
    for (const std::size_t i : {0U, 3U, 1U, 4U, 2U, 5U}) // in the provider's order
        limits.at(i) = quantityOf(properties.number(limitKinds.at(i).property), modifier);
}

Sensor::Sensor(ProviderRecord& record)
{
    identify(record.getElementName(), record.deviceID());
    possibleStates = wordsOf(record.getPossibleStates(), std::identity());
    unit = unitSymbol(record.getBaseUnits());
    kind = kindOf(record.getSensorType());
    health = record.getHealthState();
    const auto codes = record.getOperationalStatus();
    const std::vector<unsigned> statuses(codes.begin(), codes.end());
    state = stateOf(record.getCurrentState(), statuses);
    const std::int32_t modifier = record.getUnitModifier();
    setReading(
        quantityOf(record.getCurrentReading(), modifier), record.getEnabledState(), statuses);
    const std::array<std::int32_t, limitKinds.size()> thresholds = {// in the order of limitKinds
        record.getLowerThresholdNonCritical(), record.getLowerThresholdCritical(),
        record.getLowerThresholdFatal(), record.getUpperThresholdNonCritical(),
        record.getUpperThresholdCritical(), record.getUpperThresholdFatal()};
    for (std::size_t i = 0; i < thresholds.size(); ++i)
        if (thresholds.at(i) != 0) // the instance has no property for 0
            limits.at(i) = quantityOf(thresholds.at(i), modifier);
}

void Sensor::setReading(std::optional<Quantity> currentReading, unsigned enabledState,
    std::span<const unsigned> operationalStatus)
{
    const auto has = [&](unsigned status) {
        return std::ranges::find(operationalStatus, status) != operationalStatus.end();
    };
    const bool isSilent = has(noContact) || enabledState == disabled || enabledState == offline;
    const bool isZero = currentReading && currentReading->value == 0;
    if (!has(lostCommunication) && !(isZero && isSilent))
        reading = currentReading;
}

std::string deviceIdOf(const std::string& description, std::string_view path)
{
    return Vorn::stripSpaces(description + ":" + Text::toOneLine(path));
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
