// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "model/Sensor.h"

#include "model/ValueTables.h"
#include "platform/utilities/ProviderUtilities.h"

#include <limits>
#include <utility>

namespace Vorn::SensorProfileProvider {

namespace {

// A long double holds the product of a reading and a multiplier whole.
static_assert(std::numeric_limits<long double>::digits >= 64);

// Returns the exact product, truncated toward zero: 3.3 V become 3299 mV. The product that is
// rounded to double would become 3300. Truncated, the two differ only where rounding made a whole
// number. Everywhere else the exact product is not converted, since that makes the x87 unit wait
// for changes of its rounding mode.
std::int32_t truncatedProduct(double value, double multiplier)
{
    constexpr std::int32_t outOfRange = std::numeric_limits<std::int32_t>::min();
    const double product = value * multiplier;
    if (!(product >= -2147483649.0 && product <= 2147483648.0)) // also NaN
        return outOfRange;
    auto whole = static_cast<std::int64_t>(product);
    if (multiplier != 1.0 && static_cast<double>(whole) == product) {
        const long double exact = static_cast<long double>(value) * multiplier;
        if (whole > 0 && exact < static_cast<long double>(whole))
            --whole;
        else if (whole < 0 && exact > static_cast<long double>(whole))
            ++whole;
    }
    const auto narrowed = static_cast<std::int32_t>(whole);
    return narrowed == whole ? narrowed : outOfRange;
}

template <typename Element, typename List>
void appendTimes(std::vector<Element>& elements, const List& list, unsigned times)
{
    for (; times != 0; --times)
        elements.insert(elements.end(), list.begin(), list.end());
}

std::vector<std::uint16_t> repeatedThresholdCodes(unsigned times)
{
    std::vector<std::uint16_t> codes;
    appendTimes(codes, thresholdCodes, times);
    return codes;
}

} // namespace

std::string Sensor::getDeviceID() const
{
    return std::string(deviceID());
}

std::string Sensor::getElementName() const
{
    return stripSpaces(elementName_);
}

std::vector<std::string> Sensor::getPossibleStates()
{
    std::vector<std::string> labels;
    labels.reserve(possibleStates_.size() + fixedStateLabels.size());
    for (const unsigned status : possibleStates_)
        labels.emplace_back(stateLabels[status]);
    appendTimes(labels, fixedStateLabels, ++fixedStateLabels_);
    return labels;
}

std::uint16_t Sensor::getRateUnits()
{
    return rateUnits_ = 0;
}

std::vector<std::uint16_t> Sensor::getSupportedThresholds()
{
    return repeatedThresholdCodes(++supportedThresholds_);
}

std::vector<std::uint16_t> Sensor::getSettableThresholds()
{
    return repeatedThresholdCodes(++settableThresholds_);
}

bool Sensor::setDeviceID(std::string deviceID)
{
    deviceID_ = std::move(deviceID);
    return !deviceID_.empty();
}

bool Sensor::setElementName(std::string elementName)
{
    elementName_ = std::move(elementName);
    return !elementName_.empty();
}

bool Sensor::setBaseUnits(unsigned code)
{
    baseUnits_ = static_cast<std::uint16_t>(code);
    return true;
}

bool Sensor::setRateUnits(unsigned code)
{
    rateUnits_ = static_cast<std::uint16_t>(code);
    return rateUnits_ != 0;
}

bool Sensor::setUnitModifier(int powerOfTen)
{
    unitModifier_ = powerOfTen;
    return true;
}

bool Sensor::setSensorType(unsigned sensorType)
{
    const TypeAndScale& found = sensorTypes[sensorType];
    sensorType_ = found.sensorType;
    readingMultiplier_ = found.multiplier;
    unitModifier_ = found.unitModifier;
    if (!found.isKnown)
        baseUnits_ = 0;
    return true;
}

bool Sensor::setEnabledState(unsigned nodeStatus)
{
    enabledState_ = enabledStates[nodeStatus];
    return true;
}

bool Sensor::setRequestedState(unsigned code)
{
    requestedState_ = requestedStates[code];
    return true;
}

bool Sensor::setHealthState(unsigned nodeStatus)
{
    const Health& health = healthStates[nodeStatus];
    healthState_ = health.state;
    healthStatus_ = health.status;
    return true;
}

bool Sensor::setCurrentState(unsigned nodeStatus)
{
    currentState_ = stateLabels[nodeStatus];
    return true;
}

bool Sensor::setOperationalStatus(unsigned nodeStatus)
{
    operationalStatus_.push_back(operationalStatuses[nodeStatus]);
    return true;
}

bool Sensor::setPossibleStates(const std::vector<unsigned>& nodeStatuses)
{
    constexpr unsigned unknown = 0; // also stands for codes too large to store
    constexpr unsigned largest = std::numeric_limits<Codes::value_type>::max();
    possibleStates_.clear();
    fixedStateLabels_ = 0;
    for (const unsigned status : nodeStatuses)
        possibleStates_.push_back(
            static_cast<Codes::value_type>(status <= largest ? status : unknown));
    return true;
}

bool Sensor::storeScaled(std::int32_t& field, double value) const
{
    field = truncatedProduct(value, readingMultiplier_);
    return true;
}

bool Sensor::setCurrentReading(double value)
{
    return storeScaled(currentReading_, value);
}

bool Sensor::setLowerThresholdNonCritical(double value)
{
    return storeScaled(lowerThresholdNonCritical_, value);
}

bool Sensor::setUpperThresholdNonCritical(double value)
{
    return storeScaled(upperThresholdNonCritical_, value);
}

bool Sensor::setLowerThresholdCritical(double value)
{
    return storeScaled(lowerThresholdCritical_, value);
}

bool Sensor::setUpperThresholdCritical(double value)
{
    return storeScaled(upperThresholdCritical_, value);
}

bool Sensor::setLowerThresholdFatal(double value)
{
    return storeScaled(lowerThresholdFatal_, value);
}

bool Sensor::setUpperThresholdFatal(double value)
{
    return storeScaled(upperThresholdFatal_, value);
}

} // namespace Vorn::SensorProfileProvider
